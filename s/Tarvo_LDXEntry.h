#ifndef TARVO_LDXENTRY_H
#define TARVO_LDXENTRY_H

#include <string_view>

#include "Tarvo_Export.h"
#include "Tarvo_LineFault.h"

namespace Tarvo {

// An entry of an analyse order, as its line states it. Quotes or brackets make one field of several
// words:
//
//     lib LIBRARY FILE [LANGUAGE]        a source for both lists; synlib and simlib for one of them
//     lib LIBRARY all                    all that the library's own file lists
//     vlgincdir LIBRARY DIRECTORY        the library's Verilog include directory
//
// All texts are views of the line.
struct LDXEntry {
  enum Kind { File, WholeLibrary, IncludeDirectory, Ignored };

  Kind kind = File;
  std::string_view keyword;
  bool forSynthesis = false;
  bool forSimulation = false;
  std::string_view library;
  std::string_view name;      // the file or the directory
  std::string_view language;  // empty if the entry gives none
  std::string_view rest;      // behind a directory, or all of an ignored line
};

// The words that entries begin with.
StringList LDXKeywords();

// Reads an entry. False for a line of another form, with the first thing that is wrong with it; its
// kind then tells whether it was tried as one for a directory.
bool ReadLDXEntry(std::string_view line, LDXEntry& entry, LineFault& fault);

}  // namespace Tarvo

#endif
