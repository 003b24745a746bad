#include "Nearby.h"
#include "Text.h"
#include "Verbs.h"

namespace {

using Tarvo::StringBase;

StringBase Resolve(const Tarvo::KelLibrary& library, const StringBase& text) {
  const Tarvo::Kel_Key key(text);
  return key.IsValid() ? key.GetKey() : library.GetLatestIPKey(text);
}

}  // namespace

// The location is asked for first: one message for an unknown key is enough.
Status Which(const Tarvo::KelLibrary& library, const Call& call) {
  Table table;
  Json cores = Json::array();
  for (const std::string& asked : call.keys) {
    const StringBase text = asked.c_str();
    const std::string location = Text(library.GetLocation(text));
    if (location.empty()) {
      SuggestKeys(library, asked);
      continue;
    }
    const std::string key = Text(Resolve(library, text));
    const std::string name = Text(library.GetName(text));
    const std::string version = Text(library.GetVersion(text));
    table.Add({key, name, version, location});
    cores.push_back({{"asked", asked},
                     {"key", key},
                     {"name", name},
                     {"version", version},
                     {"location", location}});
  }
  const bool foundAll = cores.size() == call.keys.size();
  WriteAnswer(table, {{"cores", cores}}, call.asJson);
  return foundAll ? StatusClean : StatusFindings;
}
