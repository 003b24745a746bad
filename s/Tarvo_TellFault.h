#ifndef TARVO_TELLFAULT_H
#define TARVO_TELLFAULT_H

#include <string_view>
#include <utility>

#include "Tarvo_AppException.h"
#include "Tarvo_Diagnosis.h"
#include "Tarvo_Existence.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_LineFault.h"

namespace Tarvo {

// Where a part of the present line stands.
inline Diagnosis::Span SpanOf(const FileScanner& lines, std::string_view part) {
  return {lines.GetColumn(part), static_cast<unsigned>(part.size())};
}

// What is wrong with the present line, as a diagnostic. The hint tells of a "#" that has cut it.
KelDiagnostic TellFault(const KelDiagnosticCode& code, const FileScanner& lines,
                        const LineFault& fault);

// Warns if the comment of the present line, which is good without it, is probably the rest of a
// value.
void TellCut(const FileScanner& lines, std::string_view line);

// Reads a data file of a core that was looked for. One that can't be read is told, with the code
// for a missing one where that is what is wrong; the exception passes.
inline FileScanner ScanFile(const Port::FileName& file, Port::FoundFile found,
                            const KelDiagnosticCode& missing) {
  try {
    return {file, std::move(found)};
  } catch (AppException& exception) {
    Diagnosis::Add([&] {
      return MayExist(file)
                 ? Diagnosis::Of(Codes::kUnreadable, file.GetName(), "the file can't be read")
                 : Diagnosis::Of(missing, file.GetName(), "the file does not exist");
    });
    exception.told = true;
    throw;
  }
}

inline FileScanner ScanFile(const Port::FileName& file, const KelDiagnosticCode& missing) {
  return ScanFile(file, Port::FoundFile(file.GetName()), missing);
}

}  // namespace Tarvo

#endif
