// Two stacks of each thread meet here: the collectors, which say who wants diagnostics, and the
// inputs (see Port_Input), which say what is being read.

#include "Tarvo_Diagnosis.h"

#include <memory>
#include <string>
#include <utility>

#include "Port_Input.h"

namespace Tarvo {

namespace {

// Each collector remembers the one that it was made in, so that they form a stack.
thread_local DiagnosticCollector* innermost = nullptr;

KelPlace PlaceOf(const Port_Input& input, Diagnosis::Span span = {}) {
  return {input.GetFile(), input.GetLine(), span.column, span.length};
}

// The lines that take in the file of a diagnostic, the nearest first. For a checker the nearest one
// of a file that could not be read at all: each other file is checked for itself.
void AppendIncludes(KelDiagnostic& diagnostic) {
  const Port_Input* input = Port_Input::GetCurrent();
  const bool isRead = input != nullptr && diagnostic.place.file == input->GetFile();
  if (isRead) input = input->GetOuter();
  const bool isWhole = diagnostic.place.line == 0;
  for (; input && (isWhole || !Diagnosis::GoesOn()); input = input->GetOuter()) {
    KelRelatedPlace& outer = diagnostic.related.emplace_back();
    outer.place = PlaceOf(*input);
    outer.text = "taken in from here";
    if (Diagnosis::GoesOn()) return;
  }
}

}  // namespace

DiagnosticCollector::DiagnosticCollector(Mode theMode) noexcept : mode(theMode), outer(innermost) {
  innermost = this;
}

DiagnosticCollector::~DiagnosticCollector() { innermost = outer; }

DiagnosticCollector* DiagnosticCollector::GetCurrent() noexcept { return innermost; }

KelDiagnosticLog::KelDiagnosticLog()
    : collector(std::make_unique<DiagnosticCollector>(DiagnosticCollector::BesideMessages)) {}

KelDiagnosticLog::~KelDiagnosticLog() = default;

std::vector<KelDiagnostic> KelDiagnosticLog::Take() const {
  // Handed over, so that each is taken once.
  return std::exchange(collector->found, {});
}

namespace Diagnosis {

KelPlace Here(Span span) {
  const Port_Input* const input = Port_Input::GetCurrent();
  return input ? PlaceOf(*input, span) : KelPlace();
}

KelDiagnostic At(const KelDiagnosticCode& code, Span span, const StringBase& text,
                 const StringBase& hint) {
  return AtPlace(code, Here(span), text, hint);
}

KelDiagnostic AtPlace(const KelDiagnosticCode& code, const KelPlace& place, const StringBase& text,
                      const StringBase& hint) {
  return {code.severity, code.code, text, hint, place, {}};
}

KelDiagnostic Of(const KelDiagnosticCode& code, const StringBase& file, const StringBase& text,
                 const StringBase& hint) {
  return AtPlace(code, {file, 0, 0, 0}, text, hint);
}

KelDiagnostic Failed(bool isWarning, const StringBase& message) {
  StringBase lines = message;
  // Messages end in a line end, diagnostics don't.
  lines.Trim("\n", StringBase::TrimEnd);
  KelDiagnostic failed = At(Codes::kFailed, {}, lines);
  if (isWarning) failed.severity = KelDiagnostic::Warning;
  return failed;
}

KelDiagnostic With(KelDiagnostic diagnostic, const KelPlace& place, const StringBase& text) {
  diagnostic.related.push_back({place, text});
  return diagnostic;
}

StringBase Say(std::initializer_list<std::string_view> pieces) {
  std::string text;
  for (const std::string_view piece : pieces) text += piece;
  return StringBase(std::string_view(text));
}

bool MayHint() noexcept {
  if (!innermost || innermost->hintsLeft == 0) return false;
  --innermost->hintsLeft;
  return true;
}

bool GoesOn() noexcept {
  return innermost != nullptr && innermost->mode == DiagnosticCollector::InsteadOfMessages;
}

void Keep(KelDiagnostic diagnostic) {
  if (diagnostic.place.file.GetLength() > 0) AppendIncludes(diagnostic);
  innermost->found.push_back(std::move(diagnostic));
}

}  // namespace Diagnosis

}  // namespace Tarvo
