#include "Lint.h"

#include <algorithm>
#include <filesystem>
#include <set>
#include <string>
#include <vector>

#include "Nearby.h"
#include "NetlistTable.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_KelLibrary_Utils.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_QVRParser.h"
#include "Text.h"
#include "Verbs.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::KelIP;
using Tarvo::QVRParser;
using Tarvo::StringBase;
using Tarvo::StringList;
using Words = std::vector<std::string>;

const char* const kOption = "OPTION";
const char* const kParameter = "PARAMETER";
const char* const kPort = "PORT";
const char* const kKeywords[] = {kOption, kParameter, kPort, "BUS_INTERFACE", "IO_INTERFACE"};

// An option of a few values, one of which should be meant.
struct Choice {
  const char* option;
  Words values;
};
const Choice kChoices[] = {{"STYLE", {"HDL", "BLACKBOX", "MIX"}},
                           {"HDL", {"VHDL", "Verilog", "MIXED", "BOTH"}}};

std::string Upper(std::string word) {
  for (char& c : word) c = c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
  return word;
}

bool Contains(const Words& words, const std::string& word) {
  return std::any_of(words.begin(), words.end(),
                     [&](const std::string& other) { return Upper(other) == Upper(word); });
}

// Where a value is over that begins at this word: behind it, or behind the bracket that closes it.
std::size_t EndOfValue(const Words& words, std::size_t at) {
  const std::string first = words[at].substr(0, 1);
  if (first != "(" && first != "[") return at + 1;
  const char open = first.front();
  const char close = open == '(' ? ')' : ']';
  std::ptrdiff_t depth = 0;
  for (; at < words.size(); ++at) {
    depth += std::count(words[at].begin(), words[at].end(), open) -
             std::count(words[at].begin(), words[at].end(), close);
    if (depth <= 0) return at + 1;
  }
  return at;
}

// What is left of a list of NAME = VALUE with commas between, which ends where none announces more.
Words BehindList(const Words& words) {
  std::size_t at = 1;
  while (at + 2 < words.size() && words[at + 1] == "=") {
    at = EndOfValue(words, at + 2);
    if (at + 1 < words.size() && words[at] == ",") {
      ++at;
      continue;
    }
    return {words.begin() + static_cast<std::ptrdiff_t>(std::min(at, words.size())), words.end()};
  }
  return {};
}

// One description, statement by statement.
class Description {
 public:
  Description(const KelIP& core, FindingCollector& collector)
      : ip(core),
        findings(collector),
        file(DataFile(ip, Tarvo::Kel_Index::KEL_QVR_EXTENSION)),
        name(Text(file.GetName())) {
    ip.ListBusInterfaces(busInterfaces);
    ip.ListIOInterfaces(ioInterfaces);
  }

  void Lint() {
    Tarvo::FileScanner lines(file);
    StringBase line;
    while (lines.GetNextLine(line, number)) {
      const Words words = Fields(line.View(), "=,");
      if (!words.empty()) LintStatement(words, Text(line));
    }
  }

 private:
  void Warn(const std::string& text) { findings.Add({name, number, "warning", text, ""}); }

  void LintStatement(const Words& words, const std::string& line) {
    const std::string& keyword = words[0];
    if (std::find(std::begin(kKeywords), std::end(kKeywords), keyword) == std::end(kKeywords)) {
      LintUnknown(keyword, line);
    } else if (keyword == kOption) {
      LintOption(words);
    } else {
      LintList(words);
    }
  }

  void LintUnknown(const std::string& word, const std::string& line) {
    for (const char* keyword : kKeywords) {
      if (word.size() > 1 && IsNear(keyword, Upper(word))) {
        return Warn("begins with no keyword, near which is " + std::string(keyword) +
                    ", and is ignored: " + line);
      }
    }
  }

  // The first of several values is the one that counts, and that the core answers.
  void LintOption(const Words& words) {
    if (words.size() < 2 || !seen.insert(kOption + words[1]).second) return;
    for (const Choice& choice : kChoices) {
      if (words[1] != choice.option) continue;
      StringBase value;
      ip.GetIPProperty(choice.option, value);
      if (Contains(choice.values, Text(value))) continue;
      Warn("the " + words[1] + " '" + Text(value) + "' is none of " + Join(choice.values));
    }
  }

  void LintList(const Words& words) {
    const bool isElement = words[0] == kPort || words[0] == kParameter;
    if (isElement && words.size() > 1) {
      if (!seen.insert(words[0] + " " + words[1]).second) {
        Warn(words[0] + " " + words[1] + " is declared already, and the first one counts");
      }
      LintInterfaces(words, QVRParser::QVR_BUS_IF_NAME, busInterfaces);
      LintInterfaces(words, QVRParser::QVR_IO_IF_NAME, ioInterfaces);
    }
    const Words rest = BehindList(words);
    if (rest.empty()) return;
    const bool isOpen = rest.size() == 1 && rest[0] == ",";
    Warn(isOpen ? "ends in a comma, and no statement goes on in the next line"
                : ListEndsBefore(rest[0]));
  }

  void LintInterfaces(const Words& words, const StringBase& property, const StringList& declared) {
    for (std::size_t i = 3; i + 2 < words.size(); ++i) {
      if (property != words[i].c_str() || words[i + 1] != "=") continue;
      const StringBase value(words[i + 2].c_str());
      for (const StringBase& interface : Tarvo::KelLibrary_Utils::GetInterfaceVector(value)) {
        if (std::find(declared.begin(), declared.end(), interface) == declared.end()) {
          Warn(words[0] + " " + words[1] + " belongs to the interface " + Text(interface) +
               ", which is not declared");
        }
      }
    }
  }

  const KelIP& ip;
  FindingCollector& findings;
  Port::FileName file;
  std::string name;
  StringList busInterfaces;
  StringList ioInterfaces;
  unsigned number = 0;
  std::set<std::string> seen;
};

}  // namespace

std::string ListEndsBefore(const std::string& word) {
  return "the list is over in front of '" + word + "', with no comma to go on";
}

void LintDescription(const KelIP& ip, FindingCollector& findings) {
  Description(ip, findings).Lint();
}

void LintAnalyseOrder(const Port::FileName& file, FindingCollector& findings) {
  Tarvo::FileScanner lines(file);
  StringBase line;
  for (unsigned number = 0; lines.GetNextLine(line, number);) {
    const Words words = Fields(line.View());
    const bool isEntry = words.size() > 3 && Contains({"lib", "synlib", "simlib"}, words[0]);
    if (!isEntry || Contains({"VHDL", "Verilog"}, words[3])) continue;
    findings.Add(
        {Text(file.GetName()), number, "error", "Unknown HDL language specified: " + words[3], ""});
  }
}

void LintRepositories(const Call& call, FindingCollector& findings) {
  for (const std::string& repository : Repositories(call)) {
    std::error_code error;
    for (fs::directory_iterator entry(fs::path(repository) / "ipmods", error), end;
         !error && entry != end; entry.increment(error)) {
      const Tarvo::Kel_Key key(StringBase(entry->path().filename().c_str()));
      std::error_code ignored;
      if (key.IsValid() || !fs::is_directory(entry->path() / "data", ignored)) continue;
      findings.Add({entry->path(), 0, "warning",
                    "is no core, since its name is no key such as abc_v1_00_a", ""});
    }
  }
}
