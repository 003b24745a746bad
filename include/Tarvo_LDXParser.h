#ifndef TARVO_LDXPARSER_H
#define TARVO_LDXPARSER_H

#include <cstddef>
#include <memory>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include "Port_FileName.h"
#include "Tarvo_Export.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

class Kel_Index;

// The analyse order of a core: which HDL sources make it up, its own and those of other cores, in
// which order a compiler takes them, for synthesis and for simulation.
//
//     const Tarvo::LDXParser order(index, key, Tarvo::Kel_Key(), "VHDL");
//     for (const auto& source : order.ListSynthesisAnalyseOrder()) std::cout << source << '\n';
//
// The file has an entry on a line; `#` begins a comment, and quotes make one field of several
// words. LIBRARY is the key of a core version, or a bare name for the newest one.
//
//     lib LIBRARY FILE [LANGUAGE]      a source, for synthesis and simulation
//     synlib, simlib                   the same for one of them
//     lib LIBRARY all                  all sources that the library's own file lists, for both
//     vlgincdir LIBRARY DIRECTORY      where a library's Verilog includes lie, below this core
//
// A source lies in `hdl/vhdl` or `hdl/verilog` below its library's directory. Which of them, its
// extension tells (`vhd`, `v`), or else its language; a name without an extension gets that of its
// language. A source without a LANGUAGE has that of the core whose file is read:
//
//     VHDL, Verilog    the core's
//     MIXED            VHDL
//     BOTH             by its extension; a LANGUAGE is an error, and the source is left out
//     anything else    by its extension; a LANGUAGE is taken
//
// Languages are compared in any letter case. An entry with an unknown LANGUAGE is left out with an
// error, a source that is listed already with a warning, or with a trace if an `all` brings it; the
// order is good all the same. Any other fault makes the whole file bad: a line of another form, an
// extension against the language, a library that is not in the index, an include directory that
// does not exist or is given twice, a bad file of a core that is included.
//
// Libraries stand in the order in which each got its first source, and the sources of a library
// stand together, in the order in which they were added. What an `all` adds stands at its place.
// Each source stands once, its first place counts: sources are told apart by their library and the
// text of their name below the language's directory. Synthesis and simulation are independent of
// each other. No file is asked whether it exists.
//
// Everything is read by the constructor, the files of included cores too; a core that is reached
// twice is read twice. The queries look at no file.
//
// Failures: reading and asking may throw std::bad_alloc; so that it can be read, a line must be
// shorter than 4 GiB. A path throws std::filesystem::filesystem_error if the repository was given
// relative to a current directory that is gone.
//
// Lifetime: the index must outlive the parser. It must not change while the parser is made; later
// only the lists of libraries and GetVerilogIncludeLocation ask it. Threads: for one at a time,
// together with the index. Stack: an included core takes about 1.5 KiB while it is read.
class TARVO_EXPORT LDXParser {
 public:
  static const StringBase LDX_HDL_VERILOG;
  static const StringBase LDX_HDL_VHDL;
  static const StringBase LDX_HDL_BOTH;
  static const StringBase LDX_HDL_MIXED;

  // Reads the analyse order of a version. The root is the version for which a whole analysis is
  // made, and which nothing below may include; callers pass an invalid key, which stands for the
  // version itself. The language is the value of the core's option HDL.
  //
  // Throws AppException with level NotFound for a key that is not in the index, and with level
  // Failure for the key of the root, if the file is missing, can't be read or has a bad line, or if
  // cores include each other in a circle or nest deeper than 1,000 levels. What is wrong with a
  // line was then issued as a message, with the line itself last.
  LDXParser(const Kel_Index& theIndex, const Kel_Key& version, const Kel_Key& root,
            const StringBase& language);
  // The same for a file of any name, taken for that of the version, which the index needs to know
  // only for a `vlgincdir`.
  LDXParser(const Port::FileName& ldxFile, const Kel_Index& theIndex, const Kel_Key& version,
            const Kel_Key& root, const StringBase& language);
  ~LDXParser();
  LDXParser(const LDXParser&) = delete;
  LDXParser& operator=(const LDXParser&) = delete;

  // The language that a file's extension tells, whatever its entry said: LDX_HDL_VERILOG,
  // LDX_HDL_VHDL, or empty.
  StringBase GetFileLanguage(const Port::FileName& file) const;

  // The library of a listed source, found by the levels of its path from the version's directory
  // on, which must bear the key's normal text. An invalid, empty key for any other file, for a
  // source in a directory of its own that is named `vhdl` or `verilog`, and for one whose entry
  // names it with a slash at either end or with a doubled one.
  Kel_Key GetFileLibrary(const Port::FileName& file) const;

  // The absolute path of a library's Verilog include directory: the one that an entry gives it, or
  // else the library's own directory. Throws AppException with level NotFound for a library that
  // has none and is not in the index.
  StringBase GetVerilogIncludeLocation(const StringBase& library) const;

  // The absolute directories of the libraries, in order. Throw AppException with level NotFound for
  // a library that has left the index since.
  StringList ListSynthesisLibraries() const;
  StringList ListSimulationLibraries() const;

  // The absolute paths of the sources, library by library, in order.
  StringList ListSynthesisAnalyseOrder() const;
  StringList ListSimulationAnalyseOrder() const;

  // The libraries that entries give an include directory, as the entries name them: a bare name
  // stays bare.
  StringList ListVerilogIncludeLibraryKeys() const;

 private:
  using KeyPointer = std::shared_ptr<const Kel_Key>;

  // A source, and its file key: its library, a blank, and its name below the language's directory,
  // as its location gives them, and as its entry does if that is another text.
  struct Source {
    KeyPointer library;
    Port::FileName location;
    StringBase fileKey;
    StringBase entryKey;
  };
  // Made once, and then handed from parser to parser.
  using SourcePointer = std::shared_ptr<const Source>;
  using SourcePointers = std::vector<SourcePointer>;

  struct Library {
    KeyPointer key;
    SourcePointers sources;
  };
  // Where an entry's source lies, which the next one mostly shares: its library, as the entry
  // writes it and as the index knows it, and the directory of its language there.
  struct Place {
    StringBase text;
    KeyPointer key;
    Port::FileName location;
    StringBase subdirectory;
    StringBase directory;
    StringBase fileKeyStart;
  };

  // The lists for one purpose. No library is without sources.
  class TARVO_LOCAL Side {
   public:
    // Adds a source under the key of its entry. False, with nothing changed, if that is there.
    bool Add(const SourcePointer& source);
    // Adds the sources of another side, which is of no use afterwards, under the keys of their
    // locations. Gives those whose keys were there.
    SourcePointers Merge(Side& other);
    // The library of the source with that file key, or null.
    const Kel_Key* FindLibrary(const StringBase& fileKey) const;
    StringList ListSources() const;

    std::vector<Library> libraries;

   private:
    void Append(const SourcePointer& source);

    // Views of the texts in keys and sources that the libraries hold.
    std::unordered_map<std::string_view, std::size_t> positions;  // by the library's key text
    std::unordered_map<std::string_view, const Source*> owners;   // by file key
    bool byLocation = true;  // whether all keys of owners are those of locations
  };

  TARVO_LOCAL LDXParser(const Port::FileName& ldxFile, const Kel_Index& theIndex,
                        const Kel_Key& version, const Kel_Key& root, StringBase language,
                        const LDXParser* outer);

  TARVO_LOCAL void CheckNesting() const;
  TARVO_LOCAL void Parse(const Port::FileName& ldxFile);
  TARVO_LOCAL bool ParseLibraryEntry(std::string_view line);
  TARVO_LOCAL bool ParsePathEntry(std::string_view line);
  TARVO_LOCAL bool AddFile(std::string_view keyword, std::string_view library,
                           const StringBase& file, const StringBase& language);
  TARVO_LOCAL void AddSource(std::string_view keyword, const SourcePointer& source);
  TARVO_LOCAL void WarnOfSecond(const Source& source, const char* side) const;
  TARVO_LOCAL void PartSides();
  TARVO_LOCAL const Side& Simulation() const;
  TARVO_LOCAL void LocateLibrary(std::string_view library);
  TARVO_LOCAL void EnterDirectory(const StringBase& subdirectory);
  TARVO_LOCAL Source MakeSource(const Port::FileName& name,
                                const StringBase& missingExtension) const;
  TARVO_LOCAL bool AnalyseLibrary(const StringBase& library);
  TARVO_LOCAL StringBase LanguageOf(const Kel_Key& library) const;
  TARVO_LOCAL void MergeSides(LDXParser& nested);
  TARVO_LOCAL void TraceKnown(const SourcePointers& sources, const char* side,
                              const LDXParser& nested) const;
  TARVO_LOCAL void MergeIncludeDirectories(const LDXParser& nested);
  TARVO_LOCAL const Port::FileName* FindIncludeDirectory(const Kel_Key& library) const;
  TARVO_LOCAL StringList ListDirectories(const Side& side) const;

  const Kel_Index& index;
  Kel_Key key;   // as given
  Kel_Key core;  // the version that it stands for
  Kel_Key rootKey;
  StringBase hdl;
  const LDXParser* enclosing;  // the parser that includes this one; null at the top
  unsigned level;              // 1 at the top
  Side synthesis;
  std::unique_ptr<Side> simulation;  // null while it is the same as for synthesis
  std::vector<std::pair<Kel_Key, Port::FileName>> includeDirectories;
  Place latest;  // of the entry before; without a key at first
};

}  // namespace Tarvo

#endif
