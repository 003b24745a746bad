#ifndef KEL_SOURCELIST_H
#define KEL_SOURCELIST_H

#include <optional>
#include <string>
#include <vector>

#include "Verb.h"

struct Source {
  std::string path;      // as it is to be written
  std::string location;  // absolute
  std::string key;       // of the core that it belongs to
  std::string library;   // the logical name, under which it is compiled
  std::string language;  // VHDL, Verilog, SystemVerilog or empty
  std::string standard;  // of VHDL: 93, 02, 08, 19, or empty if nobody says
};

// A directory or file, as it is to be written and absolute.
struct Place {
  std::string path;
  std::string location;
};

// What is asked of `sources`, for the formats to write.
struct SourceList {
  std::vector<std::string> keys;  // of the cores that are asked for; the first one is the main one
  std::string purpose;
  std::string top;              // the unit that is elaborated
  bool isTopGiven;              // by the command line or an option, not only by the core's name
  std::string topLibrary;       // the logical name of the main core's library
  std::vector<Source> sources;  // each once, in analyse order
  std::vector<Place> includeDirectories;
  std::vector<Place> dataFiles;
  std::vector<Setting> parameters;  // of the top
  bool hasRun;                      // whether a script is to run the top
  std::string tool;                 // that a flow is for, or empty
};

// Of one language; every source that is Verilog or SystemVerilog counts as Verilog.
bool IsVhdl(const Source& source);
bool IsVerilog(const Source& source);

// The keys of the cores that have a source, in the order in which each has its first one.
std::vector<std::string> CoresOf(const SourceList& list);

// A library by its logical name, with its sources.
struct Library {
  std::string name;
  std::vector<const Source*> sources;
};

// The libraries, in the order in which each has its first source. They are good while the list is.
std::vector<Library> LibrariesOf(const SourceList& list);

// The values of the words that say how the list is made.
Choices LibraryNamings();
Choices VhdlStandards();
Choices Languages();
Choices Benches();
Choices FlowTools();

// The list for a request of `sources`. None if a core can't be opened or asked, or if the request
// does not fit it; then an error was issued.
std::optional<SourceList> MakeSourceList(const Tarvo::KelLibrary& library, const Request& request);

#endif
