#ifndef TARVO_TABLECHECKER_H
#define TARVO_TABLECHECKER_H

#include <vector>

#include "Port_FileName.h"
#include "Tarvo_DescriptionChecker.h"
#include "Tarvo_KelDiagnostic.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

class Kel_Index;

// A netlist that a table lists, and where.
struct ListedNetlist {
  Kel_Key library;
  Port::FileName location;
  KelPlace place;
};

// Tells all that is wrong with the netlist table of a core, to the collector of this thread.
// Gives the netlists that it lists; whether they exist is not looked at.
std::vector<ListedNetlist> CheckTable(const Port::FileName& file, const Kel_Index& index,
                                      const Kel_Key& key, const DescribedCore& core);

}  // namespace Tarvo

#endif
