#ifndef KEL_MESSAGES_H
#define KEL_MESSAGES_H

#include <string>

#include "Call.h"

// The library's messages and traces, as the command shows them. Standard output is for data alone,
// so they go to standard error: the first line behind its severity, and what it wraps indented
// below. A message that was shown already, of a core that is opened twice, is not shown again.
namespace Messages {

// Shows messages from here on, as the call asks for.
void Install(const Call& call);

// Shows a trace, if the call asks for traces.
void Trace(const std::string& text);

// The command's own words, which change no status.
void Note(const std::string& text);

// The number of errors so far, fatal ones included.
int ErrorCount();

}  // namespace Messages

#endif
