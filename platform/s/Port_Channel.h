#ifndef PORT_CHANNEL_H
#define PORT_CHANNEL_H

#include <atomic>
#include <functional>
#include <memory>
#include <mutex>
#include <utility>

namespace Port {

// A function that may be exchanged while others call it, from any thread. Calls don't overlap, and
// when Set returns, no other thread is still inside the function that stood before. The function
// may call and set the channel itself, hence the recursive lock and the shared ownership.
template <class Argument>
class Channel {
 public:
  using Function = std::function<void(const Argument&)>;

  Function Set(Function function) {
    auto next = function ? std::make_shared<const Function>(std::move(function)) : nullptr;
    const std::lock_guard<std::recursive_mutex> lock(mutex);
    current.swap(next);
    set = current != nullptr;
    return next ? *next : Function();
  }

  bool IsSet() const noexcept { return set; }

  // False if no function stands. What the function throws passes.
  bool Call(const Argument& argument) {
    const std::lock_guard<std::recursive_mutex> lock(mutex);
    const std::shared_ptr<const Function> function = current;
    if (function) (*function)(argument);
    return function != nullptr;
  }

 private:
  std::recursive_mutex mutex;
  std::atomic<bool> set{false};
  std::shared_ptr<const Function> current;
};

}  // namespace Port

#endif
