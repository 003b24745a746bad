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
const char* const kSynthesis = "synthesis";
const char* const kSimulation = "simulation";
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

bool IsLanguageDirectory(std::string_view level) {
  return level == Kel_Index::KEL_VHDL_SUBDIRECTORY.View() ||
         level == Kel_Index::KEL_VERILOG_SUBDIRECTORY.View();
}

// Appends the levels of a path, each with one separator behind it.
void AppendLevels(StringBase& text, std::string_view path) {
  while (!path.empty()) {
    const std::size_t end = std::min(path.find('/'), path.size());
    text.Append(path.data(), static_cast<unsigned>(end));
    if (end > 0) text.Append("/");
    path.remove_prefix(std::min(end + 1, path.size()));
  }
}

// What a location says of a source: version directory, blank, name below the language's directory,
// which is the nearest one of such a name. The relative path alone if there is none.
StringBase GetFileKey(const FileName& location) {
  const StringBase directory = location.GetPath();
  std::string_view rest = directory.View();
  std::size_t behindLanguage = rest.size();
  std::string_view level = PopLevel(rest);
  for (; !level.empty() && !IsLanguageDirectory(level); level = PopLevel(rest)) {
    behindLanguage = rest.size();
  }
  StringBase fileKey;
  if (!level.empty()) {
    PopLevel(rest);
    fileKey = StringBase(PopLevel(rest));
    fileKey.Append(kBetweenLibraryAndFile);
  }
  AppendLevels(fileKey, directory.View().substr(behindLanguage));
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

void AppendExtension(StringBase& name, const StringBase& extension) {
  if (extension.GetLength() == 0) return;
  name.Append(".");
  name.Append(extension);
}

// The file key that an entry gives: the file's name as written, but for a missing extension.
StringBase GetEntryKey(const Kel_Key& library, const StringBase& file,
                       const StringBase& missingExtension) {
  StringBase fileKey = library.GetKey();
  fileKey.Append(kBetweenLibraryAndFile);
  fileKey.Append(file.GetText());  // up to a NUL byte, where its name on disk ends too
  AppendExtension(fileKey, missingExtension);
  return fileKey;
}

}  // namespace

bool LDXParser::Side::Add(const SourcePointer& source) {
  const bool sameKey = source->entryKey.GetLength() == 0;
  const StringBase& fileKey = sameKey ? source->fileKey : source->entryKey;
  if (!owners.try_emplace(fileKey.View(), source.get()).second) return false;
  Append(source);
  byLocation = byLocation && sameKey;
  return true;
}

// Most sources follow one of the same library.
void LDXParser::Side::Append(const SourcePointer& source) {
  const KeyPointer& library = source->library;
  std::size_t position = libraries.size() - 1;
  if (libraries.empty() || libraries.back().key != library) {
    const auto [known, isNew] = positions.try_emplace(library->GetKey().View(), libraries.size());
    if (isNew) libraries.push_back({library, {}});
    position = known->second;
  }
  libraries[position].sources.push_back(source);
}

// With the same kind of keys, those that are new here come over without being made again, and those
// that are known stay behind.
LDXParser::SourcePointers LDXParser::Side::Merge(Side& other) {
  SourcePointers known;
  if (libraries.empty() && other.byLocation) {
    *this = std::move(other);
    return known;
  }
  if (other.byLocation) owners.merge(other.owners);
  const bool allNew = other.byLocation && other.owners.empty();
  for (Library& library : other.libraries) {
    if (allNew && positions.try_emplace(library.key->GetKey().View(), libraries.size()).second) {
      libraries.push_back(std::move(library));
      continue;
    }
    for (const SourcePointer& source : library.sources) {
      const std::string_view fileKey = source->fileKey.View();
      const bool isNew = other.byLocation ? !other.owners.contains(fileKey)
                                          : owners.try_emplace(fileKey, source.get()).second;
      if (isNew) {
        Append(source);
      } else {
        known.push_back(source);
      }
    }
  }
  return known;
}

const Kel_Key* LDXParser::Side::FindLibrary(const StringBase& fileKey) const {
  const auto owner = owners.find(fileKey.View());
  return owner == owners.end() ? nullptr : owner->second->library.get();
}

StringList LDXParser::Side::ListSources() const {
  StringList paths;
  for (const Library& library : libraries) {
    for (const SourcePointer& source : library.sources) {
      paths.push_back(source->location.GetAbsolutePath());
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
      level(outer ? outer->level + 1 : 1) {
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
  std::string_view line;
  for (unsigned lineNumber = 0; lines.GetNextLine(line, lineNumber);) {
    if (line.empty()) continue;
    const bool isPath = Matches(StringBase(FirstWord(line)), kIncludeDirectory);
    if (isPath ? ParsePathEntry(line) : ParseLibraryEntry(line)) continue;
    const char* const kind = isPath ? "path" : "library";
    kModule.Error("LDX unparsable %s entry: %s line %d, %s\n", kind, name, lineNumber,
                  StringBase(line));
    throw Report::Exception(AppException::Failure, "Invalid LDX %s\n", name);
  }
  TARVO_TRACE("  Parse successful\n");
}

bool LDXParser::ParseLibraryEntry(std::string_view line) {
  TokenReader tokens(line, kDelimiters, TokenReader::WithGroups);
  std::string_view keyword;
  std::string_view library;
  std::string_view name;
  if (!tokens.ReadField(keyword)) return false;
  if (keyword != kBoth && keyword != kSynthesisOnly && keyword != kSimulationOnly) return false;
  if (!tokens.ReadField(library) || !tokens.ReadField(name)) return false;
  const StringBase file(name);
  if (Matches(file, kWholeLibrary)) {
    return !tokens.MoreTokens() && AnalyseLibrary(StringBase(library));
  }
  // A language that is not closed is judged by what there is of it.
  const TokenReader::Value language = tokens.ReadValue();
  tokens.Step();
  if (tokens.MoreTokens()) return false;
  return AddFile(keyword, library, file, StringBase(language.text));
}

// A keyword in other letter case, and a line that goes on behind the directory, are ignored.
bool LDXParser::ParsePathEntry(std::string_view line) {
  TokenReader tokens(line, kDelimiters, TokenReader::WithGroups);
  std::string_view keyword;
  std::string_view libraryText;
  std::string_view directoryText;
  if (!tokens.ReadField(keyword)) return false;
  if (keyword != kIncludeDirectory) return true;
  if (!tokens.ReadField(libraryText) || !tokens.ReadField(directoryText)) return false;
  const StringBase library(libraryText);
  const StringBase directory(directoryText);
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

bool LDXParser::AddFile(std::string_view keyword, std::string_view library, const StringBase& file,
                        const StringBase& language) {
  try {
    LocateLibrary(library);
  } catch (const AppException& exception) {
    kModule.Error("Unable to determine location for library %s, file %s\n%s\n", StringBase(library),
                  file, exception.what());
    return false;
  }
  const FileName name(file);
  const HdlPlacement placement = PlaceSource(hdl, language, name);
  if (placement.assumed) {
    TARVO_TRACE("HDL language not specified for file %s:%s when IP core is MIXED\n",
                StringBase(library), file);
  }
  if (placement.verdict != HdlPlacement::Placed) return ReportMisplaced(placement, file);
  EnterDirectory(placement.subdirectory);
  Source source = MakeSource(name, placement.missingExtension);
  source.entryKey = GetEntryKey(*latest.key, file, placement.missingExtension);
  if (source.entryKey == source.fileKey) source.entryKey.Empty();
  AddSource(keyword, std::make_shared<const Source>(std::move(source)));
  return true;
}

void LDXParser::LocateLibrary(std::string_view library) {
  if (latest.key && latest.text.View() == library) return;
  Place place;
  place.text = StringBase(library);
  place.key = std::make_shared<const Kel_Key>(index.GetIPKey(Kel_Key(place.text)));
  place.location = index.GetIPLocation(*place.key);
  latest = std::move(place);
}

void LDXParser::EnterDirectory(const StringBase& subdirectory) {
  if (latest.subdirectory == subdirectory) return;
  FileName directory = latest.location;
  directory.SetBase("");
  directory.PushPathEnd(Kel_Index::KEL_HDL_SUBDIRECTORY);
  directory.PushPathEnd(subdirectory);
  latest.subdirectory = subdirectory;
  latest.directory = directory.GetHead();
  latest.fileKeyStart = GetFileKey(directory);
}

// The source of that name at the latest place. A name with levels may lead to another directory of
// a language, so its file key is read off the whole location.
LDXParser::Source LDXParser::MakeSource(const FileName& name,
                                        const StringBase& missingExtension) const {
  Source source{latest.key, name, latest.fileKeyStart, {}};
  source.location.SetHead(latest.directory);
  if (missingExtension.GetLength() > 0) source.location.SetExtension(missingExtension);
  const StringBase levels = name.GetPath();
  if (levels.GetLength() > 0) {
    source.location.PushPathEnd(levels);
    source.fileKey = GetFileKey(source.location);
  } else {
    source.fileKey.Append(source.location.GetTail());
  }
  return source;
}

void LDXParser::AddSource(std::string_view keyword, const SourcePointer& source) {
  if (keyword != kBoth) PartSides();
  const bool inSynthesis = keyword != kSimulationOnly && !synthesis.Add(source);
  const bool inSimulation =
      simulation ? keyword != kSynthesisOnly && !simulation->Add(source) : inSynthesis;
  if (inSynthesis) WarnOfSecond(*source, kSynthesis);
  if (inSimulation) WarnOfSecond(*source, kSimulation);
}

void LDXParser::WarnOfSecond(const Source& source, const char* side) const {
  kModule.Warning("%s - File %s:%s already exists in %s library\n", key.GetKey(),
                  source.library->GetKey(), source.location.GetTail(), side);
}

// From here on the lists for simulation are their own.
void LDXParser::PartSides() {
  if (!simulation) simulation = std::make_unique<Side>(synthesis);
}

const LDXParser::Side& LDXParser::Simulation() const {
  return simulation ? *simulation : synthesis;
}

bool LDXParser::AnalyseLibrary(const StringBase& library) {
  return Guard(NoOutput(), Failure(kModule, "Unable to analyse library %s\n%s\n", library), [&] {
    const Kel_Key libKey(library);
    const StringBase language = LanguageOf(libKey);
    // Not on the stack, of which each level of a deep chain needs some.
    const std::unique_ptr<LDXParser> nested(
        new LDXParser(GetLdxFile(index, libKey), index, libKey, rootKey, language, this));
    MergeSides(*nested);
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

// The nested parser is of no use afterwards.
void LDXParser::MergeSides(LDXParser& nested) {
  if (simulation || nested.simulation) {
    PartSides();
    nested.PartSides();
  }
  const SourcePointers known = synthesis.Merge(nested.synthesis);
  TraceKnown(known, kSynthesis, nested);
  TraceKnown(simulation ? simulation->Merge(*nested.simulation) : known, kSimulation, nested);
}

void LDXParser::TraceKnown(const SourcePointers& sources, const char* side,
                           const LDXParser& nested) const {
  for (const SourcePointer& source : sources) {
    TARVO_TRACE("%s - File %s:%s included from %s already exists in %s library\n", key.GetKey(),
                source->library->GetKey(), source->location.GetTail(), nested.key.GetKey(), side);
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
  if (!library && simulation) library = simulation->FindLibrary(fileKey);
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
    directories.push_back(index.GetIPLocation(*library.key).GetAbsolutePath());
  }
  return directories;
}

StringList LDXParser::ListSynthesisLibraries() const { return ListDirectories(synthesis); }

StringList LDXParser::ListSimulationLibraries() const { return ListDirectories(Simulation()); }

StringList LDXParser::ListSynthesisAnalyseOrder() const { return synthesis.ListSources(); }

StringList LDXParser::ListSimulationAnalyseOrder() const { return Simulation().ListSources(); }

StringList LDXParser::ListVerilogIncludeLibraryKeys() const {
  StringList keys;
  for (const auto& entry : includeDirectories) keys.push_back(entry.first.GetKey());
  return keys;
}

}  // namespace Tarvo
