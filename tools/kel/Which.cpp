// The verb `which`: what a key or a bare name stands for. Each is answered by itself, so that one
// that is unknown costs the others nothing.

#include "Suggestions.h"
#include "Text.h"
#include "Verb.h"

namespace {

using Tarvo::StringBase;

// A key is shown in its normal spelling also if it was given in capitals.
StringBase Resolve(const Tarvo::KelLibrary& library, const StringBase& text) {
  const Tarvo::Kel_Key key(text);
  return key.IsValid() ? key.GetKey() : library.GetLatestIPKey(text);
}

// The location is asked for first: one message for an unknown key is enough.
Status Which(const Tarvo::KelLibrary& library, const Request& request) {
  Json cores = Json::array();
  for (const std::string& asked : request.Values("KEY")) {
    const StringBase text = asked.c_str();
    const std::string location = Text(library.GetLocation(text));
    if (location.empty()) {
      SuggestKeys(library, asked);
      continue;
    }
    cores.push_back({{"asked", asked},
                     {"key", Text(Resolve(library, text))},
                     {"name", Text(library.GetName(text))},
                     {"version", Text(library.GetVersion(text))},
                     {"location", location}});
  }
  WriteAnswer(request, {{"cores", cores}}, TableOf(cores, {"key", "name", "version", "location"}));
  return cores.size() == request.Values("KEY").size() ? StatusClean : StatusFindings;
}

}  // namespace

Verb DescribeWhich() {
  return {.name = "which",
          .help = "Tells key, name, version and location of each core",
          .words = {Repeated(KeyWord()), NullWord()},
          .example = "which word_fifo pulse_counter_v1_00_a",
          .answer = Which};
}
