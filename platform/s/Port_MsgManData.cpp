// Messages must come through when memory has run out, while the program ends, and when a handler
// throws. So nothing on their way needs the heap unless a text is long.

#include "Port_MsgManData.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdio>
#include <cstring>
#include <memory>
#include <new>
#include <string_view>
#include <utility>

#include "Port_Channel.h"
#include "Port_Input.h"

namespace {

using MessageChannel = Port::Channel<Port_Message>;

// Never destroyed, like its lock, and made without the heap: messages may come when memory has run
// out.
MessageChannel& Messages() {
  alignas(MessageChannel) static std::array<std::byte, sizeof(MessageChannel)> place;
  static auto* const channel = new (place.data()) MessageChannel;
  return *channel;
}

const char* NameOf(Port_Message::Severity severity) {
  switch (severity) {
    case Port_Message::Warning:
      return "warning";
    case Port_Message::Error:
      return "error";
    case Port_Message::Fatal:
      return "fatal error";
  }
  return "message";
}

void WriteToStandardError(const Port_Message& message) {
  static_cast<void>(std::fprintf(stderr, "%s: %s", NameOf(message.severity), message.text));
}

// A formatted text that needs the heap only when it is long, and that is cut short when the heap
// has no room for it.
class Text {
 public:
  Text(const char* format, std::va_list arguments) noexcept PORT_PRINTF(2, 0) {
    std::va_list again;
    // A list of arguments can be read once.
    va_copy(again, arguments);
    const int length = std::vsnprintf(brief.data(), brief.size(), format, arguments);
    if (length < 0 || static_cast<std::size_t>(length) >= brief.size()) {
      FormatWhole(length, format, again);
    }
    va_end(again);
  }

  const char* Get() const noexcept { return whole ? whole.get() : brief.data(); }

 private:
  // A negative length means more than printf can count.
  void FormatWhole(int length, const char* format, std::va_list arguments) noexcept
      PORT_PRINTF(3, 0) {
    const std::size_t size = static_cast<std::size_t>(std::max(length, 0)) + 1;
    if (length > 0) whole.reset(new (std::nothrow) char[size]);
    if (whole) {
      static_cast<void>(std::vsnprintf(whole.get(), size, format, arguments));
    } else {
      MarkAsCut();
    }
  }

  void MarkAsCut() noexcept {
    constexpr std::string_view mark = " ...\n";
    const std::size_t end = std::min(std::strlen(brief.data()), brief.size() - mark.size() - 1);
    std::memcpy(brief.data() + end, mark.data(), mark.size() + 1);
  }

  std::array<char, 1024> brief{};
  std::unique_ptr<char[]> whole;
};

}  // namespace

Port_MsgManData& Port_MsgManData::createObject(const char* domain, const char* file, int line,
                                               const char* revision) noexcept {
  // One for each thread, since making a message and issuing it are two calls.
  thread_local Port_MsgManData object;
  const Port_Input* const input = Port_Input::GetCurrent();
  object.message = {
      Port_Message::Error,         domain, file, line, revision, "", input ? input->GetFile() : "",
      input ? input->GetLine() : 0};
  return object;
}

void Port_MsgManData::Issue(Port_Message::Severity severity, const char* format,
                            std::va_list arguments) noexcept {
  const Text text(format, arguments);
  Port_Message issued = message;
  issued.severity = severity;
  issued.text = text.Get();
  try {
    if (Messages().Call(issued)) return;
  } catch (...) {
    // What the handler could not take must not be lost.
  }
  WriteToStandardError(issued);
}

void Port_MsgManData::issueWarning(const char* format, ...) noexcept {
  std::va_list arguments;
  va_start(arguments, format);
  Issue(Port_Message::Warning, format, arguments);
  va_end(arguments);
}

void Port_MsgManData::issueError(const char* format, ...) noexcept {
  std::va_list arguments;
  va_start(arguments, format);
  Issue(Port_Message::Error, format, arguments);
  va_end(arguments);
}

void Port_MsgManData::issueFatal(int /*code*/, const char* format, ...) noexcept {
  std::va_list arguments;
  va_start(arguments, format);
  Issue(Port_Message::Fatal, format, arguments);
  va_end(arguments);
}

Port_MsgManData::Handler Port_MsgManData::setHandler(Handler handler) {
  return Messages().Exchange(std::move(handler));
}
