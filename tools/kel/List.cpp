// The verb `list`: a row for each core, or each version, whose options can be read. What could not
// be read shows in the exit status.

#include "Text.h"
#include "Verb.h"

namespace {

using Tarvo::Kel_Key;
using Tarvo::KelLibrary;
using Tarvo::StringBase;

std::string Option(const KelLibrary& library, const StringBase& key, const char* name) {
  StringBase value;
  library.GetIPProperty(key, name, value);
  return Text(value);
}

Status List(const KelLibrary& library, const Request& request) {
  Json cores = Json::array();
  StringBase core;
  std::vector<std::string> globs = request.Values("GLOB");
  // An empty pattern is none, as it was left out by a script.
  std::erase(globs, "");
  for (const Kel_Key& key : SortedKeys(library)) {
    if (!MatchesAny(key, globs)) continue;
    // The keys come by name, the newest first.
    const bool isNewest = key.GetName() != core;
    core = key.GetName();
    if (!isNewest && !request.Has("--all")) continue;
    const StringBase& text = key.GetKey();
    cores.push_back({{"key", Text(text)},
                     {"name", Text(key.GetName())},
                     {"version", Text(key.GetVersion())},
                     {"style", Option(library, text, "STYLE")},
                     {"language", Option(library, text, "HDL")},
                     {"location", Text(library.GetLocation(text))},
                     {"description", Option(library, text, "DESC")}});
  }
  WriteAnswer(request, {{"cores", cores}},
              TableOf(cores, {"key", "style", "language", "location", "description"}));
  if (core.GetLength() > 0 || globs.empty()) return StatusClean;
  Messages::Note("no core matches '" + request.Value("GLOB") + "'");
  return StatusFindings;
}

}  // namespace

Verb DescribeList() {
  return {.name = "list",
          .help =
              "Lists the newest version of each core: key, style, language, location, "
              "description",
          .words = {GlobWord(), {.name = "--all", .help = "List every version"}, NullWord()},
          .example = "list 'pulse*' --all",
          .reads = Verb::All,
          .answer = List};
}
