// Merging is what an analysis spends its time on, so nothing here copies a source: lists hold
// shared pointers, tables hold views of texts that the sources own, and synthesis and simulation
// are one list until they differ.

#include "Tarvo_AnalyseOrder.h"

#include <algorithm>
#include <utility>

namespace Tarvo {

const AnalyseOrder::Source* AnalyseOrder::SourceList::Add(const SourcePointer& source) {
  const bool sameKey = source->entryKey.GetLength() == 0;
  const StringBase& fileKey = sameKey ? source->fileKey : source->entryKey;
  const auto [known, isNew] = sourcesByKey.try_emplace(fileKey.View(), source.get());
  if (!isNew) return known->second;
  AppendSource(source);
  isKeyedByLocation = isKeyedByLocation && sameKey;
  return nullptr;
}

// Most sources follow one of the same library, so that its text is seldom looked up.
void AnalyseOrder::SourceList::AppendSource(const SourcePointer& source) {
  const std::shared_ptr<const Kel_Key>& library = source->origin->library;
  std::size_t position = libraries.size() - 1;
  // The pointers are compared: sources that are made one after another share the key.
  if (libraries.empty() || libraries.back().key != library) {
    const auto [known, isNew] =
        libraryIndex.try_emplace(library->GetKey().View(), libraries.size());
    if (isNew) libraries.push_back({library, {}});
    position = known->second;
  }
  libraries[position].sources.push_back(source);
}

// Where both tables hold the same kind of keys, the entries that are new here come over without
// being made again, and those that are known stay behind in the other table.
AnalyseOrder::SourcePointers AnalyseOrder::SourceList::Append(SourceList& other) {
  SourcePointers known;
  if (libraries.empty() && other.isKeyedByLocation) {
    *this = std::move(other);
    return known;
  }
  if (other.isKeyedByLocation) sourcesByKey.merge(other.sourcesByKey);
  // Nothing of the other list is here yet, so its libraries come over whole.
  const bool allNew = other.isKeyedByLocation && other.sourcesByKey.empty();
  for (Library& library : other.libraries) {
    if (allNew && libraryIndex.try_emplace(library.key->GetKey().View(), libraries.size()).second) {
      libraries.push_back(std::move(library));
      continue;
    }
    for (const SourcePointer& source : library.sources) {
      const std::string_view fileKey = source->fileKey.View();
      const bool isNew = other.isKeyedByLocation
                             ? other.sourcesByKey.find(fileKey) == other.sourcesByKey.end()
                             : sourcesByKey.try_emplace(fileKey, source.get()).second;
      if (isNew) {
        AppendSource(source);
      } else {
        known.push_back(source);
      }
    }
  }
  return known;
}

const AnalyseOrder::Source* AnalyseOrder::SourceList::Find(const StringBase& fileKey) const {
  const auto found = sourcesByKey.find(fileKey.View());
  return found == sourcesByKey.end() ? nullptr : found->second;
}

AnalyseOrder::Earlier AnalyseOrder::Add(const SourcePointer& source, bool forSynthesis,
                                        bool forSimulation) {
  if (forSynthesis != forSimulation) PartLists();
  Earlier earlier;
  if (forSynthesis) earlier.synthesis = synthesis.Add(source);
  if (!simulation) {
    earlier.simulation = earlier.synthesis;
  } else if (forSimulation) {
    earlier.simulation = simulation->Add(source);
  }
  return earlier;
}

AnalyseOrder::Known AnalyseOrder::Append(AnalyseOrder&& other) {
  // One list for both purposes goes on only while neither side has told them apart.
  if (simulation || other.simulation) {
    PartLists();
    other.PartLists();
  }
  Known known;
  known.synthesis = synthesis.Append(other.synthesis);
  known.isParted = simulation != nullptr;
  if (known.isParted) known.simulation = simulation->Append(*other.simulation);
  for (IncludeDirectory& directory : other.includeDirectories) {
    if (!FindIncludeDirectory(directory.library)) {
      includeDirectories.push_back(std::move(directory));
    }
  }
  return known;
}

const AnalyseOrder::IncludeDirectory* AnalyseOrder::FindIncludeDirectory(
    const Kel_Key& library) const {
  const auto found =
      std::find_if(includeDirectories.begin(), includeDirectories.end(),
                   [&](const IncludeDirectory& entry) { return entry.library == library; });
  return found == includeDirectories.end() ? nullptr : &*found;
}

// From here on the list for simulation is its own.
void AnalyseOrder::PartLists() {
  if (!simulation) simulation = std::make_unique<SourceList>(synthesis);
}

}  // namespace Tarvo
