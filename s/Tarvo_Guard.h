#ifndef TARVO_GUARD_H
#define TARVO_GUARD_H

#include <array>
#include <cstddef>
#include <exception>
#include <string_view>
#include <tuple>
#include <type_traits>
#include <vector>

#include "Tarvo_KelRecords.h"
#include "Tarvo_Report.h"

// The boundary of the exported operations: nothing thrown behind it reaches a caller. Each guarded
// operation is one row of an output, a failure and the work:
//
//     return Guard(list, Failure(kModule, "Unable to list ports for IP %s\n%s\n", key),
//                  [&] { list = parser.ListPorts(); });
namespace Tarvo {

// What a failure's literal ends in; its "%s" stands for the text of the exception.
constexpr std::string_view kFailureTail = "\n%s\n";

// What becomes of that tail when something arrives that has no text.
enum class ForUnknown {
  SaySo,     // ", unknown exception\n"
  CutOff,    // "\n"
  EmptyText  // the tail with an empty text
};

// How severe the message is for what has a text. For what has none it is always an error.
enum class Severity {
  Error,
  Warning,
  ErrorOrFatal  // fatal for an AppException of that level
};

inline Port_Message::Severity SeverityFor(const AppException* exception, Severity severity) {
  if (severity == Severity::Warning) return Port_Message::Warning;
  const bool fatal = severity == Severity::ErrorOrFatal && exception != nullptr &&
                     exception->level == AppException::Fatal;
  return fatal ? Port_Message::Fatal : Port_Message::Error;
}

// A literal for these arguments and the tail, and the line it stands at.
template <class... Arguments>
struct FailureFormat {
  static constexpr std::size_t kLongest = 128;

  template <std::size_t Size>
  consteval FailureFormat(const char (&literal)[Size], int sourceLine = __builtin_LINE())
      : whole(literal, sourceLine) {
    static_assert(Size <= kLongest);
    if (!std::string_view(literal).ends_with(kFailureTail)) throw "a failure ends in its tail";
  }

  Report::Format<Arguments..., const char*> whole;
};

// What an operation reports when it fails. Refers to its arguments, so it lives no longer than the
// statement that makes it.
template <class... Arguments>
class Failure {
 public:
  Failure(const Report::Module& issuer, FailureFormat<std::type_identity_t<Arguments>...> literal,
          const Arguments&... values)
      : module(issuer), format(literal.whole), arguments(values...) {}

  // The same failure with another form for what has no text, or with another severity.
  Failure With(ForUnknown form) const {
    Failure copy = *this;
    copy.forUnknown = form;
    return copy;
  }
  Failure With(Severity other) const {
    Failure copy = *this;
    copy.severity = other;
    return copy;
  }

  void Issue(const std::exception& exception) const noexcept {
    const auto* const own = dynamic_cast<const AppException*>(&exception);
    IssueText(SeverityFor(own, severity), own != nullptr && own->told, format.text,
              exception.what());
  }

  void IssueUnknown() const noexcept {
    if (forUnknown == ForUnknown::EmptyText) {
      return IssueText(Port_Message::Error, false, format.text, "");
    }
    constexpr std::string_view unknown = ", unknown exception\n";
    const std::string_view tail = forUnknown == ForUnknown::CutOff ? "\n" : unknown;
    const std::string_view whole = format.text;
    const std::string_view head = whole.substr(0, whole.size() - kFailureTail.size());
    std::array<char, FailureFormat<Arguments...>::kLongest + unknown.size()> companion{};
    tail.copy(companion.data() + head.copy(companion.data(), head.size()), tail.size());
    IssueText(Port_Message::Error, false, companion.data());
  }

 private:
  // What was not told where it was found is told as a failure of this operation.
  template <class... Last>
  void IssueText(Port_Message::Severity issued, bool told, const char* text,
                 const Last&... last) const noexcept {
    std::apply(
        [&](const auto&... values) {
          if (!told) {
            Diagnosis::Add([&] {
              return Diagnosis::Failed(issued == Port_Message::Warning,
                                       Report::TextOf(text, values..., last...));
            });
          }
          module.IssueAt(issued, format.line, text, values..., last...);
        },
        arguments);
  }

  const Report::Module& module;
  Report::Format<Arguments..., const char*> format;
  std::tuple<const Arguments&...> arguments;
  ForUnknown forUnknown = ForUnknown::SaySo;
  Severity severity = Severity::Error;
};

// Outputs of guarded operations, and how they are cleared.
struct NoOutput {};
inline void Clear(NoOutput /*none*/) noexcept {}
inline void Clear(StringBase& text) noexcept { text.Empty(); }
template <class Element>
void Clear(std::vector<Element>& list) noexcept {
  list.clear();
}
inline void Clear(KelNetlistTable& table) noexcept {
  table.parameters.clear();
  table.rows.clear();
}

// Does the work, which sets the output as its last step. If it throws, issues the failure. True
// when the work came to its end, or what it returned if it returns a bool; else the output is
// cleared. The output is cleared behind the message, not before the work: an argument may lie
// within it, as in `library.ListIPProperties(list[0], list)`.
template <class Output, class FailureType, class Work>
bool Guard(Output&& output, const FailureType& failure, const Work& work) noexcept {
  try {
    if constexpr (std::is_same_v<decltype(work()), bool>) {
      if (work()) return true;
    } else {
      work();
      return true;
    }
  } catch (const std::exception& exception) {
    failure.Issue(exception);
  } catch (...) {
    failure.IssueUnknown();
  }
  Clear(output);
  return false;
}

// The text that the work gives, or the empty text with the failure issued.
template <class FailureType, class Work>
StringBase GuardText(const FailureType& failure, const Work& work) noexcept {
  StringBase text;
  Guard(text, failure, [&] { text = work(); });
  return text;
}

}  // namespace Tarvo

#endif
