// An order is what its cores' parts add up to, so nothing here copies a source: lists hold pointers
// and tables hold views of what the parts own, and synthesis and simulation are one list until they
// differ.

#include "Tarvo_AnalyseOrder.h"

#include <algorithm>
#include <functional>
#include <utility>

namespace Tarvo {

// The text behind the library, which for all but odd names is that of the path below the directory.
Port::FileName AnalyseOrder::Source::GetLocation() const {
  if (odd) return odd->location;
  StringBase name = origin->directory;
  name.Append("/");
  const std::string_view below = fileKey.substr(nameAt);
  name.Append(below.data(), static_cast<unsigned>(below.size()));
  return Port::FileName(name);
}

namespace {

// Of the standard library's hash 32 bits are enough: whoever shares them is told apart by the key.
std::uint32_t HashOf(std::string_view key) {
  return static_cast<std::uint32_t>(std::hash<std::string_view>()(key));
}

}  // namespace

// The slot of the key, or the free one where it belongs. There is always a free one.
std::size_t AnalyseOrder::KeyTable::Probe(std::string_view key, std::uint32_t hash) const {
  const std::size_t mask = slots.size() - 1;
  std::size_t at = hash & mask;
  while (slots[at].source && (slots[at].hash != hash || slots[at].GetKey() != key)) {
    at = (at + 1) & mask;
  }
  return at;
}

const AnalyseOrder::Source* AnalyseOrder::KeyTable::Add(std::string_view key,
                                                        const Source& source) {
  if (slots.size() * 2 <= count * 3) Grow();
  const std::uint32_t hash = HashOf(key);
  Slot& slot = slots[Probe(key, hash)];
  if (slot.source) return slot.source;
  slot = {&source, hash, key != source.fileKey};
  ++count;
  return nullptr;
}

const AnalyseOrder::Source* AnalyseOrder::KeyTable::Find(std::string_view key) const {
  return slots.empty() ? nullptr : slots[Probe(key, HashOf(key))].source;
}

// The hashes are kept, so that no key is looked at again.
void AnalyseOrder::KeyTable::Grow() {
  constexpr std::size_t kFirstSize = 64;
  const std::vector<Slot> former =
      std::exchange(slots, std::vector<Slot>(std::max(kFirstSize, slots.size() * 2)));
  const std::size_t mask = slots.size() - 1;
  for (const Slot& slot : former) {
    if (!slot.source) continue;
    std::size_t at = slot.hash & mask;
    while (slots[at].source) at = (at + 1) & mask;
    slots[at] = slot;
  }
}

const AnalyseOrder::Source* AnalyseOrder::SourceList::Add(const Source& source) {
  const Source* const known = sourcesByKey.Add(source.GetEntryKey(), source);
  if (!known) AppendSource(source);
  return known;
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
      if (sourcesByKey.Add(source->fileKey, *source)) {
        known.push_back(source);
      } else {
        AppendSource(*source);
      }
    }
  }
  return known;
}

const AnalyseOrder::Source* AnalyseOrder::SourceList::Find(std::string_view fileKey) const {
  return sourcesByKey.Find(fileKey);
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
