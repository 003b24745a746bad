#ifndef TARVO_ORDERPART_H
#define TARVO_ORDERPART_H

#include <forward_list>
#include <memory>
#include <memory_resource>
#include <string_view>
#include <utility>
#include <variant>

#include "Tarvo_AnalyseOrder.h"

namespace Tarvo {

// What one file adds to an order, in the order of its lines: sources and include directories of its
// own, and the parts of cores that it includes. Parts are shared: one that several files include is
// read once. A part owns its own entries; whoever reads owns the parts.
class OrderPart {
 public:
  using Entry = std::variant<const AnalyseOrder::Source*, const AnalyseOrder::IncludeDirectory*,
                             const OrderPart*>;
  // For what needs no end: sources, their keys, and lists of entries. Several parts share one.
  using Memory = std::pmr::monotonic_buffer_resource;

  explicit OrderPart(std::shared_ptr<Memory> shared)
      : memory(std::move(shared)), entries(memory.get()), last(entries.before_begin()) {}
  OrderPart(const OrderPart&) = delete;
  OrderPart& operator=(const OrderPart&) = delete;

  // Makes what may become entries: from here on it lives as long as the part.
  AnalyseOrder::Source& MakeSource(std::string_view fileKey);
  const AnalyseOrder::Origin* Keep(AnalyseOrder::Origin origin);
  const AnalyseOrder::OddName* Keep(AnalyseOrder::OddName name);
  const AnalyseOrder::IncludeDirectory& Keep(AnalyseOrder::IncludeDirectory directory);

  void Add(const AnalyseOrder::Source& source);
  void Add(const AnalyseOrder::IncludeDirectory& directory) { Append(&directory); }
  void Add(const OrderPart& core);

  const std::pmr::forward_list<Entry>& GetEntries() const { return entries; }
  // With those of the cores that it includes.
  unsigned GetLevels() const { return levels; }
  // Whether a source here or below has an odd name.
  bool HasOdd() const { return hasOdd; }

 private:
  void Append(const Entry& entry) { last = entries.insert_after(last, entry); }

  std::shared_ptr<Memory> memory;
  std::pmr::forward_list<Entry> entries;
  std::pmr::forward_list<Entry>::iterator last;
  std::forward_list<AnalyseOrder::Origin> origins;
  std::forward_list<AnalyseOrder::OddName> oddNames;
  std::forward_list<AnalyseOrder::IncludeDirectory> directories;
  unsigned levels = 1;
  bool hasOdd = false;
};

// The order that a part adds up to, without the includes.
AnalyseOrder AddUp(const OrderPart& part);

}  // namespace Tarvo

#endif
