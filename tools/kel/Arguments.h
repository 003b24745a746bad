#ifndef KEL_ARGUMENTS_H
#define KEL_ARGUMENTS_H

#include <optional>

#include "Verb.h"

// The options that may stand before and behind every verb.
const std::vector<Word>& CommonOptions();

// Reads a command line. If there is nothing to run, because help was asked for or there is a usage
// error, that was written, and `status` is what to end with.
std::optional<Request> ReadRequest(const std::vector<std::string>& words, Status& status);

// What a command line asks for that may be wrong, or end too early.
Request GuessRequest(const std::vector<std::string>& words);

// The help of a verb, or of the command if there is no such verb.
std::string HelpText(const std::string& verb);

// Writes what is wrong with a command line, and where the help is.
Status Refuse(const std::string& fault, const std::string& verb);

// For shells: writes what may stand in place of the last word, one on a line, and behind a tab what
// it is. A line ":directory" has the shell complete one, behind the text that follows the tab.
Status Complete(const std::vector<std::string>& words);

#endif
