// Adding up comes to each part once: what stands in the lists already is not added again. Odd names
// alone need the order of each core by itself, since its own entries are told apart by other keys
// than those of included cores.

#include "Tarvo_OrderPart.h"

#include <algorithm>
#include <cstring>
#include <type_traits>
#include <unordered_map>
#include <unordered_set>
#include <utility>

namespace Tarvo {

namespace {

using Source = AnalyseOrder::Source;
using IncludeDirectory = AnalyseOrder::IncludeDirectory;

// Adds what is no core. Gives the core, or null.
const OrderPart* AddOwn(AnalyseOrder& order, const OrderPart::Entry& entry) {
  if (const auto* const source = std::get_if<const Source*>(&entry)) {
    order.Add(**source, (*source)->forSynthesis, (*source)->forSimulation);
    return nullptr;
  }
  if (const auto* const directory = std::get_if<const IncludeDirectory*>(&entry)) {
    order.Add(**directory);
    return nullptr;
  }
  return std::get<const OrderPart*>(entry);
}

using Parts = std::unordered_set<const OrderPart*>;

void AddPlain(AnalyseOrder& order, const OrderPart& part, Parts& added) {
  if (!added.insert(&part).second) return;
  for (const OrderPart::Entry& entry : part.GetEntries()) {
    if (const OrderPart* const core = AddOwn(order, entry)) AddPlain(order, *core, added);
  }
}

using Orders = std::unordered_map<const OrderPart*, AnalyseOrder>;

const AnalyseOrder& AddUpOdd(const OrderPart& part, Orders& orders) {
  const auto known = orders.find(&part);
  if (known != orders.end()) return known->second;
  AnalyseOrder order;
  for (const OrderPart::Entry& entry : part.GetEntries()) {
    if (const OrderPart* const core = AddOwn(order, entry)) order.Append(AddUpOdd(*core, orders));
  }
  return orders.emplace(&part, std::move(order)).first->second;
}

}  // namespace

AnalyseOrder::Source& OrderPart::MakeSource(std::string_view fileKey) {
  static_assert(std::is_trivially_destructible_v<Source>);
  auto* const text = static_cast<char*>(memory->allocate(fileKey.size(), 1));
  std::memcpy(text, fileKey.data(), fileKey.size());
  auto* const source = new (memory->allocate(sizeof(Source), alignof(Source))) Source;
  source->fileKey = {text, fileKey.size()};
  return *source;
}

const AnalyseOrder::Origin* OrderPart::Keep(AnalyseOrder::Origin origin) {
  return &origins.emplace_front(std::move(origin));
}

const AnalyseOrder::OddName* OrderPart::Keep(AnalyseOrder::OddName name) {
  return &oddNames.emplace_front(std::move(name));
}

const IncludeDirectory& OrderPart::Keep(IncludeDirectory directory) {
  return directories.emplace_front(std::move(directory));
}

void OrderPart::Add(const Source& source) {
  Append(&source);
  hasOdd = hasOdd || source.odd != nullptr;
}

void OrderPart::Add(const OrderPart& core) {
  Append(&core);
  levels = std::max(levels, core.levels + 1);
  hasOdd = hasOdd || core.hasOdd;
}

AnalyseOrder AddUp(const OrderPart& part) {
  if (part.HasOdd()) {
    Orders orders;
    AddUpOdd(part, orders);
    return std::move(orders.at(&part));
  }
  AnalyseOrder order;
  Parts added;
  AddPlain(order, part, added);
  return order;
}

}  // namespace Tarvo
