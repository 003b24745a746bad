// Loggers are made once for each name and kept for ever; a channel each does the work.

#include "Tarvo_DebugMessenger.h"

#include <mutex>
#include <unordered_map>
#include <utility>

#include "Port_Channel.h"

namespace Tarvo {

using String = Port::StringBase<char>;

struct DebugMessenger::State {
  Port::Channel<String> channel;
};

DebugMessenger::DebugMessenger() : state(std::make_unique<State>()) {}

DebugMessenger::~DebugMessenger() = default;

bool DebugMessenger::IsOff() const noexcept { return !state->channel.IsSet(); }

void DebugMessenger::Verbose(const String& text) { state->channel.Call(text); }

void DebugMessenger::SetSink(Sink sink) { state->channel.Set(std::move(sink)); }

// The loggers are never destroyed, so that traces may come while the program ends.
DebugMessenger* DebugMessengerFactory::GetLogger(const String& name) {
  static std::mutex mutex;
  static auto* const loggers = new std::unordered_map<String, DebugMessenger*>;
  const std::lock_guard<std::mutex> lock(mutex);
  DebugMessenger*& logger = (*loggers)[name];
  if (!logger) logger = new DebugMessenger;
  return logger;
}

}  // namespace Tarvo
