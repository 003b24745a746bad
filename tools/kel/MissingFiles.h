#ifndef KEL_MISSINGFILES_H
#define KEL_MISSINGFILES_H

#include "SourceList.h"

// The sources and data files that do not exist, as they are to be written, in the order of the
// list.
std::vector<std::string> MissingFiles(const SourceList& list);

#endif
