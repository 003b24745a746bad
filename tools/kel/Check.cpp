// The verb `check`. The library finds what is wrong; here it is narrowed to what was asked for,
// sorted, judged and written.

#include <unistd.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <filesystem>
#include <iostream>
#include <tuple>

#include "Diagnostics.h"
#include "Sarif.h"
#include "Suggestions.h"
#include "Tarvo_KelChecker.h"
#include "Tarvo_Kel_Index.h"
#include "Text.h"
#include "Verb.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Key;
using Tarvo::KelDiagnostic;
using Tarvo::KelPlace;
using Tarvo::StringBase;
using Tarvo::StringList;
using Diagnostics = std::vector<KelDiagnostic>;

// All versions that are asked for and have a directory, those without a description too.
StringList Keys(const Tarvo::KelLibrary& library, const std::vector<std::string>& globs) {
  StringList keys = library.GetIndex().GetAllVersionKeys();
  std::erase_if(keys, [&](const StringBase& key) { return !MatchesAny(Kel_Key(key), globs); });
  return keys;
}

// Whether each pattern matches a version. An error tells of one that doesn't.
bool MatchAll(const Tarvo::KelLibrary& library, const std::vector<std::string>& globs) {
  bool all = true;
  for (const std::string& glob : globs) {
    if (!Keys(library, {glob}).empty()) continue;
    Messages::Error("no core matches '" + glob + "'" + NearNames(library, glob));
    all = false;
  }
  return all;
}

// A word on a terminal now and then, so that one sees that it goes on.
class Progress {
 public:
  explicit Progress(bool isQuiet) : shown(!isQuiet && ::isatty(STDERR_FILENO) != 0) {}
  ~Progress() {
    if (written) std::cerr << "\r\x1B[K";
  }
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;

  void Step(std::size_t done, std::size_t total) {
    const auto now = std::chrono::steady_clock::now();
    // Twice a second is enough for people, and costs nothing beside a core.
    if (!shown || now - last < std::chrono::milliseconds(500)) return;
    last = now;
    written = true;
    std::cerr << "\rkel: checked " << done << " of " << total << " cores\x1B[K";
  }

 private:
  bool shown;
  bool written = false;
  std::chrono::steady_clock::time_point last = std::chrono::steady_clock::now();
};

// Whether a file belongs to a version that was not asked for.
bool IsLeftOut(const StringBase& file, const std::vector<std::string>& globs) {
  for (fs::path path = Text(file); path.has_relative_path(); path = path.parent_path()) {
    const Kel_Key key(StringBase(path.filename().c_str()));
    const bool isVersion =
        path.parent_path().filename() == Tarvo::Kel_Index::KEL_VERSIONS_SUBDIRECTORY.GetText();
    if (isVersion && key.IsValid()) return !MatchesAny(key, globs);
  }
  return false;
}

// Sets the repository path, and gives what the walk finds and the checker does not look for.
Diagnostics Walk(Tarvo::KelLibrary& library, const Request& request) {
  std::vector<std::string> paths;
  for (const std::string& repository : Repositories(request)) {
    // Findings come from the walk and from the checker; one way of writing paths lets them be
    // sorted.
    paths.push_back(fs::absolute(repository).lexically_normal());
  }
  const Tarvo::KelDiagnosticLog log;
  library.SetRepositoryPath(Join(paths, ";").c_str());
  // The checker tells of bad descriptions by itself, with all of their faults.
  Diagnostics found = log.Take();
  std::erase_if(found, [&](const KelDiagnostic& one) {
    return one.place.file.GetLength() > 0 &&
           (one.code == "bad-statement" || one.code == "missing-description" ||
            IsLeftOut(one.place.file, request.Values("GLOB")));
  });
  return found;
}

auto Order(const KelDiagnostic& diagnostic) {
  const KelPlace& place = diagnostic.place;
  return std::tie(place.file, place.line, place.column, diagnostic.code, diagnostic.text);
}

Diagnostics CheckAll(const Tarvo::KelLibrary& library, const Request& request,
                     const StringList& keys) {
  const Tarvo::KelChecker checker(library);
  Progress progress(request.Has("--quiet"));
  const auto step = [&](std::size_t done, std::size_t total) { progress.Step(done, total); };
  return request.Has("GLOB") ? checker.CheckCores(keys, step) : checker.CheckLibrary(step);
}

// In the order of their places, each once.
void Sort(Diagnostics& found) {
  std::stable_sort(found.begin(), found.end(),
                   [](const auto& left, const auto& right) { return Order(left) < Order(right); });
  const auto isSame = [](const auto& one, const auto& two) { return Order(one) == Order(two); };
  found.erase(std::unique(found.begin(), found.end(), isSame), found.end());
}

// What the options -W make of them.
void Judge(Diagnostics& found, const std::vector<std::string>& choices) {
  for (const std::string& choice : choices) {
    std::erase_if(found, [&](const auto& one) { return "no-" + Text(one.code) == choice; });
    // The last choice does not win: leaving out and raising are two questions.
    for (KelDiagnostic& one : found) {
      const bool counts = choice == "error" && one.severity == KelDiagnostic::Warning;
      if (counts) one.severity = KelDiagnostic::Error;
    }
  }
}

struct Counts {
  std::size_t cores;
  std::array<std::size_t, 3> of;  // by severity
};

std::string Plural(std::size_t count, const char* noun) {
  return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

void WriteText(const Diagnostics& found, const Counts& counts, const Request& request) {
  const bool isDetailed = request.Has("--excerpts") || ::isatty(STDOUT_FILENO) != 0;
  DiagnosticWriter writer;
  writer.relativeTo = request.Value("--relative-to");
  writer.withColour = WantsColour(request.Value("--color"), STDOUT_FILENO);
  writer.withRelated = writer.withHelp = isDetailed;
  writer.excerptWidth = isDetailed ? TerminalWidth() : 0;
  for (const KelDiagnostic& diagnostic : found) std::cout << writer.Write(diagnostic);
  const auto [notes, warnings, errors] = counts.of;
  std::cout << Plural(counts.cores, "core") << ", " << Plural(errors, "error") << ", "
            << Plural(warnings, "warning") << (notes > 0 ? ", " + Plural(notes, "note") : "")
            << '\n';
}

Json PlaceMembers(const KelPlace& place, const std::string& relativeTo) {
  const auto known = [](unsigned number) { return number > 0 ? Json(number) : Json(nullptr); };
  const std::string file = RelativeTo(relativeTo, place.file);
  return {{"file", file.empty() ? Json(nullptr) : Json(file)},
          {"line", known(place.line)},
          {"column", known(place.column)},
          {"length", known(place.length)}};
}

void WriteJsonList(const Diagnostics& found, const Counts& counts, const Request& request) {
  Json findings = Json::array();
  for (const KelDiagnostic& one : found) {
    Json related = Json::array();
    for (const Tarvo::KelRelatedPlace& other : one.related) {
      related.push_back(PlaceMembers(other.place, request.Value("--relative-to")));
      related.back()["text"] = Text(other.text);
    }
    findings.push_back(PlaceMembers(one.place, request.Value("--relative-to")));
    findings.back().update(
        {{"severity", SeverityWord(one.severity)},
         {"code", Text(one.code)},
         {"text", Text(one.text)},
         {"hint", one.hint.GetLength() > 0 ? Json(Text(one.hint)) : Json(nullptr)},
         {"related", related}});
  }
  const auto [notes, warnings, errors] = counts.of;
  WriteJson({{"cores", counts.cores},
             {"errors", errors},
             {"warnings", warnings},
             {"notes", notes},
             {"findings", findings}});
}

void WriteSarif(const Diagnostics& found, const Counts& /*counts*/, const Request& request) {
  const std::string base = request.Value("--relative-to");
  const fs::path directory = fs::absolute((base.empty() ? "." : base) + "/.");
  WriteDocument(std::cout, SarifLog(found, directory.lexically_normal().parent_path()));
}

struct Format {
  const char* name;
  void (*write)(const Diagnostics& found, const Counts& counts, const Request& request);
  const char* help;
};
const Format kFormats[] = {{"text", WriteText, "A line for each finding, and a line of counts"},
                           {"json", WriteJsonList, "A document of findings and counts"},
                           {"sarif", WriteSarif, "A SARIF log, for code hosts and editors"}};

Choices FindingFormats() { return ChoicesOf(kFormats); }

void Write(const Diagnostics& found, const Counts& counts, const Request& request) {
  for (const Format& format : kFormats) {
    if (request.Value("--format") == format.name) format.write(found, counts, request);
  }
}

Status Check(const Tarvo::KelLibrary& /*unread*/, const Request& request) {
  Tarvo::KelLibrary library;
  const std::vector<std::string>& globs = request.Values("GLOB");
  Diagnostics found = Walk(library, request);
  if (library.GetRepositories().empty()) {
    for (const KelDiagnostic& diagnostic : found) Messages::Show(diagnostic);
    SuggestRepositories(request);
    return StatusUnreadable;
  }
  // What the walk found is about repositories, and may be what is to be suggested about.
  const bool isComplete = found.empty();
  const StringList keys = Keys(library, globs);
  const Diagnostics checked = CheckAll(library, request, keys);
  found.insert(found.end(), checked.begin(), checked.end());
  Sort(found);
  Judge(found, request.Values("-W"));
  Counts counts = {keys.size(), {}};
  for (const KelDiagnostic& diagnostic : found) ++counts.of.at(diagnostic.severity);
  Write(found, counts, request);
  if (!isComplete || keys.empty()) SuggestRepositories(request);
  // A repository without cores is hardly the one that was meant.
  if (keys.empty() && globs.empty()) {
    Messages::Note("there is no core to check");
    return StatusUnreadable;
  }
  const bool isClean = counts.of.at(KelDiagnostic::Note) == found.size();
  return MatchAll(library, globs) && isClean ? StatusClean : StatusFindings;
}

Choices Warnings() {
  Choices choices = {{"error", "Warnings count as errors"}};
  for (const auto& code : Codes()) choices.push_back({std::string("no-") + code.code, code.title});
  return choices;
}

std::string WarningFault(const std::string& choice) {
  const std::vector<std::string> names = NamesOf(Warnings());
  if (std::find(names.begin(), names.end(), choice) != names.end()) return "";
  return "'" + choice + "' is neither error nor no-CODE" + DidYouMean(names, choice);
}

}  // namespace

Verb DescribeCheck() {
  return {.name = "check",
          .help = "Lists what is wrong with the cores, at its file and line",
          .words = {Repeated(GlobWord()),
                    {.name = "--format",
                     .value = "FORMAT",
                     .help = "How the findings are written",
                     .byDefault = "text",
                     .choices = FindingFormats},
                    {.name = "--excerpts",
                     .help = "Show lines, help and related places, as on a terminal"},
                    {.name = "-W",
                     .value = "CHOICE",
                     .help = "error: warnings count as errors; no-CODE: leave out this code; may "
                             "be repeated",
                     .isRepeated = true,
                     .choices = Warnings,
                     .fault = WarningFault},
                    RelativeToWord()},
          .example = "check 'pulse*' -W error",
          .reads = Verb::ItsOwn,
          .answer = Check};
}
