#ifndef KEL_FORMATS_H
#define KEL_FORMATS_H

#include "SourceList.h"

// How sources are written for the tools that read them.
// Every format keeps the order, and the libraries where it can say them. Those for one language
// leave out the sources of the other.
Choices SourceFormats();

// Writes to standard output, in one of those formats. Nothing is written, with an error, if the
// format has no room for any of the sources, or can't hold a path. What else it leaves out is a
// warning, unless `isMeant`. A terminal is shown control characters as \xNN; a file or pipe gets
// each byte of a name.
Status WriteSources(const SourceList& list, const std::string& format, bool isMeant);

#endif
