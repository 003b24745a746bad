// What the library of a core's sources is called where tools compile them. VHDL takes only
// identifiers; a key is nearly always one.

#include "LibraryNames.h"

#include <algorithm>
#include <map>
#include <set>
#include <unordered_map>

#include "Suggestions.h"
#include "Tarvo_KelLibrary_Utils.h"
#include "Text.h"

namespace {

using Tarvo::Kel_Key;
using Tarvo::KelLibrary_Utils;

// Of each core that has a source in a list, by its key.
using Names = std::unordered_map<std::string, std::string>;

std::string BaseName(const std::string& key) { return Text(Kel_Key(key.c_str()).GetName()); }

std::string OwnName(const CoreOptions& options, const std::string& key, const std::string& naming) {
  if (naming == "name") return BaseName(key);
  const std::string stated = naming == "option" ? options.Value(key, "HDL_LIBRARY") : "";
  return stated.empty() ? key : stated;
}

// A bare name stands for all versions that are here.
bool SetName(const std::string& setting, Names& names) {
  const std::size_t equals = setting.find('=');
  const std::string core = setting.substr(0, equals);
  if (equals + 1 == setting.size()) {
    Messages::Error("--hdl-library gives '" + core + "' no name");
    return false;
  }
  std::set<std::string> known;
  bool isSet = false;
  for (auto& [key, name] : names) {
    known.insert({key, BaseName(key)});
    if (core != key && core != BaseName(key)) continue;
    name = setting.substr(equals + 1);
    isSet = true;
  }
  if (isSet) return true;
  Messages::Error("--hdl-library names '" + core + "', which has no sources here" +
                  DidYouMean({known.begin(), known.end()}, core));
  return false;
}

// VHDL knows no letter case, so the first spelling of a name is that of all.
void SpellAlike(const SourceList& list, Names& names) {
  std::unordered_map<std::string, std::string> spellings;
  for (const std::string& key : CoresOf(list)) {
    std::string& name = names[key];
    name = spellings.try_emplace(Lower(name), name).first->second;
  }
}

void TellClash(const std::string& key, const std::string& other, const std::string& name) {
  Messages::Error(key + " and " + other + " would both be the library '" + name +
                  "'. Give one of them another name with --hdl-library KEY=NAME, or call "
                  "libraries by their keys with --library-names key");
}

bool VersionsDiffer(const Names& names) {
  std::map<std::pair<std::string, std::string>, std::string> versions;
  const std::map<std::string, std::string> sorted(names.begin(), names.end());
  for (const auto& [key, name] : sorted) {
    const auto [other, isFirst] = versions.try_emplace({BaseName(key), name}, key);
    if (isFirst) continue;
    TellClash(other->second, key, name);
    return false;
  }
  return true;
}

void TellOddNames(const SourceList& list) {
  for (const Library& library : LibrariesOf(list)) {
    const auto first = std::find_if(library.sources.begin(), library.sources.end(),
                                    [](const Source* source) { return IsVhdl(*source); });
    if (first == library.sources.end()) continue;
    if (KelLibrary_Utils::IsHdlLibrary(library.name.c_str())) continue;
    Messages::Warn("'" + library.name + "' is no name for a library in VHDL, but " + (*first)->key +
                   " would have it. Give it another name with --hdl-library KEY=NAME");
  }
}

}  // namespace

bool NameLibraries(const CoreOptions& options, const Request& request, SourceList& list) {
  const std::string naming = request.Value("--library-names");
  Names names;
  for (const std::string& key : list.keys) names[key] = OwnName(options, key, naming);
  for (const Source& source : list.sources) {
    const auto [name, isNew] = names.try_emplace(source.key);
    if (isNew) name->second = OwnName(options, source.key, naming);
  }
  for (const std::string& setting : request.Values("--hdl-library")) {
    if (!SetName(setting, names)) return false;
  }
  SpellAlike(list, names);
  if (!VersionsDiffer(names)) return false;
  for (Source& source : list.sources) source.library = names[source.key];
  list.topLibrary = names[list.keys.front()];
  TellOddNames(list);
  return true;
}
