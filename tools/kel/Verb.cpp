// What several verbs need: words of the command line, keys and patterns, the opened core.

#include "Verb.h"

#include <fnmatch.h>

#include <algorithm>
#include <sstream>

#include "Suggestions.h"
#include "Text.h"

using Tarvo::Kel_Key;
using Tarvo::KelIP;
using Tarvo::KelLibrary;
using Tarvo::StringBase;

namespace {

// Cores by name, and the versions of a core from the newest down. Of versions that are equal but
// for zeros, the one that the library answers for comes first.
bool ComesBefore(const KelLibrary& library, const Kel_Key& left, const Kel_Key& right) {
  if (left.GetName() != right.GetName()) return left.GetName() < right.GetName();
  if (left < right || right < left) return right < left;
  return left != right && left.GetKey() == library.GetLatestIPKey(left.GetName());
}

}  // namespace

std::string PairFault(const std::string& pair) {
  const std::size_t equals = pair.find('=');
  const bool isGood = equals != std::string::npos && equals > 0;
  return isGood ? "" : "'" + pair + "' is not NAME=VALUE";
}

std::vector<std::string> NamesOf(const Choices& choices) {
  std::vector<std::string> names;
  for (const Choice& choice : choices) names.push_back(choice.name);
  return names;
}

Word KeyWord() {
  return {.name = "KEY",
          .help = "A key such as abc_v1_00_a, or a core's bare name for its newest version",
          .isRequired = true};
}

Word GlobWord() {
  return {.name = "GLOB", .help = "A key or name, in which * ? [...] stand for any text"};
}

Word RelativeToWord() {
  return {
      .name = "--relative-to", .value = "DIR", .help = "Write paths relative to this directory"};
}

Word SetWord(const char* help) {
  return {
      .name = "--set", .value = "NAME=VALUE", .help = help, .isRepeated = true, .fault = PairFault};
}

Word NullWord() {
  return {.letter = "-0", .name = "--null", .help = "Write only paths, each with a NUL behind it"};
}

Word Repeated(Word word) {
  word.isRepeated = true;
  return word;
}

bool MatchesAny(const Kel_Key& key, const std::vector<std::string>& globs) {
  for (const std::string& glob : globs) {
    for (const StringBase* text : {&key.GetKey(), &key.GetName()}) {
      if (::fnmatch(glob.c_str(), text->GetText(), 0) == 0) return true;
    }
  }
  return globs.empty();
}

std::vector<Kel_Key> SortedKeys(const KelLibrary& library) {
  Tarvo::StringList texts;
  library.ListAllIPKeys(texts);
  std::vector<Kel_Key> keys(texts.begin(), texts.end());
  std::stable_sort(keys.begin(), keys.end(), [&](const Kel_Key& left, const Kel_Key& right) {
    return ComesBefore(library, left, right);
  });
  return keys;
}

std::vector<Setting> SettingsOf(const Request& request) {
  std::vector<Setting> settings;
  for (const std::string& text : request.Values("--set")) {
    const std::size_t equals = text.find('=');
    settings.push_back({text.substr(0, equals), text.substr(equals + 1)});
  }
  return settings;
}

std::unique_ptr<KelIP> OpenCore(const KelLibrary& library, const std::string& key) {
  std::unique_ptr<KelIP> ip(library.CreateIP(key.c_str()));
  if (!ip) SuggestKeys(library, key);
  return ip;
}

bool HasNoneByStyle(const KelIP& ip, const char* what, int errors) {
  // False without an error is how the library says that the style has none.
  if (Messages::ErrorCount() != errors) return false;
  StringBase style;
  ip.GetIPProperty(KelIP::KEL_STYLE_OPTION_NAME, style);
  Messages::Note(Text(ip.GetKey()) + " has no " + what + " because its STYLE is '" + Text(style) +
                 "'");
  return true;
}

std::vector<std::string> Repositories(const Request& request) {
  std::vector<std::string> repositories;
  for (const std::string& path : request.Values("--library")) {
    std::istringstream pieces(path);
    for (std::string piece; std::getline(pieces, piece, ';');) {
      if (!piece.empty()) repositories.push_back(piece);
    }
  }
  return repositories;
}
