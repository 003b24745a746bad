#include <algorithm>

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

std::vector<Kel_Key> Versions(const KelLibrary& library, const std::vector<std::string>& globs) {
  StringList texts;
  library.ListAllIPKeys(texts);
  std::vector<Kel_Key> keys;
  for (const StringBase& text : texts) {
    const Kel_Key key(text);
    if (MatchesAny(key, globs)) keys.push_back(key);
  }
  std::stable_sort(keys.begin(), keys.end(), [&](const Kel_Key& left, const Kel_Key& right) {
    return ComesBefore(library, left, right);
  });
  return keys;
}

}  // namespace

Status List(const KelLibrary& library, const Call& call) {
  Table table;
  Json cores = Json::array();
  StringBase core;
  std::vector<std::string> globs;
  if (!call.key.empty()) globs.push_back(call.key);
  for (const Kel_Key& key : Versions(library, globs)) {
    const bool newest = key.GetName() != core;
    core = key.GetName();
    if (!newest && !call.allVersions) continue;
    const StringBase& text = key.GetKey();
    const std::string location = Text(library.GetLocation(text));
    const std::string style = Option(library, text, "STYLE");
    const std::string language = Option(library, text, "HDL");
    const std::string description = Option(library, text, "DESC");
    table.Add({Text(text), style, language, location, description});
    cores.push_back({{"key", Text(text)},
                     {"name", Text(key.GetName())},
                     {"version", Text(key.GetVersion())},
                     {"style", style},
                     {"language", language},
                     {"location", location},
                     {"description", description}});
  }
  WriteAnswer(table, {{"cores", cores}}, call.asJson);
  if (core.GetLength() > 0 || globs.empty()) return StatusClean;
  Messages::Note("no core matches '" + call.key + "'");
  return StatusFindings;
}
