#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <iostream>
#include <map>
#include <set>

#include "Findings.h"
#include "Json.h"
#include "Lint.h"
#include "Messages.h"
#include "Nearby.h"
#include "NetlistTable.h"
#include "Tarvo_AppException.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Kel_Index.h"
#include "Text.h"
#include "Verbs.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Index;
using Tarvo::Kel_Key;
using Tarvo::KelIP;
using Tarvo::StringBase;
using Tarvo::StringList;

// All versions that are asked for and have a directory, those without a description too.
std::set<std::string> Keys(const Call& call) {
  std::set<std::string> keys;
  for (const VersionDirectory& directory : VersionDirectories(call)) {
    if (MatchesAny(directory.key, call.keys)) keys.insert(Text(directory.key.GetKey()));
  }
  return keys;
}

// A word on a terminal now and then, so that one sees that it goes on.
class Progress {
 public:
  explicit Progress(std::size_t count, bool isQuiet)
      : total(count), shown(!isQuiet && ::isatty(STDERR_FILENO) != 0) {}
  ~Progress() {
    if (written) std::cerr << "\r\x1B[K";
  }
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;

  void Step() {
    ++done;
    const auto now = std::chrono::steady_clock::now();
    if (!shown || now - last < std::chrono::milliseconds(500)) return;
    last = now;
    written = true;
    std::cerr << "\rkel: checked " << done << " of " << total << " cores\x1B[K";
  }

 private:
  std::size_t total;
  std::size_t done = 0;
  bool shown;
  bool written = false;
  std::chrono::steady_clock::time_point last = std::chrono::steady_clock::now();
};

class Checker {
 public:
  Checker(Tarvo::KelLibrary& openLibrary, FindingCollector& collector)
      : library(openLibrary), findings(collector) {}

  void CheckCore(const std::string& key) {
    findings.Begin(key);
    const std::unique_ptr<KelIP> ip(library.CreateIP(key.c_str()));
    if (!ip) return;
    try {
      LintDescription(*ip, findings);
      CheckSources(*ip);
      CheckNetlists(*ip);
    } catch (const Tarvo::AppException&) {  // of a file that went while the core was looked at
      findings.Add({Text(ip->GetLocation()), 0, "error", "changed while it was read", ""});
    }
  }

  // Sources that are missing, and that no core's own file was found to list.
  void Finish() {
    for (const auto& [path, isPlaced] : missing) {
      if (!isPlaced)
        findings.Add({path, 0, "error", "is listed as a source but does not exist", ""});
    }
  }

 private:
  void CheckSources(const KelIP& ip) {
    const Port::FileName file = DataFile(ip, Kel_Index::KEL_LDX_EXTENSION);
    const std::string name = Text(file.GetName());
    findings.Begin(name);
    StringList paths;
    StringList others;
    if (!ip.ListSynthesisSources(paths) || !ip.ListSimulationSources(others)) return;
    LintAnalyseOrder(file, findings);
    paths.insert(paths.end(), others.begin(), others.end());
    const bool hasDirectories = CheckIncludeDirectories(ip, name);
    if (paths.empty() && !hasDirectories) {
      findings.Add({name, 0, "warning", "lists no source", name});
    }
    std::map<std::string, unsigned> lines;
    for (const StringBase& path : paths) {
      std::error_code error;
      if (fs::is_regular_file(path.GetText(), error)) continue;
      bool& isPlaced = missing[Text(path)];
      if (isPlaced) continue;
      if (lines.empty()) lines = SourceLines(file);
      const auto line = FindSource(lines, Text(path));
      if (line == lines.end()) continue;
      isPlaced = true;
      findings.Add({name, line->second, "error", "source does not exist: " + Text(path), ""});
    }
  }

  // Whether there are any.
  bool CheckIncludeDirectories(const KelIP& ip, const std::string& name) {
    StringList libraries;
    ip.ListVerilogIncludeLibraries(libraries);
    for (const StringBase& key : libraries) {
      StringBase directory;
      std::error_code error;
      ip.GetVerilogIncludeLocation(key, directory);
      if (fs::is_directory(directory.GetText(), error)) continue;
      findings.Add({name, 0, "error", "include directory is none: " + Text(directory), ""});
    }
    return !libraries.empty();
  }

  // The lines of an analyse order by what they list, a library, a blank and a file.
  static std::map<std::string, unsigned> SourceLines(const Port::FileName& file) {
    std::map<std::string, unsigned> found;
    Tarvo::FileScanner lines(file);
    StringBase line;
    for (unsigned number = 0; lines.GetNextLine(line, number);) {
      const std::vector<std::string> fields = Fields(line.View());
      if (fields.size() < 3) continue;
      const std::string library = Text(Kel_Key(StringBase(std::string_view(fields[1]))).GetKey());
      found.try_emplace(library + " " + fs::path(fields[2]).lexically_normal().string(), number);
    }
    return found;
  }

  // The line that lists a source: by the key or the bare name of its library, and with or without
  // its extension.
  static std::map<std::string, unsigned>::const_iterator FindSource(
      const std::map<std::string, unsigned>& lines, const std::string& path) {
    for (const std::string directory : {"/hdl/vhdl/", "/hdl/verilog/"}) {
      const std::size_t start = path.rfind(directory);
      if (start == std::string::npos) continue;
      const fs::path version = fs::path(path.substr(0, start)).filename();
      const Kel_Key key(StringBase(version.c_str()));
      const fs::path name = fs::path(path.substr(start + directory.size())).lexically_normal();
      const fs::path bare = name.parent_path() / name.stem();
      for (const StringBase* library : {&key.GetKey(), &key.GetName()}) {
        for (const fs::path& listed : {name, bare}) {
          const auto line = lines.find(Text(*library) + " " + listed.string());
          if (line != lines.end()) return line;
        }
      }
    }
    return lines.end();
  }

  void CheckNetlists(KelIP& ip) {
    const Port::FileName file = DataFile(ip, Kel_Index::KEL_TEW_EXTENSION);
    const std::string name = Text(file.GetName());
    findings.Begin(name);
    StringList paths;
    if (!ip.ListNetlists(paths)) return;
    for (const NetlistTable::Row& row : ReadNetlistTable(ip).rows) {
      for (const std::string& path : row.netlists) {
        std::error_code error;
        if (fs::is_regular_file(path, error)) continue;
        findings.Add({name, row.line, "error", "netlist does not exist: " + path, ""});
      }
      if (!row.ignored.empty()) {
        findings.Add({name, row.line, "warning", ListEndsBefore(row.ignored.front()), ""});
      }
    }
  }

  Tarvo::KelLibrary& library;
  FindingCollector& findings;
  std::map<std::string, bool> missing;  // and whether the line that lists it was found
};

std::string Plural(std::size_t count, const char* noun) {
  return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

void Write(const std::vector<Finding>& findings, std::size_t cores, bool asJson) {
  std::size_t errors = 0;
  Json list = Json::array();
  for (const Finding& finding : findings) {
    if (finding.severity == "error") ++errors;
    list.push_back({{"file", finding.file},
                    {"line", finding.line > 0 ? Json(finding.line) : Json(nullptr)},
                    {"severity", finding.severity},
                    {"text", finding.text}});
    if (asJson) continue;
    const std::string line = finding.line > 0 ? ":" + std::to_string(finding.line) : "";
    std::cout << Printable(finding.file) << line << ": " << finding.severity << ": "
              << Printable(finding.text) << '\n';
  }
  const std::size_t warnings = findings.size() - errors;
  if (asJson) {
    WriteJson({{"cores", cores}, {"errors", errors}, {"warnings", warnings}, {"findings", list}});
  } else {
    std::cout << Plural(cores, "core") << ", " << Plural(errors, "error") << ", "
              << Plural(warnings, "warning") << '\n';
  }
}

// What the walk over all repositories finds of the cores that are asked for, and of what is no
// core.
std::vector<Finding> Walk(Tarvo::KelLibrary& library, const Call& call) {
  FindingCollector findings;
  findings.Begin(Text(RepositoryPath(call)));
  library.SetRepositoryPath(RepositoryPath(call));
  std::vector<Finding> found;
  for (const Finding& finding : findings.Take()) {
    const fs::path directory = fs::path(finding.file).parent_path().parent_path().filename();
    const Kel_Key key(StringBase(directory.c_str()));
    if (!key.IsValid() || MatchesAny(key, call.keys)) found.push_back(finding);
  }
  return found;
}

}  // namespace

Status Check(Tarvo::KelLibrary& library, const Call& call) {
  Call absolute = call;
  absolute.libraries.clear();
  for (const std::string& repository : Repositories(call)) {
    absolute.libraries.push_back(fs::absolute(repository).lexically_normal());
  }
  const std::set<std::string> keys = Keys(absolute);
  std::vector<Finding> found = Walk(library, absolute);
  {
    FindingCollector findings;
    for (const Finding& finding : found) findings.Add(finding);
    Checker checker(library, findings);
    if (call.keys.empty()) LintRepositories(absolute, findings);
    Progress progress(keys.size(), call.quiet);
    for (const std::string& key : keys) {
      checker.CheckCore(key);
      progress.Step();
    }
    checker.Finish();
    found = findings.Take();
  }
  Write(found, keys.size(), call.asJson);
  SuggestRepositories(call);
  if (keys.empty()) Messages::Note("there is no core to check");
  if (keys.empty() && call.keys.empty()) return StatusUnreadable;
  return found.empty() && !keys.empty() ? StatusClean : StatusFindings;
}
