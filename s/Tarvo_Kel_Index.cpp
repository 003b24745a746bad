// Two tables, one of locations and one of options, each by base name and then by version, newest
// first. A version whose description is bad stands in the first alone.

#include "Tarvo_Kel_Index.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "Tarvo_Existence.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_Report.h"

namespace Tarvo {

using Port::FileName;

const StringBase Kel_Index::KEL_VERSIONS_SUBDIRECTORY = "ipmods";
const StringBase Kel_Index::KEL_VERSION = "_v2_1_0";
const StringBase Kel_Index::KEL_QVR_EXTENSION = "qvr";
const StringBase Kel_Index::KEL_LDX_EXTENSION = "ldx";
const StringBase Kel_Index::KEL_TEW_EXTENSION = "tew";
const StringBase Kel_Index::KEL_DATA_SUBDIRECTORY = "data";
const StringBase Kel_Index::KEL_NETLIST_SUBDIRECTORY = "netlist";
const StringBase Kel_Index::KEL_HDL_SUBDIRECTORY = "hdl";
const StringBase Kel_Index::KEL_VHDL_SUBDIRECTORY = "vhdl";
const StringBase Kel_Index::KEL_VERILOG_SUBDIRECTORY = "verilog";

namespace {

constexpr Report::Module kModule{"s/Tarvo_Kel_Index", "1.0"};

// Room for the cores of a usual library, so that the tables seldom grow.
constexpr std::size_t kBucketHint = 100;

// The keys of the entries that `gather` adds from each list, sorted, each once.
template <class Table, class Gather>
StringList SortedKeys(const Table& table, const Gather& gather) {
  StringList keys;
  for (const auto& core : table) gather(core.second, keys);
  std::sort(keys.begin(), keys.end());
  keys.erase(std::unique(keys.begin(), keys.end()), keys.end());
  return keys;
}

constexpr auto AppendAll = [](const auto& versions, StringList& keys) {
  for (const auto& version : versions) keys.push_back(version.first.GetKey());
};

// The entry of this very key: entries of equal versions stand together.
template <class Versions>
auto FindKey(Versions& versions, const Kel_Key& key) {
  const auto [first, last] = versions.equal_range(key);
  const auto found =
      std::find_if(first, last, [&](const auto& entry) { return entry.first == key; });
  return found == last ? versions.end() : found;
}

// The entry that a key stands for, or null.
template <class Table>
auto Find(const Table& table, const Kel_Key& key) {
  const typename Table::mapped_type::value_type* entry = nullptr;
  const auto core = table.find(key.GetName());
  if (core == table.end()) return entry;
  const auto& versions = core->second;
  // A bare name stands for the front of the list. A full key never stands for another version,
  // however much newer that is.
  const auto found = key.IsValid() ? FindKey(versions, key) : versions.begin();
  if (found != versions.end()) entry = &*found;
  return entry;
}

// The entry of a key, and whether it was added just now.
template <class Versions>
struct Insertion {
  typename Versions::iterator entry;
  bool isNew;
};

// Adds the entry, in front of the entries of equal versions, unless its key is there already.
template <class Versions, class Value>
Insertion<Versions> InsertVersion(Versions& versions, const Kel_Key& key, Value value) {
  const auto known = FindKey(versions, key);
  if (known != versions.end()) return {known, false};
  return {versions.emplace_hint(versions.lower_bound(key), key, std::move(value)), true};
}

// The same, by base name. A new list goes again if memory runs out for its first entry: none is
// empty.
template <class Table, class Value>
Insertion<typename Table::mapped_type> Insert(Table& table, const Kel_Key& key, Value value) {
  const auto [core, isNewCore] = table.try_emplace(key.GetName());
  try {
    return InsertVersion(core->second, key, std::move(value));
  } catch (...) {
    if (isNewCore) table.erase(core);
    throw;
  }
}

void TellRefused(const Kel_Key& key, const FileName& location) {
  Diagnosis::Add([&] {
    return key.IsValid() ? Diagnosis::Of(Codes::kUnreadable, location.GetName(),
                                         "the directory can't be read")
                         : Diagnosis::Of(Codes::kNotAKey, location.GetName(),
                                         "its name is not a version's key");
  });
}

}  // namespace

FileName Kel_Index::GetDataFile(const FileName& location, const Kel_Key& key,
                                const StringBase& extension) {
  StringBase base = key.GetName();
  base.Append(KEL_VERSION);
  FileName file = location;
  file.PushPathEnd(KEL_DATA_SUBDIRECTORY);
  // In this order: setting the base takes an extension away.
  file.SetBase(base);
  file.SetExtension(extension);
  return file;
}

Kel_Index::Kel_Index() : locations(kBucketHint), options(kBucketHint) {
  locations.max_load_factor(1.0F);
  options.max_load_factor(1.0F);
}

Kel_Index::~Kel_Index() = default;

bool Kel_Index::AddIP(const Kel_Key& key, const FileName& location) {
  const FileName description = GetDataFile(location, key, KEL_QVR_EXTENSION);
  return AddIP(key, location, description,
               key.IsValid() ? Port::FoundFile(description.GetName()) : Port::FoundFile());
}

// A description that is there shows that its location is there too: the disk is asked once for most
// versions.
bool Kel_Index::AddIP(const Kel_Key& key, const FileName& location, const FileName& description,
                      Port::FoundFile found) {
  const Existence described = found.GetExistence();
  if (!key.IsValid() || (described != Existence::Yes && !Exists(location))) {
    TellRefused(key, location);
    kModule.Error("Invalid IP index entry %s at %s\n", key.GetKey(), location.GetName());
    return false;
  }
  const auto inserted = Insert(locations, key, location);
  if (!inserted.isNew) {
    TARVO_TRACE("Duplicate IP index entry %s at %s\nPrecedence given to %s\n", key.GetKey(),
                location.GetName(), inserted.entry->second.GetName());
    // No lookup sees it; it is kept for who asks what is hidden.
    hidden.emplace_back(key, location);
  } else if (described == Existence::No) {
    TARVO_TRACE("Unable to define options for IP %s at %s\n", key.GetKey(), location.GetName());
  } else {
    AddIPOptions(key, description, std::move(found));
    return true;
  }
  TARVO_TRACE("Library IP %s found at %s\n", key.GetKey(), location.GetName());
  return true;
}

// The reader throws for a bad description. The version is in `locations` by then, and stays there
// without options.
void Kel_Index::AddIPOptions(const Kel_Key& key, const FileName& description,
                             Port::FoundFile found) {
  PropertyList taken = OptionScanner(key, description, std::move(found)).TakeOptions();
  const auto first = std::make_move_iterator(taken.begin());
  const auto last = std::make_move_iterator(taken.end());
  Insert(options, key, PropertyList(first, last));  // without the room for more
}

void Kel_Index::ClearIP() {
  locations.clear();
  options.clear();
  hidden.clear();
}

unsigned int Kel_Index::GetBaseIPCount() const { return static_cast<unsigned>(options.size()); }

unsigned int Kel_Index::GetFullIPCount() const {
  std::size_t count = 0;
  for (const auto& core : options) count += core.second.size();
  return static_cast<unsigned>(count);
}

const PropertyList& Kel_Index::GetIPOptions(const Kel_Key& key) const {
  const auto* const entry = Find(options, key);
  if (entry) return entry->second;
  throw Report::Exception(AppException::NotFound, "Cannot find IP index entry for %s\n",
                          key.GetKey());
}

StringList Kel_Index::GetAllIPKeys() const { return SortedKeys(options, AppendAll); }

StringList Kel_Index::GetAllVersionKeys() const { return SortedKeys(locations, AppendAll); }

std::vector<FileName> Kel_Index::GetHiddenLocations(const Kel_Key& key) const {
  std::vector<FileName> found;
  const auto* const entry = Find(locations, key);
  if (!entry) return found;
  // Few versions are hidden, so one list for all is enough.
  for (const auto& [hiddenKey, location] : hidden) {
    if (hiddenKey == entry->first) found.push_back(location);
  }
  return found;
}

StringList Kel_Index::GetLatestIPKeys() const {
  return SortedKeys(options, [](const auto& versions, StringList& keys) {
    keys.push_back(versions.begin()->first.GetKey());
  });
}

const Kel_Index::Version* Kel_Index::FindVersion(const Kel_Key& key) const {
  return Find(locations, key);
}

FileName Kel_Index::GetIPLocation(const Kel_Key& key) const {
  const Version* const version = FindVersion(key);
  if (version) return version->second;
  throw Report::Exception(AppException::NotFound, "Cannot find IP index entry for %s\n",
                          key.GetKey());
}

Kel_Key Kel_Index::GetIPKey(const Kel_Key& key) const {
  const Version* const version = FindVersion(key);
  if (version) return version->first;
  throw Report::Exception(AppException::NotFound, "Cannot find IP key for %s\n", key.GetKey());
}

}  // namespace Tarvo
