#ifndef KEL_LINT_H
#define KEL_LINT_H

#include <string>

#include "Call.h"
#include "Findings.h"
#include "Port_FileName.h"
#include "Tarvo_KelIP.h"

// Warnings of what the library passes over without a word, though whoever wrote it hardly meant it.

// In a core's description: words that are nearly keywords, what stands behind the end of a list,
// a second declaration of one name, interfaces that are not declared, and options with a value that
// means nothing.
void LintDescription(const Tarvo::KelIP& ip, FindingCollector& findings);

// In an analyse order that could be read: words in the place of a language.
void LintAnalyseOrder(const Port::FileName& file, FindingCollector& findings);

// What is said of a list that ends in front of a word.
std::string ListEndsBefore(const std::string& word);

// Directories of the repositories that look like a core, but for their name.
void LintRepositories(const Call& call, FindingCollector& findings);

#endif
