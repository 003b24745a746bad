#ifndef KEL_ARGUMENTS_H
#define KEL_ARGUMENTS_H

#include <optional>

#include "Call.h"
#include "Status.h"

// Reads the words of a call. If there is nothing to run, because help was asked for or there is a
// usage error, that was written, and `status` is what to end with.
std::optional<Call> ReadCall(int argc, char** argv, Status& status);

#endif
