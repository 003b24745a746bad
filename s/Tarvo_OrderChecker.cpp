// The reader tells what is wrong in a file. Here the result is judged: sources that are not there
// or stand twice under two names, and cores that one order takes in two versions.

#include "Tarvo_OrderChecker.h"

#include <algorithm>
#include <boost/filesystem.hpp>
#include <map>
#include <utility>

#include "Tarvo_AnalyseOrderReader.h"
#include "Tarvo_AppException.h"
#include "Tarvo_Diagnosis.h"
#include "Tarvo_Existence.h"
#include "Tarvo_Kel_Index.h"

namespace Tarvo {

using Diagnosis::Say;
using Port::FileName;

namespace {

// A fault at a place that was read before.
void Tell(const KelDiagnosticCode& code, const KelPlace& place, const StringBase& text) {
  Diagnosis::Add([&] { return Diagnosis::AtPlace(code, place, text); });
}

FileName OrderFile(const Kel_Index& index, const Kel_Key& key) {
  return Kel_Index::GetDataFile(index.GetIPLocation(key), key, Kel_Index::KEL_LDX_EXTENSION);
}

// Whether a file key has neither steps nor doubled slashes.
bool IsNormal(std::string_view fileKey) {
  const std::string_view name = fileKey.substr(fileKey.find(' ') + 1);
  return name.substr(0, 1) != "." && name.find("/.") == std::string_view::npos &&
         name.find("//") == std::string_view::npos;
}

// One name for each file, however its entry writes it.
StringBase Normal(const FileName& file) { return file.Normalize(); }

}  // namespace

StringBase ShortName(const Kel_Index& index, const Kel_Key& key, const FileName& file) {
  const boost::filesystem::path location = index.GetIPLocation(key).GetName().GetText();
  const boost::filesystem::path name = file.GetName().GetText();
  return name.lexically_relative(location.parent_path()).c_str();
}

void OrderChecker::Check(const FileName& file, const Kel_Key& key, const StringBase& language) {
  AnalyseOrder order;
  const std::size_t before = DiagnosticCollector::GetCurrent()->found.size();
  try {
    order = ReadAnalyseOrder(file, index, key, Kel_Key(), language);
  } catch (const AppException&) {  // told as the reader met it
    return;
  }
  // An order that is empty only because its entries are bad is told for those.
  const auto& found = DiagnosticCollector::GetCurrent()->found;
  const bool isGood =
      std::all_of(found.begin() + static_cast<std::ptrdiff_t>(before), found.end(),
                  [](const KelDiagnostic& one) { return one.code == Codes::kIgnoredPurpose.code; });
  // Mostly the same list twice. What is found twice is told once, at the end of the check.
  CheckSources(order.GetSynthesis());
  CheckSources(order.GetSimulation());
  CheckIncludeDirectories(order, key);
  AddEdges(order, key);
  tops.push_back(key.GetKey());
  if (order.IsEmpty() && isGood) {
    Diagnosis::Add([&] {
      return Diagnosis::Of(Codes::kEmptyOrder, file.GetName(), "the order lists no source");
    });
  }
}

// Cores share sources, and a look at the disk may be slow: one for each name.
bool OrderChecker::IsThere(const FileName& file) {
  const auto [known, isNew] = files.try_emplace(file.GetName(), false);
  if (isNew) {
    known->second = IsFile(file);
    listed.insert(Normal(file));
  }
  return known->second;
}

bool OrderChecker::IsListed(const FileName& file) const { return listed.contains(Normal(file)); }

bool OrderChecker::IsIncludeDirectory(const FileName& directory) const {
  return includeDirectories.contains(Normal(directory));
}

void OrderChecker::CheckSources(const AnalyseOrder::SourceList& sources) {
  bool isNormal = true;
  for (const AnalyseOrder::Library& library : sources.libraries) {
    for (const AnalyseOrder::Source* const source : library.sources) {
      isNormal = isNormal && IsNormal(source->fileKey);
      const FileName location = source->GetLocation();
      if (IsThere(location)) continue;
      Tell(Codes::kMissingSource, source->mark.In(*source->origin->file),
           Say({"source does not exist: ", ShortName(index, *library.key, location).View()}));
    }
  }
  if (!isNormal) CheckNames(sources);
}

// Sources are told apart by their names as written, so that one may be listed twice. Names without
// a step or a doubled slash are normal as they are.
void OrderChecker::CheckNames(const AnalyseOrder::SourceList& sources) {
  std::unordered_map<StringBase, const AnalyseOrder::Source*> known;
  for (const AnalyseOrder::Library& library : sources.libraries) {
    for (const AnalyseOrder::Source* const source : library.sources) {
      const auto [first, isNew] = known.try_emplace(Normal(source->GetLocation()), source);
      if (isNew) continue;
      const AnalyseOrder::Source& other = *first->second;
      Diagnosis::Add([&] {
        return Diagnosis::With(
            Diagnosis::AtPlace(Codes::kDuplicateSource, source->mark.In(*source->origin->file),
                               Say({ShortName(index, *library.key, source->GetLocation()).View(),
                                    " is listed already under another name"})),
            other.mark.In(*other.origin->file), "first listed here");
      });
    }
  }
}

void OrderChecker::CheckIncludeDirectories(const AnalyseOrder& order, const Kel_Key& key) {
  for (const auto* const directory : order.includeDirectories) {
    includeDirectories.insert(Normal(directory->location));
    if (IsDirectory(directory->location)) continue;
    Tell(Codes::kMissingIncludeDirectory, directory->mark.In(*directory->file),
         Say({"include directory is not a directory: ",
              ShortName(index, key, directory->location).View()}));
  }
}

// What each core of the order brings in: whole ones, and those of single sources.
void OrderChecker::AddEdges(const AnalyseOrder& order, const Kel_Key& key) {
  std::unordered_map<StringBase, Edges> own = {{key.GetKey(), {}}};
  std::unordered_map<StringBase, Kel_Key> cores = {{OrderFile(index, key).GetName(), key}};
  for (const auto* const includes : {&order.includes, &order.further}) {
    for (const AnalyseOrder::Include& include : *includes) {
      cores.emplace(*include.file, *include.from);
      own[include.from->GetKey()].push_back({*include.core, include.mark.In(*include.file), true});
      // A core that is included whole lists its own sources in its own file.
      cores.emplace(OrderFile(index, *include.core).GetName(), *include.core);
    }
  }
  for (const auto* const list : {&order.GetSynthesis(), &order.GetSimulation()}) {
    for (const AnalyseOrder::Library& library : list->libraries) {
      AddSingleSources(library, cores, own);
    }
  }
  // What is known from another top stays: it comes from the same file.
  edges.merge(own);
}

// One edge from each other core that lists sources of the library.
void OrderChecker::AddSingleSources(const AnalyseOrder::Library& library,
                                    const std::unordered_map<StringBase, Kel_Key>& cores,
                                    std::unordered_map<StringBase, Edges>& own) {
  std::unordered_set<const StringBase*> seen;
  for (const AnalyseOrder::Source* const source : library.sources) {
    const StringBase& file = *source->origin->file;
    // Sources of one file share its name, so the pointer tells them apart.
    if (!seen.insert(&file).second) continue;
    const auto core = cores.find(file);
    if (core == cores.end() || core->second == *library.key) continue;
    own[core->second.GetKey()].push_back({*library.key, source->mark.In(file), false});
  }
}

void OrderChecker::CheckVersions() {
  for (const StringBase& top : tops) CheckVersionsOf(top);
}

// A short way to each core that the top takes in, and the cores in the order in which they are met.
OrderChecker::Steps OrderChecker::FindSteps(const StringBase& top,
                                            std::vector<StringBase>& met) const {
  Steps steps;
  met = {top};
  std::vector<StringBase> wholes = {top};
  std::unordered_set<StringBase> queued = {top};
  // Near cores first, so that the way which is told is a short one.
  for (std::size_t i = 0; i < wholes.size(); ++i) {
    const StringBase from = wholes[i];
    const auto own = edges.find(from);
    if (own == edges.end()) continue;
    for (const Edge& edge : own->second) {
      const StringBase& to = edge.core.GetKey();
      if (to != top && steps.try_emplace(to, Step{&edge, from}).second) met.push_back(to);
      if (edge.isWhole && queued.insert(to).second) wholes.push_back(to);
    }
  }
  return steps;
}

void OrderChecker::CheckVersionsOf(const StringBase& top) {
  std::vector<StringBase> met;
  const Steps steps = FindSteps(top, met);
  // Every version that is older than the newest one met is told, with the way to both.
  std::map<StringBase, Kel_Key> newest;  // by the core's name
  for (const StringBase& text : met) {
    const Kel_Key key(text);
    const auto [known, isNew] = newest.try_emplace(key.GetName(), key);
    if (!isNew && known->second < key) known->second = key;
  }
  for (const StringBase& text : met) {
    const Kel_Key& newer = newest.at(Kel_Key(text).GetName());
    if (newer != Kel_Key(text)) TellVersions(steps, top, text, newer.GetKey());
  }
}

// At the entry that brings the older version in. Behind it the rest of the way to that version, and
// then the way to the newer one, both backwards.
void OrderChecker::TellVersions(const Steps& steps, const StringBase& top, const StringBase& older,
                                const StringBase& newer) {
  const auto way = [&](const StringBase& to, std::vector<KelRelatedPlace>& places) {
    for (StringBase at = to; at != top;) {
      const Step& step = steps.at(at);
      places.push_back({step.edge->place, Say({step.from.View(), " includes ", at.View()})});
      at = step.from;
    }
  };
  Diagnosis::Add([&] {
    std::vector<KelRelatedPlace> places;
    way(older == top ? newer : older, places);
    KelDiagnostic told = Diagnosis::AtPlace(
        Codes::kVersionConflict, places.front().place,
        Say({older.View(), " and the newer ", newer.View(), " are both in one order"}),
        Say({"use ", newer.View(), " everywhere"}));
    // The first step is where the diagnostic itself stands.
    places.erase(places.begin());
    if (older != top) way(newer, places);
    told.related = std::move(places);
    return told;
  });
}

}  // namespace Tarvo
