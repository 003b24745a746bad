#ifndef TARVO_REPORT_H
#define TARVO_REPORT_H

#include <cstddef>
#include <iterator>
#include <type_traits>

#include "Port_MsgManData.h"
#include "Tarvo_AppException.h"
#include "Tarvo_DebugMessenger.h"
#include "Tarvo_Diagnosis.h"
#include "Tarvo_Export.h"

// Messages, exceptions and traces in one line each.
//
//     constexpr Report::Module kModule{"s/Tarvo_Kel_Index", "1.0"};
//
//     kModule.Error("Invalid IP index entry %s at %s\n", key.GetKey(), location.GetName());
//     throw Report::Exception(AppException::NotFound, "Cannot find IP key for %s\n", key.GetKey());
//     TARVO_TRACE("Opening File %s\n", name.GetName());
//
// A format is a literal. The compiler refuses one whose conversions don't fit the arguments or that
// doesn't end its line, and remembers the line it stands at.
namespace Tarvo::Report {

constexpr char KindOf(const StringBase* /*text*/) { return 's'; }
constexpr char KindOf(const char* const* /*text*/) { return 's'; }
constexpr char KindOf(const int* /*number*/) { return 'd'; }
constexpr char KindOf(const unsigned* /*number*/) { return 'd'; }

// True if the literal's conversions are `kinds` in that order, and the text ends in a line end.
constexpr bool Fits(const char* literal, const char* kinds) {
  char previous = 0;
  for (; *literal; previous = *literal++) {
    if (*literal != '%') continue;
    ++literal;
    while (*literal >= '0' && *literal <= '9') ++literal;
    if (*literal != *kinds++) return false;
  }
  return *kinds == 0 && previous == '\n';
}

// A literal for arguments of these types, and the line it stands at.
template <class... Arguments>
struct Format {
  template <std::size_t Size>
  consteval Format(const char (&literal)[Size], int sourceLine = __builtin_LINE())
      : text(literal), line(sourceLine) {
    constexpr char kinds[] = {KindOf(static_cast<const Arguments*>(nullptr))..., 0};
    if (!Fits(literal, kinds)) throw "the conversions of a format must fit its arguments";
  }

  const char* text;
  int line;
};

// The format of a call with these arguments, left out of their deduction.
template <class... Arguments>
using FormatFor = Format<std::type_identity_t<Arguments>...>;

inline const char* Raw(const StringBase& text) { return text; }
inline const char* Raw(const char* text) { return text; }
inline int Raw(int number) { return number; }
inline unsigned Raw(unsigned number) { return number; }

// Formats were checked when they were compiled; here the compiler no longer sees a literal.
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wformat-nonliteral"
#pragma GCC diagnostic ignored "-Wformat-security"

inline thread_local unsigned messageCount = 0;

// How many messages the library has issued in this thread; only differences say something.
inline unsigned CountMessages() noexcept { return messageCount; }

// What a source file puts on its messages: its path stem and its revision.
struct Module {
  template <class... Arguments>
  void Warning(FormatFor<Arguments...> format, const Arguments&... arguments) const noexcept {
    IssueAt(Port_Message::Warning, format.line, format.text, arguments...);
  }

  template <class... Arguments>
  void Error(FormatFor<Arguments...> format, const Arguments&... arguments) const noexcept {
    IssueAt(Port_Message::Error, format.line, format.text, arguments...);
  }

  // For a text that was made from a checked format. While a checker reads, nothing is issued.
  template <class... Arguments>
  void IssueAt(Port_Message::Severity severity, int line, const char* text,
               const Arguments&... arguments) const noexcept {
    if (Diagnosis::GoesOn()) return;
    ++messageCount;
    Port_MsgManData& message = Port_MsgManData::createObject("tarvomsg", file, line, revision);
    switch (severity) {
      case Port_Message::Warning:
        return message.issueWarning(text, Raw(arguments)...);
      case Port_Message::Error:
        return message.issueError(text, Raw(arguments)...);
      case Port_Message::Fatal:
        return message.issueFatal(1, text, Raw(arguments)...);
    }
  }

  const char* file;
  const char* revision;
};

// The same for a text.
template <class... Arguments>
StringBase TextOf(const char* text, const Arguments&... arguments) {
  return StringBase::doFormat(text, Raw(arguments)...);
}

#pragma GCC diagnostic pop

template <class... Arguments>
StringBase Text(FormatFor<Arguments...> format, const Arguments&... arguments) {
  return TextOf(format.text, arguments...);
}

template <class... Arguments>
AppException Exception(AppException::Level level, FormatFor<Arguments...> format,
                       const Arguments&... arguments) {
  return {level, Text<Arguments...>(format, arguments...)};
}

// The same for what was told already where it was found: by a message, a diagnostic, or both.
inline AppException Told(AppException exception) {
  exception.told = true;
  return exception;
}

inline DebugMessenger& Logger() {
  static DebugMessenger& logger = *DebugMessengerFactory::GetLogger(kLoggerName);
  return logger;
}

// For what is found out for a trace alone.
inline bool IsTracing() noexcept {
  try {
    return !Logger().IsOff();
  } catch (...) {
    return false;
  }
}

// Nothing else depends on whether the logger is on, so what goes wrong with a trace ends here.
template <class BuildText>
void TraceIfOn(const BuildText& buildText) noexcept {
  if (!IsTracing()) return;
  try {
    const StringBase text = buildText();
    Logger().Verbose(text);
  } catch (...) {
    return;
  }
}

// Evaluates its arguments only while the logger is on, which a function could not.
#define TARVO_TRACE(...) \
  ::Tarvo::Report::TraceIfOn([&] { return ::Tarvo::Report::Text(__VA_ARGS__); })

}  // namespace Tarvo::Report

#endif
