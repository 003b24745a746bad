#include "Which.h"

#include <iostream>

#include "Tarvo_Kel_Key.h"

namespace {

using Tarvo::StringBase;

StringBase Resolve(const Tarvo::KelLibrary& library, const StringBase& text) {
  const Tarvo::Kel_Key key(text);
  return key.IsValid() ? key.GetKey() : library.GetLatestIPKey(text);
}

// The location is asked for first: one message for an unknown key is enough.
bool Show(const Tarvo::KelLibrary& library, const StringBase& text) {
  const StringBase location = library.GetLocation(text);
  if (location.GetLength() == 0) return false;
  std::cout << Resolve(library, text) << '\t' << library.GetName(text) << '\t'
            << library.GetVersion(text) << '\t' << location << '\n';
  return true;
}

}  // namespace

Status Which(const Tarvo::KelLibrary& library, const std::vector<std::string>& keys) {
  bool allFound = true;
  for (const std::string& key : keys) allFound = Show(library, key.c_str()) && allFound;
  return allFound ? StatusClean : StatusFindings;
}
