#ifndef KEL_MESSAGES_H
#define KEL_MESSAGES_H

// The library's messages, as the command shows them. Standard output is for data alone, so they go
// to standard error: the first line behind its severity, and what it wraps indented below.
namespace Messages {

// Shows messages from here on.
void Install();

// The number of errors so far, fatal ones included.
int ErrorCount();

}  // namespace Messages

#endif
