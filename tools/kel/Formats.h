#ifndef KEL_FORMATS_H
#define KEL_FORMATS_H

#include <string>
#include <vector>

#include "Verb.h"

// How the sources of a core are written for the tools that read them.
// Every format keeps the order, and the libraries where it can say them. Those for one language
// leave out the sources of the other.
Choices SourceFormats();

struct Source {
  std::string path;
  std::string library;   // its key
  std::string language;  // VHDL, Verilog or empty
};

struct IncludeDirectory {
  std::string path;      // as it is to be written
  std::string location;  // absolute
};

struct SourceList {
  std::string key;
  std::string purpose;
  std::vector<Source> sources;
  std::vector<IncludeDirectory> includeDirectories;
};

// Writes to standard output, in one of those formats, and notes what the format leaves out. A
// terminal is shown control characters as \xNN; a file or pipe gets each byte of a name.
void WriteSources(const SourceList& list, const std::string& format);

#endif
