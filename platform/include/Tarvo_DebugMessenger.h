#ifndef TARVO_DEBUGMESSENGER_H
#define TARVO_DEBUGMESSENGER_H

#include <functional>
#include <memory>

#include "Port_Export.h"
#include "Port_StringBase.h"

namespace Tarvo {

// A named logger for traces. Every logger starts off, and is on while it has a sink.
//
// Lifetime: the factory owns all loggers and never destroys one.
// Threads: a logger may be used and its sink exchanged from several threads. Calls of sinks and of
// the message handler from several threads never overlap, and once SetSink has returned in one
// thread, the sink that stood before is no longer running in another. A sink may use loggers and
// issue messages itself, but must not wait for another thread that does.
class PORT_EXPORT DebugMessenger {
 public:
  using Sink = std::function<void(const Port::StringBase<char>&)>;

  DebugMessenger(const DebugMessenger&) = delete;
  DebugMessenger& operator=(const DebugMessenger&) = delete;

  // Ask this before building a text.
  bool IsOff() const noexcept;

  // Hands the text to the sink, or does nothing when there is none. What the sink throws passes.
  void Verbose(const Port::StringBase<char>& text);

  // Sets the sink; an empty one turns the logger off. May throw std::bad_alloc; then
  // the sink that stood before still stands.
  void SetSink(Sink sink);

 private:
  friend class DebugMessengerFactory;
  PORT_LOCAL DebugMessenger();
  PORT_LOCAL ~DebugMessenger();

  struct State;
  std::unique_ptr<State> state;
};

// Gives the loggers by name. May be called from several threads.
class PORT_EXPORT DebugMessengerFactory {
 public:
  // The logger of that name, made at the first call for it. Never null. May throw std::bad_alloc.
  static DebugMessenger* GetLogger(const Port::StringBase<char>& name);

  DebugMessengerFactory() = delete;
};

}  // namespace Tarvo

#endif
