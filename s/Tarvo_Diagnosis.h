#ifndef TARVO_DIAGNOSIS_H
#define TARVO_DIAGNOSIS_H

#include <initializer_list>
#include <string_view>
#include <utility>
#include <vector>

#include "Tarvo_DiagnosticCodes.h"
#include "Tarvo_KelDiagnostic.h"

namespace Tarvo {

// Keeps what is found while it lives, innermost of its thread. A checker's one changes how files
// are read: no messages are issued, and the readers go on behind a fault.
class DiagnosticCollector {
 public:
  enum Mode { BesideMessages, InsteadOfMessages };

  explicit DiagnosticCollector(Mode theMode) noexcept;
  ~DiagnosticCollector();
  DiagnosticCollector(const DiagnosticCollector&) = delete;
  DiagnosticCollector& operator=(const DiagnosticCollector&) = delete;

  // The innermost one of this thread, or null.
  static DiagnosticCollector* GetCurrent() noexcept;

  const Mode mode;
  std::vector<KelDiagnostic> found;
  bool isIncomplete = false;
  // How many names may still be compared with all others for a hint. So a file full of unknown
  // names costs no more than it is worth.
  unsigned hintsLeft = 100;

 private:
  DiagnosticCollector* outer;
};

// How readers tell what is wrong, beside the message that they issue for it. Where no collector
// lives, nothing of it is made:
//
//     Diagnosis::Add([&] { return Diagnosis::At(Codes::kBadEntry, span, "missing FILE"); });
namespace Diagnosis {

// A part of the line that is being read; none of its own stands for the whole line.
struct Span {
  unsigned column = 0;
  unsigned length = 0;
};

// A fault at the innermost input (see Port_Input).
KelDiagnostic At(const KelDiagnosticCode& code, Span span, const StringBase& text,
                 const StringBase& hint = {});

// A fault at a place that was read before.
KelDiagnostic AtPlace(const KelDiagnosticCode& code, const KelPlace& place, const StringBase& text,
                      const StringBase& hint = {});

// A fault of a file as a whole, whatever is being read.
KelDiagnostic Of(const KelDiagnosticCode& code, const StringBase& file, const StringBase& text,
                 const StringBase& hint = {});

// The failure of an operation, in the words of its message.
KelDiagnostic Failed(bool isWarning, const StringBase& message);

// The same with a further place.
KelDiagnostic With(KelDiagnostic diagnostic, const KelPlace& place, const StringBase& text);

// The place of the innermost input; none where nothing is read.
KelPlace Here(Span span = {});

// The pieces of a text, put together.
StringBase Say(std::initializer_list<std::string_view> pieces);

// Whether a search for near words is worth its while; each one asked for counts.
bool MayHint() noexcept;

// Whether a reader is to go on behind a fault.
bool GoesOn() noexcept;

// Gives it to the innermost collector. One that stands beside messages also gets the lines that
// take the file in.
void Keep(KelDiagnostic diagnostic);

// What can't be made or kept for lack of memory is left out, and marked: no reading depends on it.
template <class Make>
void Add(const Make& make) noexcept {
  DiagnosticCollector* const collector = DiagnosticCollector::GetCurrent();
  if (!collector) return;
  try {
    Keep(make());
  } catch (...) {
    collector->isIncomplete = true;
  }
}

}  // namespace Diagnosis

}  // namespace Tarvo

#endif
