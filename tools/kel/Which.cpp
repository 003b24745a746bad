#include "Table.h"
#include "Tarvo_Kel_Key.h"
#include "Text.h"
#include "Verbs.h"

namespace {

using Tarvo::StringBase;

StringBase Resolve(const Tarvo::KelLibrary& library, const StringBase& text) {
  const Tarvo::Kel_Key key(text);
  return key.IsValid() ? key.GetKey() : library.GetLatestIPKey(text);
}

// The location is asked for first: one message for an unknown key is enough.
bool Add(Table& table, const Tarvo::KelLibrary& library, const StringBase& text) {
  const StringBase location = library.GetLocation(text);
  if (location.GetLength() == 0) return false;
  table.Add({Text(Resolve(library, text)), Text(library.GetName(text)),
             Text(library.GetVersion(text)), Text(location)});
  return true;
}

}  // namespace

Status Which(const Tarvo::KelLibrary& library, const std::vector<std::string>& keys) {
  Table table;
  bool allFound = true;
  for (const std::string& key : keys) allFound = Add(table, library, key.c_str()) && allFound;
  table.Write();
  return allFound ? StatusClean : StatusFindings;
}
