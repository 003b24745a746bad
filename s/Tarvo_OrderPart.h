#ifndef TARVO_ORDERPART_H
#define TARVO_ORDERPART_H

#include <deque>
#include <forward_list>
#include <vector>

#include "Tarvo_AnalyseOrder.h"

namespace Tarvo {

// What one file adds to an order, in the order of its lines: sources and include directories of its
// own, and the parts of cores that it includes. Parts are shared: one that several files include is
// read once. A part owns its own entries; whoever reads owns the parts.
struct OrderPart {
  // One of the three.
  struct Entry {
    const AnalyseOrder::Source* source = nullptr;
    const AnalyseOrder::IncludeDirectory* directory = nullptr;
    const OrderPart* core = nullptr;
    bool forSynthesis = false;  // of a source
    bool forSimulation = false;
  };

  void Add(const AnalyseOrder::Source& source, bool forSynthesis, bool forSimulation);
  void Add(const AnalyseOrder::IncludeDirectory& directory);
  void Add(const OrderPart& core);

  std::vector<Entry> entries;
  std::forward_list<AnalyseOrder::Origin> origins;
  std::deque<AnalyseOrder::Source> sources;
  std::forward_list<AnalyseOrder::IncludeDirectory> directories;
  unsigned levels = 1;  // with those of the cores that it includes
  bool hasOdd = false;  // whether a source here or below has an odd name
};

// The order that a part adds up to, without the includes.
AnalyseOrder AddUp(const OrderPart& part);

}  // namespace Tarvo

#endif
