#ifndef TARVO_TEWLINE_H
#define TARVO_TEWLINE_H

#include <cstddef>
#include <string_view>
#include <vector>

#include "Tarvo_Export.h"
#include "Tarvo_LineFault.h"

// The lines of a netlist table: a header that names parameters, and rows with a value for each
// of them and netlists. Values may be quoted.
//
//     MODE WIDTH FILES
//     fast 32    a.edn, b.edn
//     fast 64    OTHER_CORE:c.edn
//
// All views are parts of the line.
namespace Tarvo::TEWLine {

struct Header {
  std::vector<std::string_view> names;
  bool isEnded = false;  // by the word FILES
};

// Reads what may be a header. False for a line that states nothing: it is empty, or begins with a
// quote that is not closed.
bool ReadHeader(std::string_view line, Header& header, LineFault& fault);

struct Row {
  std::vector<std::string_view> values;
  std::vector<std::string_view> netlists;
  std::string_view rest;  // behind the last netlist; mostly empty
};

// What became of a line. One that states nothing begins with a quote that is not closed.
enum Result { Read, StatesNothing, Unparsable };

// Reads a row with so many values; a comma between values is a value itself. Of a line that can't
// be read, what stands in front of the fault is there.
Result ReadRow(std::string_view line, std::size_t columns, Row& row, LineFault& fault);

// A netlist, NAME or LIBRARY:NAME, cut at its first colon. Without one there is no library.
struct Netlist {
  bool hasLibrary;
  std::string_view library;
  std::string_view name;
};
Netlist SplitNetlist(std::string_view text);

}  // namespace Tarvo::TEWLine

#endif
