#ifndef TARVO_ORDERANALYSIS_H
#define TARVO_ORDERANALYSIS_H

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <unordered_map>
#include <utility>
#include <vector>

#include "Tarvo_AnalyseOrder.h"
#include "Tarvo_OrderPart.h"

namespace Tarvo {

// A file that is being read, and the entry that it has come to.
struct OpenOrder {
  std::shared_ptr<const StringBase> file;
  const Kel_Key* core;
  AnalyseOrder::Mark entry;
};
// The outermost first.
using OpenOrders = std::vector<OpenOrder>;

// What the readers of one analysis share.
//
// A core that was read without a circle can't be in one with those that include it later, so its
// part may stand for it wherever else it is included. It is read again where somebody can tell: for
// its messages and traces, and where it would now nest too deep.
class OrderAnalysis {
 public:
  // Far above what libraries need, and far below what the stack of a thread has room for.
  static constexpr unsigned kDeepestLevel = 1000;

  // A core as it was read in one language.
  struct Reading {
    const OrderPart* part = nullptr;  // null until it was read to its end
    bool isSilent = false;            // whether no message was issued meanwhile
  };
  struct Core {
    unsigned timesOpen = 0;
    std::map<StringBase, Reading> readings;  // by language
  };

  // Whether the part of that reading may stand for another one, here and now.
  bool MayReuse(const Reading& reading) const;
  // Has a core read, and gives its part, which is remembered. What is read again adds nothing: the
  // part that was read first is given.
  const OrderPart& Read(Reading& reading, const std::function<const OrderPart&()>& read);
  OrderPart& NewPart();

  // Whether all readers add to the order of the root as they go. Not while a core is read again,
  // nor where the parts must be added up one by one: with odd names, and where a part was given up.
  bool IsShared() const { return isShared && !isAgain; }
  void StopSharing() { isShared = false; }

  OpenOrders open;
  std::unordered_map<StringBase, Core> cores;  // by the text of the key that the index has
  std::set<StringBase> done;  // for a checker alone: the files that were read to their end
  std::vector<std::shared_ptr<const OrderPart>> parts;  // in the order in which they were begun
  AnalyseOrder order;                                   // of the root, while it is shared

 private:
  const OrderPart& ReadAgain(const Reading& reading, const std::function<const OrderPart&()>& read);

  std::shared_ptr<OrderPart::Memory> memory = std::make_shared<OrderPart::Memory>();
  bool isShared = true;
  bool isAgain = false;
};

// The order of one core, as far as it was read: its part, and what that adds up to, which is worked
// out only where it is asked for. It is, where an entry might be listed twice in that core, and for
// traces.
class CoreOrder {
 public:
  CoreOrder(OrderAnalysis& theAnalysis, bool isRoot)
      : analysis(theAnalysis), isOutermost(isRoot), part(theAnalysis.NewPart()) {}

  // Add what an entry states, and give what stands in this core's order already.
  AnalyseOrder::Earlier Add(AnalyseOrder::Source& source, bool forSynthesis, bool forSimulation);
  const AnalyseOrder::IncludeDirectory* Add(AnalyseOrder::IncludeDirectory directory);
  // Adds a core that is included, with what it adds up to if that is known. What stands in the
  // order already is given while the logger is on.
  AnalyseOrder::Known Add(const OrderPart& core, std::optional<AnalyseOrder> sum);

  OrderPart& GetPart() { return part; }
  const OrderPart& GetPart() const { return part; }
  // What it adds up to if that was worked out.
  std::optional<AnalyseOrder> TakeSum() { return std::exchange(sum, std::nullopt); }
  // The order of the root.
  AnalyseOrder TakeOrder();

 private:
  template <class AddTo>
  auto AddOwn(const AddTo& add);
  AnalyseOrder& GetSum();

  OrderAnalysis& analysis;
  bool isOutermost;
  OrderPart& part;
  std::optional<AnalyseOrder> sum;
};

}  // namespace Tarvo

#endif
