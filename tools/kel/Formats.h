#ifndef KEL_FORMATS_H
#define KEL_FORMATS_H

#include <string>
#include <vector>

// How the sources of a core are written for the tools that read them.
//
//     list       a path on each line
//     json       a document of sources, libraries and include directories
//     f          a file list for Verilog tools: include directories and Verilog sources
//     ghdl       a shell script that analyses the VHDL sources, each into its library
//     edam       a document as flow generators take it: name, files with type and logical library
//     vhdl_ls    the configuration of the VHDL language server
//     tcl        a script that sets a list of sources and one of include directories
//
// Every format keeps the order, and the libraries where it can say them. Those for one language
// leave out the sources of the other.
std::vector<std::string> FormatNames();

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
