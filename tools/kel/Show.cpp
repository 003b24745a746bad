#include <set>

#include "Table.h"
#include "Verbs.h"

// An option that stands twice counts by its first entry, so that one alone is shown.
Status Show(const Tarvo::KelLibrary& library, const std::string& key) {
  Tarvo::StringList names;
  if (!library.ListIPProperties(key.c_str(), names)) return StatusFindings;
  Table table;
  std::set<Tarvo::StringBase> shown;
  for (const Tarvo::StringBase& name : names) {
    if (!shown.insert(name).second) continue;
    Tarvo::StringBase value;
    library.GetIPProperty(key.c_str(), name, value);
    table.Add({name, value});
  }
  table.Write();
  return StatusClean;
}
