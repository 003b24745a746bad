#ifndef TARVO_TELLFAULT_H
#define TARVO_TELLFAULT_H

#include <string_view>

#include "Tarvo_Diagnosis.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_LineFault.h"

namespace Tarvo {

// Where a part of the present line stands.
inline Diagnosis::Span SpanOf(const FileScanner& lines, std::string_view part) {
  return {lines.GetColumn(part), static_cast<unsigned>(part.size())};
}

// What is wrong with the present line, as a diagnostic.
inline KelDiagnostic TellFault(const KelDiagnosticCode& code, const FileScanner& lines,
                               const LineFault& fault) {
  return Diagnosis::At(code, SpanOf(lines, fault.where), fault.text);
}

}  // namespace Tarvo

#endif
