// An order is what its cores' parts add up to, so nothing here copies a source: lists hold pointers
// and tables hold views of what the parts own, and synthesis and simulation are one list until they
// differ.

#include "Tarvo_AnalyseOrder.h"

#include <utility>

namespace Tarvo {

// The text behind the library, which for all but odd names is that of the path below the directory.
Port::FileName AnalyseOrder::Source::GetLocation() const {
  if (odd) return odd->location;
  StringBase name = origin->directory;
  name.Append("/");
  name.Append(fileKey.GetText() + nameAt);
  return Port::FileName(name);
}

const AnalyseOrder::Source* AnalyseOrder::SourceList::Add(const Source& source) {
  const auto [known, isNew] = sourcesByKey.try_emplace(source.GetEntryKey().View(), &source);
  if (!isNew) return known->second;
  AppendSource(source);
  return nullptr;
}

// Most sources follow one of the same library, so that its text is seldom looked up.
void AnalyseOrder::SourceList::AppendSource(const Source& source) {
  const std::shared_ptr<const Kel_Key>& library = source.origin->library;
  std::size_t position = libraries.size() - 1;
  // The pointers are compared: sources that are made one after another share the key.
  if (libraries.empty() || libraries.back().key != library) {
    const auto [known, isNew] =
        libraryIndex.try_emplace(library->GetKey().View(), libraries.size());
    if (isNew) libraries.push_back({library, {}});
    position = known->second;
  }
  libraries[position].sources.push_back(&source);
}

AnalyseOrder::SourcePointers AnalyseOrder::SourceList::Append(const SourceList& other) {
  SourcePointers known;
  for (const Library& library : other.libraries) {
    for (const Source* const source : library.sources) {
      if (sourcesByKey.try_emplace(source->fileKey.View(), source).second) {
        AppendSource(*source);
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

AnalyseOrder::Earlier AnalyseOrder::Add(const Source& source, bool forSynthesis,
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

const AnalyseOrder::IncludeDirectory* AnalyseOrder::Add(const IncludeDirectory& directory) {
  const auto [known, isNew] =
      directoriesByLibrary.try_emplace(directory.library.GetKey().View(), &directory);
  if (!isNew) return known->second;
  includeDirectories.push_back(&directory);
  return nullptr;
}

AnalyseOrder::Known AnalyseOrder::Append(const AnalyseOrder& other) {
  // One list for both purposes goes on only while neither side has told them apart.
  if (other.simulation) PartLists();
  Known known;
  known.synthesis = synthesis.Append(other.GetSynthesis());
  known.isParted = simulation != nullptr;
  if (known.isParted) known.simulation = simulation->Append(other.GetSimulation());
  for (const IncludeDirectory* const directory : other.includeDirectories) Add(*directory);
  return known;
}

bool AnalyseOrder::IsEmpty() const {
  return GetSynthesis().libraries.empty() && GetSimulation().libraries.empty() &&
         includeDirectories.empty();
}

const AnalyseOrder::IncludeDirectory* AnalyseOrder::FindIncludeDirectory(
    const Kel_Key& library) const {
  const auto found = directoriesByLibrary.find(library.GetKey().View());
  return found == directoriesByLibrary.end() ? nullptr : found->second;
}

// From here on the list for simulation is its own.
void AnalyseOrder::PartLists() {
  if (!simulation) simulation = std::make_unique<SourceList>(synthesis);
}

}  // namespace Tarvo
