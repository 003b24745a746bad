#ifndef KEL_NETLISTTABLE_H
#define KEL_NETLISTTABLE_H

#include <string>
#include <vector>

#include "Port_FileName.h"
#include "Tarvo_KelIP.h"

// The whole table of a core's netlists, a row for each line of its file, found by asking the
// instance at each combination of values that the file names.
struct NetlistTable {
  struct Row {
    unsigned line;
    std::vector<std::string> values;
    std::vector<std::string> netlists;
    std::vector<std::string> ignored;  // words behind the end of the list
    bool applies;                      // at the values that the parameters had
  };

  std::vector<std::string> parameters;
  std::vector<Row> rows;
};

// Leaves the instance's parameters as they were. The table is empty if the core's file can't be
// read, which the instance itself reports.
NetlistTable ReadNetlistTable(Tarvo::KelIP& ip);

// The name of one of a core's data files, with its directory.
Port::FileName DataFile(const Tarvo::KelIP& ip, const Tarvo::StringBase& extension);

#endif
