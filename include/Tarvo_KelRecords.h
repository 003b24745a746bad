#ifndef TARVO_KELRECORDS_H
#define TARVO_KELRECORDS_H

#include <vector>

#include "Tarvo_Export.h"
#include "Tarvo_KelDiagnostic.h"
#include "Tarvo_Kel_Key.h"

// What the data files of a core state, with the place of each statement: plain values, which the
// parsers and instances hand out. Threads: like an int.
namespace Tarvo {

// A statement of a core description.
struct KelStatement {
  enum Kind { Option, Parameter, Port, BusInterface, IoInterface };

  Kind kind;
  StringBase name;
  KelPlace place;  // file and line
};

// A source of an analyse order (compile order).
struct KelSource {
  StringBase path;      // absolute
  Kel_Key library;      // as the index has it
  StringBase language;  // what was settled when it was listed, as the entry or the core writes it
  KelPlace place;       // of its name in the entry that lists it
};

// A Verilog include directory of an analyse order.
struct KelIncludeDirectory {
  StringBase library;  // as the entry names it
  StringBase path;     // absolute
  KelPlace place;
};

// An entry that takes over the whole order of another core.
struct KelInclude {
  StringBase library;  // as the entry names it
  Kel_Key core;        // the version that is meant
  KelPlace place;
};

struct KelNetlist {
  StringBase path;  // absolute
  Kel_Key library;
};

// A row of a netlist table.
struct KelNetlistRow {
  StringList values;  // one for each parameter of the table
  std::vector<KelNetlist> netlists;
  StringBase ignored;  // what stands behind the end of the list, and counts for nothing
  bool applies;        // at the values that the parameters have now
  KelPlace place;
};

// A netlist table: the parameters that choose among the rows, and the rows in their order.
struct KelNetlistTable {
  StringList parameters;
  std::vector<KelNetlistRow> rows;
};

}  // namespace Tarvo

#endif
