#ifndef KEL_SARIF_H
#define KEL_SARIF_H

#include <string>
#include <vector>

#include "Answer.h"
#include "Tarvo_KelDiagnostic.h"

// Diagnostics as a SARIF 2.1.0 log of one run, with all codes as its rules. Files below the
// directory are relative to it. A finding's fingerprint stays when its line moves.
Json SarifLog(const std::vector<Tarvo::KelDiagnostic>& found, const std::string& directory);

#endif
