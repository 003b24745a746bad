// Adding up comes to each part once: what stands in the lists already is not added again. Odd names
// alone need the order of each core by itself, since its own entries are told apart by other keys
// than those of included cores.

#include "Tarvo_OrderPart.h"

#include <algorithm>
#include <unordered_map>
#include <unordered_set>
#include <utility>

namespace Tarvo {

namespace {

void AddOwn(AnalyseOrder& order, const OrderPart::Entry& entry) {
  if (entry.source) order.Add(*entry.source, entry.forSynthesis, entry.forSimulation);
  if (entry.directory) order.Add(*entry.directory);
}

using Parts = std::unordered_set<const OrderPart*>;

void AddPlain(AnalyseOrder& order, const OrderPart& part, Parts& added) {
  if (!added.insert(&part).second) return;
  for (const OrderPart::Entry& entry : part.entries) {
    AddOwn(order, entry);
    if (entry.core) AddPlain(order, *entry.core, added);
  }
}

using Orders = std::unordered_map<const OrderPart*, AnalyseOrder>;

const AnalyseOrder& AddUpOdd(const OrderPart& part, Orders& orders) {
  const auto known = orders.find(&part);
  if (known != orders.end()) return known->second;
  AnalyseOrder order;
  for (const OrderPart::Entry& entry : part.entries) {
    AddOwn(order, entry);
    if (entry.core) order.Append(AddUpOdd(*entry.core, orders));
  }
  return orders.emplace(&part, std::move(order)).first->second;
}

}  // namespace

void OrderPart::Add(const AnalyseOrder::Source& source, bool forSynthesis, bool forSimulation) {
  entries.push_back({&source, nullptr, nullptr, forSynthesis, forSimulation});
  hasOdd = hasOdd || source.odd;
}

void OrderPart::Add(const AnalyseOrder::IncludeDirectory& directory) {
  entries.push_back({nullptr, &directory, nullptr});
}

void OrderPart::Add(const OrderPart& core) {
  entries.push_back({nullptr, nullptr, &core});
  levels = std::max(levels, core.levels + 1);
  hasOdd = hasOdd || core.hasOdd;
}

AnalyseOrder AddUp(const OrderPart& part) {
  if (part.hasOdd) {
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
