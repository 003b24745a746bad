#ifndef KEL_LIBRARYNAMES_H
#define KEL_LIBRARYNAMES_H

#include "CoreOptions.h"
#include "SourceList.h"

// Gives each source the logical name of its library: what the command line says of its core, or
// else what --library-names says that names come from. False, with an error, if two versions of a
// core would be one library, or if the command line names a core that has no source here.
bool NameLibraries(const CoreOptions& options, const Request& request, SourceList& list);

#endif
