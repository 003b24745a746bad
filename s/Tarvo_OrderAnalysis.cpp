// Each source is put into one table, that of the root's order, when its line is read. In most
// libraries nothing else is needed: no core lists a source that another one lists too.

#include "Tarvo_OrderAnalysis.h"

#include <utility>

#include "Tarvo_Report.h"

namespace Tarvo {

bool OrderAnalysis::MayReuse(const Reading& reading) const {
  return reading.part != nullptr && reading.isSilent && !Report::IsTracing() &&
         open.size() + reading.part->GetLevels() <= kDeepestLevel;
}

const OrderPart& OrderAnalysis::Read(Reading& reading,
                                     const std::function<const OrderPart&()>& read) {
  if (reading.part) return ReadAgain(reading, read);
  const unsigned messagesBefore = Report::CountMessages();
  try {
    const OrderPart& part = read();
    // A checker takes what is read a second time for nothing, so it remembers nothing.
    if (!Diagnosis::GoesOn() && !isAgain) {
      reading = {&part, Report::CountMessages() == messagesBefore};
    }
    return part;
  } catch (...) {
    // The order holds what was read before it failed. A checker goes on.
    isShared = false;
    throw;
  }
}

const OrderPart& OrderAnalysis::ReadAgain(const Reading& reading,
                                          const std::function<const OrderPart&()>& read) {
  const std::size_t before = parts.size();
  const bool wasAgain = std::exchange(isAgain, true);
  // Of its own, so that what is read many times needs memory once.
  const auto former = std::exchange(memory, std::make_shared<OrderPart::Memory>());
  read();
  memory = former;
  isAgain = wasAgain;
  parts.resize(before);
  return *reading.part;
}

OrderPart& OrderAnalysis::NewPart() {
  auto part = std::make_shared<OrderPart>(memory);
  parts.push_back(part);
  return *part;
}

AnalyseOrder& CoreOrder::GetSum() {
  if (!sum) sum = AddUp(part);
  return *sum;
}

// `add` adds to an order, and gives what stands there already. What is new to the root's order is
// new to this core's. What is not may come from elsewhere.
template <class AddTo>
auto CoreOrder::AddOwn(const AddTo& add) {
  if (!analysis.IsShared()) return add(GetSum());
  const auto earlier = add(analysis.order);
  return !sum && (isOutermost || !earlier) ? earlier : add(GetSum());
}

AnalyseOrder::Earlier CoreOrder::Add(AnalyseOrder::Source& source, bool forSynthesis,
                                     bool forSimulation) {
  if (source.odd != nullptr) analysis.StopSharing();
  const auto earlier =
      AddOwn([&](AnalyseOrder& order) { return order.Add(source, forSynthesis, forSimulation); });
  source.forSynthesis = forSynthesis && earlier.synthesis == nullptr;
  source.forSimulation = forSimulation && earlier.simulation == nullptr;
  if (source.forSynthesis || source.forSimulation) part.Add(source);
  return earlier;
}

const AnalyseOrder::IncludeDirectory* CoreOrder::Add(AnalyseOrder::IncludeDirectory directory) {
  const AnalyseOrder::IncludeDirectory& added = part.Keep(std::move(directory));
  const auto* const earlier = AddOwn([&](AnalyseOrder& order) { return order.Add(added); });
  if (!earlier) part.Add(added);
  return earlier;
}

AnalyseOrder::Known CoreOrder::Add(const OrderPart& core, std::optional<AnalyseOrder> coreSum) {
  AnalyseOrder::Known known;
  if (sum || !analysis.IsShared() || Report::IsTracing()) {
    if (!coreSum) coreSum = AddUp(core);
    // Odd names are told apart by other keys in their own core than above it.
    if (GetSum().IsEmpty() && !core.HasOdd()) {
      sum = std::move(coreSum);
    } else {
      known = GetSum().Append(*coreSum);
    }
  }
  part.Add(core);
  return known;
}

AnalyseOrder CoreOrder::TakeOrder() {
  return std::move(analysis.IsShared() ? analysis.order : GetSum());
}

}  // namespace Tarvo
