#ifndef TARVO_KEL_INDEX_H
#define TARVO_KEL_INDEX_H

#include <map>
#include <unordered_map>
#include <utility>
#include <vector>

#include "Port_File.h"
#include "Port_FileName.h"
#include "Tarvo_Export.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

// The catalogue of what repositories hold: for each core its versions, newest first, each with the
// directory that it lies in (its location) and, if its core description could be read, its options.
//
// A key that is not valid stands for a bare core name: lookups answer for that core's newest
// version. A valid key is found only as that very version.
//
// Lookups that find nothing throw AppException with level NotFound; nothing is caught here. Any
// operation that stores or builds text may throw std::bad_alloc.
//
// Lifetime: an index must outlive the instances and parsers that keep a reference to it, as their
// headers say. Threads: for one at a time.
class TARVO_EXPORT Kel_Index {
 public:
  // The layout of a repository, REPOSITORY/ipmods/KEY/..., where KEY names a version directory:
  //
  //     data/NAME_v2_1_0.qvr   core description      hdl/vhdl/      VHDL sources
  //     data/NAME_v2_1_0.ldx   analyse order         hdl/verilog/   Verilog sources
  //     data/NAME_v2_1_0.tew   netlist table         netlist/       netlists
  //
  // NAME is the core's base name, and `_v2_1_0` the version of the family of data files, the same
  // for every core.
  static const StringBase KEL_VERSIONS_SUBDIRECTORY;  // ipmods
  static const StringBase KEL_VERSION;                // _v2_1_0
  static const StringBase KEL_QVR_EXTENSION;
  static const StringBase KEL_LDX_EXTENSION;
  static const StringBase KEL_TEW_EXTENSION;
  static const StringBase KEL_DATA_SUBDIRECTORY;
  static const StringBase KEL_NETLIST_SUBDIRECTORY;
  static const StringBase KEL_HDL_SUBDIRECTORY;
  static const StringBase KEL_VHDL_SUBDIRECTORY;
  static const StringBase KEL_VERILOG_SUBDIRECTORY;

  // The name of a version's data file with that extension, given without its dot. The location must
  // hold a directory alone, as FileName::SetHead makes it. Whether the file exists is not asked.
  static Port::FileName GetDataFile(const Port::FileName& location, const Kel_Key& key,
                                    const StringBase& extension);

  // An empty index.
  Kel_Index();
  ~Kel_Index();
  Kel_Index(const Kel_Index&) = delete;
  Kel_Index& operator=(const Kel_Index&) = delete;

  // Adds a version at a location, which must hold a directory alone, as FileName::SetHead makes it.
  // False, with an error issued and nothing changed, for an invalid key or a location that does not
  // exist. The first location added for a key wins: adding it again gives true and changes nothing.
  // Of keys that differ in text but not in version, such as `abc_v1_00_a` and `abc_v01_00_a`, the
  // one added later stands in front.
  //
  // Throws AppException if the version's core description exists but can't be read or parsed. Then,
  // and when memory runs out while it is read, the version is there, without options.
  bool AddIP(const Kel_Key& key, const Port::FileName& location);
  // The same for a version whose core description, by that name, was looked for already.
  bool AddIP(const Kel_Key& key, const Port::FileName& location, const Port::FileName& description,
             Port::FoundFile found);

  // Empties the index.
  void ClearIP();

  // Among the versions whose core description could be read: the number of cores, and of versions.
  unsigned int GetBaseIPCount() const;
  unsigned int GetFullIPCount() const;

  // The options of a version, in the order of OptionScanner::GetOptions. Only versions whose
  // core description could be read have any, so a bare name may stand for an older version here
  // than in the lookups below. The reference stays good until ClearIP or the end of the index.
  // Throws AppException.
  const PropertyList& GetIPOptions(const Kel_Key& key) const;

  // The keys of all versions that have options, and of the newest such version of each core,
  // in the order of their bytes, each once.
  StringList GetAllIPKeys() const;
  StringList GetLatestIPKeys() const;

  // The directory of a version, and its key as it was added. Versions without a core description
  // are found too. Throw AppException.
  Port::FileName GetIPLocation(const Kel_Key& key) const;
  Kel_Key GetIPKey(const Kel_Key& key) const;

  // A version: its key as it was added, and its directory.
  using Version = std::pair<const Kel_Key, Port::FileName>;
  // Both of these at once, or null for what is not in the index. Good until ClearIP or the end of
  // the index.
  const Version* FindVersion(const Kel_Key& key) const;

  // The keys of all versions that have a location, those without options too, in the order of their
  // bytes.
  StringList GetAllVersionKeys() const;

  // The directories of a version that were added after its first one, which hides them, in the
  // order in which they came. Empty for a key that is not in the index.
  std::vector<Port::FileName> GetHiddenLocations(const Kel_Key& key) const;

 private:
  struct NewestFirst {
    bool operator()(const Kel_Key& left, const Kel_Key& right) const { return right < left; }
  };
  // By base name, the versions of that core. No list is ever empty.
  template <class Value>
  using Table = std::unordered_map<StringBase, std::multimap<Kel_Key, Value, NewestFirst>>;

  TARVO_LOCAL void AddIPOptions(const Kel_Key& key, const Port::FileName& description,
                                Port::FoundFile found);

  Table<Port::FileName> locations;
  std::vector<std::pair<Kel_Key, Port::FileName>> hidden;  // in the order in which they came
  Table<PropertyList> options;
};

}  // namespace Tarvo

#endif
