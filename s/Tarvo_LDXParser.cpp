#include "Tarvo_LDXParser.h"

#include <algorithm>
#include <memory>
#include <string_view>
#include <utility>

#include "Tarvo_Existence.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Guard.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_LDXParser_Hdl.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_Report.h"
#include "Tarvo_TokenReader.h"
#include "Tarvo_Word.h"

namespace Tarvo {

using Port::FileName;

// A file has one entry on a line, and quotes or brackets make one field of several words:
//
//     lib LIBRARY FILE [LANGUAGE]        a source for both lists; synlib and simlib for one of them
//     lib LIBRARY all                    all that the library's own file lists
//     vlgincdir LIBRARY DIRECTORY        the library's Verilog include directory
namespace {

constexpr Report::Module kModule{"s/Tarvo_LDXParser", "1.0"};

const char* const kDelimiters = " \"'";
const char* const kBoth = "lib";
const char* const kSynthesisOnly = "synlib";
const char* const kSimulationOnly = "simlib";
const char* const kWholeLibrary = "all";
const char* const kIncludeDirectory = "vlgincdir";
const char* const kLanguageOption = "HDL";
const char* const kBetweenLibraryAndFile = " ";

constexpr unsigned kDeepestLevel = 1000;

// The key, which must not be that of the root of its own analysis.
const Kel_Key& CheckRoot(const Kel_Key& key, const Kel_Key& root) {
  if (!root.IsValid() || key != root) return key;
  throw Report::Exception(AppException::Failure, "Circular LDX definition for %s\n", root.GetKey());
}

// The analyse-order file of a version, which must be there.
FileName GetLdxFile(const Kel_Index& index, const Kel_Key& key) {
  FileName file =
      Kel_Index::GetDataFile(index.GetIPLocation(key), key, Kel_Index::KEL_LDX_EXTENSION);
  if (MayExist(file)) return file;
  throw Report::Exception(AppException::Failure, "Invalid LDX %s\n", file.GetName());
}

// Takes the last level off a path; empty if there is none.
std::string_view PopLevel(std::string_view& path) {
  while (!path.empty() && path.back() == '/') path.remove_suffix(1);
  const std::size_t slash = path.rfind('/');
  const std::size_t start = slash == std::string_view::npos ? 0 : slash + 1;
  const std::string_view level = path.substr(start);
  path = path.substr(0, start);
  return level;
}

// What a location says of a source: version directory, blank, name below the language's directory,
// which is the nearest one of such a name. The relative path alone if there is none.
StringBase GetFileKey(const FileName& location) {
  const StringBase directory = location.GetPath();
  std::string_view rest = directory.View();
  std::vector<std::string_view> levels;
  std::string_view level = PopLevel(rest);
  for (; !level.empty(); level = PopLevel(rest)) {
    if (level == Kel_Index::KEL_VHDL_SUBDIRECTORY.View() ||
        level == Kel_Index::KEL_VERILOG_SUBDIRECTORY.View()) {
      break;
    }
    levels.push_back(level);
  }
  StringBase fileKey;
  if (!level.empty()) {
    PopLevel(rest);
    fileKey = StringBase(PopLevel(rest));
    fileKey.Append(kBetweenLibraryAndFile);
  }
  std::reverse(levels.begin(), levels.end());
  for (const std::string_view name : levels) {
    fileKey.Append(name.data(), static_cast<unsigned>(name.size()));
    fileKey.Append("/");
  }
  fileKey.Append(location.GetTail());
  return fileKey;
}

// The key as the index stores it, or as it is if the index does not know it.
Kel_Key Resolve(const Kel_Index& index, const Kel_Key& key) {
  try {
    return index.GetIPKey(key);
  } catch (const AppException&) {
    return key;
  }
}

// Says what is wrong with a file entry. True if that costs the entry alone.
bool ReportMisplaced(const HdlPlacement& placement, const StringBase& file) {
  switch (placement.verdict) {
    case HdlPlacement::Placed:
      return true;
    case HdlPlacement::UnknownLanguage:
      kModule.Error("Unknown HDL language specified\n");
      return true;
    case HdlPlacement::LanguageOnBoth:
      kModule.Error("HDL language specified when IP core is BOTH\n");
      return true;
    case HdlPlacement::AgainstExtension:
      kModule.Error("File %s declared to be %s\n", file, placement.language);
      return false;
    case HdlPlacement::NeitherLanguageNorExtension:
      kModule.Error("Unable to add file extension to %s\n", file);
      return false;
  }
  return false;
}

// Where a placed file lies, from its library's directory on.
FileName Locate(FileName location, const HdlPlacement& placement, const FileName& file) {
  location.PushPathEnd(Kel_Index::KEL_HDL_SUBDIRECTORY);
  location.PushPathEnd(placement.subdirectory);
  location.PushPathEnd(file.GetPath());
  if (file.HasExtension()) {
    location.SetTail(file.GetTail());
  } else {
    location.SetBase(file.GetBase());
    location.SetExtension(placement.missingExtension);
  }
  return location;
}

// The file key that an entry gives: the file's name as written, but for a missing extension.
StringBase GetEntryKey(const Kel_Key& library, const StringBase& file,
                       const StringBase& missingExtension) {
  StringBase fileKey = library.GetKey();
  fileKey.Append(kBetweenLibraryAndFile);
  fileKey.Append(file.GetText());  // up to a NUL byte, where its name on disk ends too
  if (missingExtension.GetLength() > 0) {
    fileKey.Append(".");
    fileKey.Append(missingExtension);
  }
  return fileKey;
}

}  // namespace

bool LDXParser::Side::Add(const Kel_Key& library, const StringBase& fileKey, Source& source) {
  const auto [owner, isNewSource] = owners.try_emplace(fileKey, libraries.size());
  if (!isNewSource) return false;
  const auto [position, isNewLibrary] = positions.try_emplace(library.GetKey(), libraries.size());
  if (isNewLibrary) libraries.push_back({library, {}});
  owner->second = position->second;
  libraries[position->second].sources.push_back(std::move(source));
  return true;
}

const Kel_Key* LDXParser::Side::FindLibrary(const StringBase& fileKey) const {
  const auto owner = owners.find(fileKey);
  return owner == owners.end() ? nullptr : &libraries[owner->second].key;
}

StringList LDXParser::Side::ListSources() const {
  StringList paths;
  for (const Library& library : libraries) {
    for (const Source& source : library.sources) {
      paths.push_back(source.location.GetAbsolutePath());
    }
  }
  return paths;
}

LDXParser::LDXParser(const Kel_Index& theIndex, const Kel_Key& version, const Kel_Key& root,
                     const StringBase& language)
    : LDXParser(GetLdxFile(theIndex, CheckRoot(version, root)), theIndex, version, root, language) {
}

LDXParser::LDXParser(const FileName& ldxFile, const Kel_Index& theIndex, const Kel_Key& version,
                     const Kel_Key& root, const StringBase& language)
    : LDXParser(ldxFile, theIndex, version, root, language, nullptr) {}

LDXParser::LDXParser(const FileName& ldxFile, const Kel_Index& theIndex, const Kel_Key& version,
                     const Kel_Key& root, StringBase language, const LDXParser* outer)
    : index(theIndex),
      key(CheckRoot(version, root)),
      core(Resolve(theIndex, version)),
      rootKey(root.IsValid() ? root : version),
      hdl(std::move(language)),
      enclosing(outer),
      level(outer ? outer->level + 1 : 1),
      synthesis("synthesis"),
      simulation("simulation") {
  CheckNesting();
  Parse(ldxFile);
}

LDXParser::~LDXParser() = default;

// Finds the circles that don't lead through the root, or reach it by its bare name.
void LDXParser::CheckNesting() const {
  for (const LDXParser* outer = enclosing; outer; outer = outer->enclosing) {
    if (outer->core == core) {
      throw Report::Exception(AppException::Failure, "Circular LDX definition for %s\n",
                              core.GetKey());
    }
  }
  if (level > kDeepestLevel) {
    throw Report::Exception(AppException::Failure, "LDX definition for %s nested below %d others\n",
                            core.GetKey(), kDeepestLevel);
  }
}

// The first bad line ends all reading.
void LDXParser::Parse(const FileName& ldxFile) {
  const StringBase name = ldxFile.GetName();
  TARVO_TRACE("  Parsing LDX File %s\n", name);
  FileScanner lines(ldxFile);
  StringBase line;
  for (unsigned lineNumber = 0; lines.GetNextLine(line, lineNumber);) {
    if (line.GetLength() == 0) continue;
    const bool isPath = Matches(StringBase(FirstWord(line.View())), kIncludeDirectory);
    if (isPath ? ParsePathEntry(line) : ParseLibraryEntry(line)) continue;
    const char* const kind = isPath ? "path" : "library";
    kModule.Error("LDX unparsable %s entry: %s line %d, %s\n", kind, name, lineNumber, line);
    throw Report::Exception(AppException::Failure, "Invalid LDX %s\n", name);
  }
  TARVO_TRACE("  Parse successful\n");
}

bool LDXParser::ParseLibraryEntry(const StringBase& line) {
  TokenReader tokens(line.View(), kDelimiters, TokenReader::WithGroups);
  StringBase keyword;
  StringBase library;
  StringBase file;
  if (!tokens.ReadField(keyword)) return false;
  if (keyword != kBoth && keyword != kSynthesisOnly && keyword != kSimulationOnly) return false;
  if (!tokens.ReadField(library) || !tokens.ReadField(file)) return false;
  if (Matches(file, kWholeLibrary)) return !tokens.MoreTokens() && AnalyseLibrary(library);
  // A language that is not closed is judged by what there is of it.
  const TokenReader::Value language = tokens.ReadValue();
  tokens.Step();
  if (tokens.MoreTokens()) return false;
  return AddFile(keyword, library, file, StringBase(language.text));
}

// A keyword in other letter case, and a line that goes on behind the directory, are ignored.
bool LDXParser::ParsePathEntry(const StringBase& line) {
  TokenReader tokens(line.View(), kDelimiters, TokenReader::WithGroups);
  StringBase keyword;
  StringBase library;
  StringBase directory;
  if (!tokens.ReadField(keyword)) return false;
  if (keyword != kIncludeDirectory) return true;
  if (!tokens.ReadField(library) || !tokens.ReadField(directory)) return false;
  const Kel_Key libKey(library);
  FileName location = index.GetIPLocation(key);
  location.PushPathEnd(directory);
  if (!Exists(FileName(location.Normalize()))) {
    kModule.Warning("The include directory %s for library %s does not exist\n", directory, library);
    return false;
  }
  if (tokens.MoreTokens()) return true;
  if (const FileName* const known = FindIncludeDirectory(libKey)) {
    kModule.Warning("Library %s already has path %s defined\n", library, known->GetName());
    return false;
  }
  includeDirectories.emplace_back(libKey, location);
  return true;
}

bool LDXParser::AddFile(const StringBase& keyword, const StringBase& library,
                        const StringBase& file, const StringBase& language) {
  Kel_Key libKey;
  FileName location;
  try {
    libKey = index.GetIPKey(Kel_Key(library));
    location = index.GetIPLocation(libKey);
  } catch (const AppException& exception) {
    kModule.Error("Unable to determine location for library %s, file %s\n%s\n", library, file,
                  exception.what());
    return false;
  }
  const FileName name(file);
  const HdlPlacement placement = PlaceSource(hdl, language, name);
  if (placement.assumed) {
    TARVO_TRACE("HDL language not specified for file %s:%s when IP core is MIXED\n", library, file);
  }
  if (placement.verdict != HdlPlacement::Placed) return ReportMisplaced(placement, file);
  location = Locate(location, placement, name);
  const StringBase fileKey = GetEntryKey(libKey, file, placement.missingExtension);
  const Source source{location, GetFileKey(location)};
  if (keyword != kSimulationOnly) AddSource(synthesis, libKey, fileKey, source);
  if (keyword != kSynthesisOnly) AddSource(simulation, libKey, fileKey, source);
  return true;
}

void LDXParser::AddSource(Side& side, const Kel_Key& library, const StringBase& fileKey,
                          Source source) const {
  if (side.Add(library, fileKey, source)) return;
  kModule.Warning("%s - File %s:%s already exists in %s library\n", key.GetKey(), library.GetKey(),
                  source.location.GetTail(), side.name);
}

bool LDXParser::AnalyseLibrary(const StringBase& library) {
  return Guard(NoOutput(), Failure(kModule, "Unable to analyse library %s\n%s\n", library), [&] {
    const Kel_Key libKey(library);
    const StringBase language = LanguageOf(libKey);
    // Not on the stack, of which each level of a deep chain needs some.
    const std::unique_ptr<LDXParser> nested(
        new LDXParser(GetLdxFile(index, libKey), index, libKey, rootKey, language, this));
    MergeSide(synthesis, nested->synthesis, *nested);
    MergeSide(simulation, nested->simulation, *nested);
    MergeIncludeDirectories(*nested);
  });
}

// The language of an included core; this one's own if the index has no options of it.
StringBase LDXParser::LanguageOf(const Kel_Key& library) const {
  StringBase language;
  try {
    language = OptionScanner::GetOptionValue(index.GetIPOptions(library), kLanguageOption);
  } catch (const AppException& exception) {
    if (exception.level == AppException::NotFound) language = hdl;
  }
  return language.GetLength() > 0 ? language : LDX_HDL_VHDL;
}

// Takes over the sources of the nested side; it is not asked again.
void LDXParser::MergeSide(Side& side, Side& nestedSide, const LDXParser& nested) const {
  for (Library& library : nestedSide.libraries) {
    for (Source& source : library.sources) {
      if (side.Add(library.key, source.fileKey, source)) continue;
      TARVO_TRACE("%s - File %s:%s included from %s already exists in %s library\n", key.GetKey(),
                  library.key.GetKey(), source.location.GetTail(), nested.key.GetKey(), side.name);
    }
  }
}

// A library keeps the directory that it was given first.
void LDXParser::MergeIncludeDirectories(const LDXParser& nested) {
  for (const auto& entry : nested.includeDirectories) {
    if (!FindIncludeDirectory(entry.first)) includeDirectories.push_back(entry);
  }
}

const FileName* LDXParser::FindIncludeDirectory(const Kel_Key& library) const {
  const auto found = std::find_if(includeDirectories.begin(), includeDirectories.end(),
                                  [&](const auto& entry) { return entry.first == library; });
  return found == includeDirectories.end() ? nullptr : &found->second;
}

// A question to the parser like the others, though its answer needs none of it.
// NOLINTNEXTLINE(readability-convert-member-functions-to-static)
StringBase LDXParser::GetFileLanguage(const FileName& file) const {
  return LanguageByExtension(file);
}

Kel_Key LDXParser::GetFileLibrary(const FileName& file) const {
  const StringBase fileKey = GetFileKey(file);
  const Kel_Key* library = synthesis.FindLibrary(fileKey);
  if (!library) library = simulation.FindLibrary(fileKey);
  return library ? *library : Kel_Key();
}

StringBase LDXParser::GetVerilogIncludeLocation(const StringBase& library) const {
  const Kel_Key libKey(library);
  const FileName* const directory = FindIncludeDirectory(libKey);
  return directory ? directory->GetAbsolutePath() : index.GetIPLocation(libKey).GetAbsolutePath();
}

StringList LDXParser::ListDirectories(const Side& side) const {
  StringList directories;
  for (const Library& library : side.libraries) {
    directories.push_back(index.GetIPLocation(library.key).GetAbsolutePath());
  }
  return directories;
}

StringList LDXParser::ListSynthesisLibraries() const { return ListDirectories(synthesis); }

StringList LDXParser::ListSimulationLibraries() const { return ListDirectories(simulation); }

StringList LDXParser::ListSynthesisAnalyseOrder() const { return synthesis.ListSources(); }

StringList LDXParser::ListSimulationAnalyseOrder() const { return simulation.ListSources(); }

StringList LDXParser::ListVerilogIncludeLibraryKeys() const {
  StringList keys;
  for (const auto& entry : includeDirectories) keys.push_back(entry.first.GetKey());
  return keys;
}

}  // namespace Tarvo
