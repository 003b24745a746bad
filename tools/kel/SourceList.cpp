// How the list of sources is made: the orders of the cores one behind the other, less what the
// request leaves out, with what descriptions and command line say for the tools.

#include "SourceList.h"

#include <algorithm>
#include <filesystem>
#include <map>
#include <unordered_map>
#include <unordered_set>

#include "CoreOptions.h"
#include "LibraryNames.h"
#include "Suggestions.h"
#include "Tarvo_LDXParser.h"
#include "Text.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::KelIP;
using Tarvo::KelSource;
using Tarvo::LDXParser;
using Tarvo::StringBase;

bool Equals(const StringBase& left, const StringBase& right) {
  return left.Compare(right, StringBase::CompareIgnoreCase) == 0;
}

// The language as the formats write it, in whatever letter case a core does. The library tells two
// languages apart; of the newer kind of Verilog the file's extension tells.
std::string LanguageOf(const KelSource& source) {
  if (Equals(source.language, LDXParser::LDX_HDL_VHDL)) return Text(LDXParser::LDX_HDL_VHDL);
  if (!Equals(source.language, LDXParser::LDX_HDL_VERILOG)) return "";
  const std::string extension = fs::path(Text(source.path)).extension();
  const bool isSystem = extension == ".sv" || extension == ".svh";
  return isSystem ? "SystemVerilog" : Text(LDXParser::LDX_HDL_VERILOG);
}

// Places of messages are written as the repository was named, and paths of cores are absolute.
std::string Normal(const StringBase& path) {
  return fs::absolute(Text(path)).lexically_normal().string();
}

// The sources of a core for the purpose of the request. Without the benches of others, what another
// core lists for simulation alone is left out.
bool AskForSources(const KelIP& ip, const Request& request, std::vector<KelSource>& sources) {
  const bool isSynthesis = request.Value("--for") == "synthesis";
  const auto question = isSynthesis ? &KelIP::GetSynthesisSources : &KelIP::GetSimulationSources;
  if (!Ask(ip, question, "sources", sources)) return false;
  if (isSynthesis || request.Value("--benches") == "all") return true;
  std::vector<KelSource> synthesised;
  if (!Ask(ip, &KelIP::GetSynthesisSources, "sources", synthesised)) return false;
  std::unordered_set<std::string> kept;
  for (const KelSource& source : synthesised) kept.insert(Text(source.path));
  const std::string own = Normal(ip.GetLocation()) + "/";
  std::erase_if(sources, [&](const KelSource& source) {
    return !kept.contains(Text(source.path)) && !Normal(source.place.file).starts_with(own);
  });
  return true;
}

// Collects the sources and directories of one core after the other.
class Collection {
 public:
  Collection(const CoreOptions& theOptions, const Request& theRequest, SourceList& theList)
      : options(theOptions), request(theRequest), list(theList) {}

  void Add(const KelIP& ip, const std::vector<KelSource>& sources) {
    list.keys.push_back(Text(ip.GetKey()));
    for (const KelSource& source : sources) {
      if (IsChosen(source) && known.insert(Text(source.path)).second) Add(source);
    }
    // Without a source there is nothing to include into.
    std::vector<Tarvo::KelIncludeDirectory> directories;
    if (!sources.empty()) ip.GetVerilogIncludeDirectories(directories);
    for (const Tarvo::KelIncludeDirectory& directory : directories) {
      const std::string location = Text(directory.path);
      if (knownDirectories.insert(location).second) {
        list.includeDirectories.push_back({Written(directory.path), location});
      }
    }
  }

 private:
  std::string Written(const StringBase& path) const {
    return RelativeTo(request.Value("--relative-to"), path);
  }

  void Add(const KelSource& source) {
    const std::string key = Text(source.library.GetKey());
    list.sources.push_back({Written(source.path), Text(source.path), key, key, LanguageOf(source),
                            StandardOf(source, key)});
  }

  // A core of both languages has each of its files twice.
  bool IsChosen(const KelSource& source) const {
    const std::string language = request.Value("--language");
    if (language.empty() || Equals(source.language, language.c_str())) return true;
    const std::string ofCore = options.Value(Text(source.library.GetKey()), "HDL");
    return !Equals(ofCore.c_str(), LDXParser::LDX_HDL_BOTH);
  }

  std::string StandardOf(const KelSource& source, const std::string& key) {
    if (!Equals(source.language, LDXParser::LDX_HDL_VHDL)) return "";
    if (request.Has("--vhdl-standard")) return request.Value("--vhdl-standard");
    const auto [standard, isNew] = standards.try_emplace(key);
    if (isNew) standard->second = StatedStandard(key);
    return standard->second;
  }

  std::string StatedStandard(const std::string& key) const {
    std::string stated = options.Value(key, "VHDL_STANDARD");
    const std::vector<std::string> choices = NamesOf(VhdlStandards());
    if (std::find(choices.begin(), choices.end(), stated) != choices.end()) return stated;
    if (!stated.empty()) {
      Messages::Warn("the option VHDL_STANDARD of " + key + " is '" + stated +
                     "', which is none of " + Join(choices));
    }
    return "";
  }

  const CoreOptions& options;
  const Request& request;
  SourceList& list;
  std::unordered_set<std::string> known;
  std::unordered_set<std::string> knownDirectories;
  std::map<std::string, std::string> standards;  // what descriptions say, by key
};

void SetTop(const CoreOptions& options, const Request& request, SourceList& list) {
  const std::string& key = list.keys.front();
  const std::string given = request.Value("--top");
  list.top = given.empty() ? options.Value(key, "TOP") : given;
  list.isTopGiven = !list.top.empty();
  if (!list.isTopGiven) list.top = Text(Tarvo::Kel_Key(key.c_str()).GetName());
}

// A unit other than the core may have generics that the core does not know.
bool SetParameters(const KelIP& ip, const Request& request, SourceList& list) {
  Tarvo::StringList generics;
  ip.ListGenerics(generics);
  std::vector<std::string> names;
  for (const StringBase& generic : generics) names.push_back(Text(generic));
  for (const Setting& given : SettingsOf(request)) {
    list.parameters.push_back(given);
    const bool isKnown = std::find(names.begin(), names.end(), given.name) != names.end();
    if (list.isTopGiven || isKnown) continue;
    Messages::Error(Text(ip.GetKey()) + " has no generic '" + given.name + "'" +
                    DidYouMean(names, given.name));
    return false;
  }
  return true;
}

// Files that are no sources, of each core that is here.
void AddDataFiles(const CoreOptions& options, const Tarvo::KelLibrary& library,
                  const Request& request, SourceList& list) {
  std::vector<std::string> cores = CoresOf(list);
  for (const std::string& key : list.keys) {
    if (std::find(cores.begin(), cores.end(), key) == cores.end()) cores.push_back(key);
  }
  for (const std::string& key : cores) {
    for (const std::string& name : options.Values(key, "DATA_FILES")) {
      const std::string location = fs::path(Text(library.GetLocation(key.c_str()))) / name;
      list.dataFiles.push_back(
          {RelativeTo(request.Value("--relative-to"), location.c_str()), location});
    }
  }
}

}  // namespace

bool IsVhdl(const Source& source) { return source.language == "VHDL"; }

bool IsVerilog(const Source& source) { return source.language.ends_with("Verilog"); }

std::vector<std::string> CoresOf(const SourceList& list) {
  std::vector<std::string> cores;
  std::unordered_set<std::string> known;
  for (const Source& source : list.sources) {
    if (known.insert(source.key).second) cores.push_back(source.key);
  }
  return cores;
}

std::vector<Library> LibrariesOf(const SourceList& list) {
  std::vector<Library> libraries;
  std::unordered_map<std::string, std::size_t> known;
  for (const Source& source : list.sources) {
    const auto [place, isNew] = known.try_emplace(source.library, libraries.size());
    if (isNew) libraries.push_back({source.library, {}});
    libraries[place->second].sources.push_back(&source);
  }
  return libraries;
}

Choices LibraryNamings() {
  return {{"option", "The option HDL_LIBRARY of its core, or else its key"},
          {"key", "The key of its core"},
          {"name", "The bare name of its core"}};
}

Choices VhdlStandards() { return {{"93"}, {"02"}, {"08"}, {"19"}}; }

Choices Languages() { return {{"vhdl"}, {"verilog"}}; }

Choices FlowTools() { return {{"ghdl"}, {"icarus"}, {"verilator"}}; }

Choices Benches() { return {{"own"}, {"all"}}; }

std::optional<SourceList> MakeSourceList(const Tarvo::KelLibrary& library, const Request& request) {
  const CoreOptions options(library);
  SourceList list = {};
  list.purpose = request.Value("--for");
  list.hasRun = request.Has("--run");
  list.tool = request.Value("--tool");
  Collection collection(options, request, list);
  for (const std::string& key : request.Values("KEY")) {
    const std::unique_ptr<KelIP> ip = OpenCore(library, key);
    std::vector<KelSource> sources;
    if (!ip || !AskForSources(*ip, request, sources)) return std::nullopt;
    collection.Add(*ip, sources);
    if (list.keys.size() > 1) continue;
    SetTop(options, request, list);
    if (!SetParameters(*ip, request, list)) return std::nullopt;
  }
  AddDataFiles(options, library, request, list);
  if (!NameLibraries(options, request, list)) return std::nullopt;
  return list;
}
