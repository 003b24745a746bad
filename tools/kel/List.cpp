#include <algorithm>

#include "Table.h"
#include "Tarvo_Kel_Key.h"
#include "Text.h"
#include "Verbs.h"

namespace {

using Tarvo::Kel_Key;
using Tarvo::KelLibrary;
using Tarvo::StringBase;
using Tarvo::StringList;

std::string Option(const KelLibrary& library, const StringBase& key, const char* name) {
  StringBase value;
  library.GetIPProperty(key, name, value);
  return Text(value);
}

// Cores by name, and the versions of a core from the newest down. Of versions that are equal but
// for zeros, the one that the library answers for comes first.
bool ComesBefore(const KelLibrary& library, const Kel_Key& left, const Kel_Key& right) {
  if (left.GetName() != right.GetName()) return left.GetName() < right.GetName();
  if (left < right || right < left) return right < left;
  return left != right && left.GetKey() == library.GetLatestIPKey(left.GetName());
}

std::vector<Kel_Key> AllVersions(const KelLibrary& library) {
  StringList texts;
  library.ListAllIPKeys(texts);
  std::vector<Kel_Key> keys(texts.begin(), texts.end());
  std::stable_sort(keys.begin(), keys.end(), [&](const Kel_Key& left, const Kel_Key& right) {
    return ComesBefore(library, left, right);
  });
  return keys;
}

}  // namespace

Status List(const KelLibrary& library, bool allVersions) {
  Table table;
  StringBase core;
  for (const Kel_Key& key : AllVersions(library)) {
    const bool newest = table.IsEmpty() || key.GetName() != core;
    core = key.GetName();
    if (!newest && !allVersions) continue;
    const StringBase& text = key.GetKey();
    table.Add({Text(text), Option(library, text, "STYLE"), Option(library, text, "HDL"),
               Text(library.GetLocation(text)), Option(library, text, "DESC")});
  }
  table.Write();
  return StatusClean;
}
