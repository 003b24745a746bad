#ifndef TARVO_ANALYSEORDER_H
#define TARVO_ANALYSEORDER_H

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "Port_FileName.h"
#include "Tarvo_Export.h"
#include "Tarvo_KelDiagnostic.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

class OrderPart;

// An analyse order (a compile order, as many say): the sources for synthesis and for simulation,
// the Verilog include directories, and the cores that were taken in. A plain value that LDXParser
// fills and answers from; callers ask that class.
//
// A source is known by a text, its file key: its library and its name below the language's
// directory. It is made in two ways. An entry's source is looked up by the name as the entry writes
// it; a source that comes from another core's order, and one that a caller asks for, by what its
// location tells. Both give the same text but for odd names, such as one with a doubled slash: then
// entry and location have different keys, and one file counts as two.
class AnalyseOrder {
 public:
  // What the sources of consecutive entries usually have in common.
  struct Origin {
    std::shared_ptr<const Kel_Key> library;
    std::shared_ptr<const StringBase> file;  // that lists them
    StringBase language;                     // as settled
    StringBase directory;                    // of the language
  };
  // Where on its file an entry names what it adds.
  struct Mark {
    KelPlace In(const StringBase& file) const { return {file, line, column, length}; }

    unsigned line;
    unsigned column;
    unsigned length;
  };
  // What only a source with an odd name has.
  struct OddName {
    Port::FileName location;
    StringBase entryKey;  // its file key by its entry
  };
  // Held by the part that it was read into, with all that it points at.
  struct Source {
    Port::FileName GetLocation() const;
    std::string_view GetEntryKey() const { return odd ? odd->entryKey.View() : fileKey; }

    const Origin* origin = nullptr;
    std::string_view fileKey;      // by its location
    const OddName* odd = nullptr;  // null for most
    Mark mark = {};
    unsigned nameAt = 0;  // where in its file key its name below the language's directory begins
    bool forSynthesis = false;  // what its entry added it for
    bool forSimulation = false;
  };
  using SourcePointers = std::vector<const Source*>;

  struct Library {
    std::shared_ptr<const Kel_Key> key;
    SourcePointers sources;
  };

  // Sources by their file keys, for tables of many: without a block of memory for each.
  class KeyTable {
   public:
    // Adds a source under a key, and gives null. Gives the source that has the key already.
    const Source* Add(std::string_view key, const Source& source);
    const Source* Find(std::string_view key) const;

   private:
    // Free without a source.
    struct Slot {
      std::string_view GetKey() const { return byEntry ? source->GetEntryKey() : source->fileKey; }

      const Source* source = nullptr;
      std::uint32_t hash = 0;
      bool byEntry = false;  // which of its keys it is found by
    };

    std::size_t Probe(std::string_view key, std::uint32_t hash) const;
    void Grow();

    std::vector<Slot> slots;  // a power of two, or none
    std::size_t count = 0;
  };

  // The sources for one purpose, library by library. No library is without sources.
  class SourceList {
   public:
    // Adds a source under the key of its entry, and gives null. If the key is there already, gives
    // the source that has it, and nothing changes.
    const Source* Add(const Source& source);
    // Adds the sources of another list under the keys of their locations. Gives those whose keys
    // were there.
    SourcePointers Append(const SourceList& other);
    // The source with that file key, or null.
    const Source* Find(std::string_view fileKey) const;

    std::vector<Library> libraries;

   private:
    void AppendSource(const Source& source);

    // Views of the texts of keys that the libraries hold.
    std::unordered_map<std::string_view, std::size_t> libraryIndex;
    KeyTable sourcesByKey;
  };

  struct IncludeDirectory {
    Kel_Key library;  // as the entry names it
    Port::FileName location;
    std::shared_ptr<const StringBase> file;
    Mark mark;
  };

  // A core whose whole order an entry takes in.
  struct Include {
    std::shared_ptr<const Kel_Key> from;  // whose file has the entry
    StringBase library;                   // as the entry names it
    std::shared_ptr<const Kel_Key> core;  // as the index has it
    std::shared_ptr<const StringBase> file;
    Mark mark;
  };

  // What stood in the lists already; null where the source is new or was not to be added.
  struct Earlier {
    explicit operator bool() const { return synthesis != nullptr || simulation != nullptr; }

    const Source* synthesis = nullptr;
    const Source* simulation = nullptr;
  };
  struct Known {
    const SourcePointers& ForSimulation() const { return isParted ? simulation : synthesis; }

    SourcePointers synthesis;
    SourcePointers simulation;  // empty while the lists are the same
    bool isParted = false;
  };

  Earlier Add(const Source& source, bool forSynthesis, bool forSimulation);
  // Adds a directory and gives null; gives the one that its library has already, which stays.
  const IncludeDirectory* Add(const IncludeDirectory& directory);
  // Adds the sources and include directories of another order.
  Known Append(const AnalyseOrder& other);

  bool IsEmpty() const;
  const IncludeDirectory* FindIncludeDirectory(const Kel_Key& library) const;

  const SourceList& GetSynthesis() const { return synthesis; }
  const SourceList& GetSimulation() const { return simulation ? *simulation : synthesis; }

  std::vector<const IncludeDirectory*> includeDirectories;
  std::vector<Include> includes;  // of the core's own file, in the order of its lines
  std::vector<Include> further;   // of the files below; for a checker alone
  // What was read, which holds all that the lists point at.
  std::vector<std::shared_ptr<const OrderPart>> parts;

 private:
  void PartLists();

  SourceList synthesis;
  std::unique_ptr<SourceList> simulation;  // null while it is the same as for synthesis
  std::unordered_map<std::string_view, const IncludeDirectory*> directoriesByLibrary;
};

}  // namespace Tarvo

#endif
