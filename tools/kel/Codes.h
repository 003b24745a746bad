#ifndef KEL_CODES_H
#define KEL_CODES_H

#include <string>
#include <vector>

#include "Tarvo_KelDiagnostic.h"

// All codes that a diagnostic may have, in the order of the alphabet.
const std::vector<Tarvo::KelDiagnosticCode>& Codes();

// "note", "warning" or "error", as a diagnostic's line and all formats have it.
const char* SeverityWord(Tarvo::KelDiagnostic::Severity severity);

// Writes what a code means to standard output, or for "diagnostics" what all of them do. False for
// any other topic.
bool ShowCodes(const std::string& topic);

#endif
