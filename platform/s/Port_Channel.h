#ifndef PORT_CHANNEL_H
#define PORT_CHANNEL_H

#include <array>
#include <atomic>
#include <cstddef>
#include <functional>
#include <memory>
#include <mutex>
#include <new>
#include <utility>

namespace Port {

// One lock for all channels: a message handler may write a trace while a trace's sink issues a
// message in another thread, and two locks would then wait for each other. Never destroyed, since
// messages and traces may come while the program ends.
inline std::recursive_mutex& ChannelLock() {
  alignas(std::recursive_mutex) static std::array<std::byte, sizeof(std::recursive_mutex)> place;
  static auto* const mutex = new (place.data()) std::recursive_mutex;
  return *mutex;
}

// A function that may be exchanged while others call it, from any thread. Calls from several
// threads don't overlap, and when an exchange returns, no other thread is still inside the function
// that stood before. The function may call and exchange it itself, hence the shared ownership.
template <class Argument>
class Channel {
 public:
  using Function = std::function<void(const Argument&)>;

  // If it throws, the function that stood before still stands.
  void Set(Function function) {
    auto next = function ? std::make_shared<const Function>(std::move(function)) : nullptr;
    const std::lock_guard<std::recursive_mutex> lock(ChannelLock());
    current.swap(next);
    set = current != nullptr;
  }

  // The same, and gives the one that stood before.
  Function Exchange(Function function) {
    const std::lock_guard<std::recursive_mutex> lock(ChannelLock());
    Function previous = current ? *current : Function();
    Set(std::move(function));
    return previous;
  }

  bool IsSet() const noexcept { return set; }

  // False if no function stands. What the function throws passes.
  bool Call(const Argument& argument) {
    const std::lock_guard<std::recursive_mutex> lock(ChannelLock());
    const std::shared_ptr<const Function> function = current;
    if (function) (*function)(argument);
    return function != nullptr;
  }

 private:
  std::atomic<bool> set{false};
  std::shared_ptr<const Function> current;
};

}  // namespace Port

#endif
