#ifndef TARVO_LDXPARSER_H
#define TARVO_LDXPARSER_H

#include <vector>

#include "Port_FileName.h"
#include "Tarvo_AnalyseOrder.h"
#include "Tarvo_Export.h"
#include "Tarvo_KelRecords.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

class Kel_Index;

// The analyse order of a core, or compile order: which HDL sources make it up, its own and those of
// other cores, in which order a compiler takes them, for synthesis and for simulation.
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
// Everything is read by the constructor, the files of included cores too. A core that several ways
// lead to is read once, unless somebody could tell: while the logger is on, and where reading it
// issued a message, it is read for each way. The queries look at no file.
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

  // The library of a listed source. It is found by the part of the path that begins with the
  // version's directory, whose name must be the key in its normal spelling. An invalid, empty key
  // for any other file, for a source within a further directory named `vhdl` or `verilog`, and for
  // one whose entry names it with a slash at either end or with `//`.
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

  // The same sources, in the same order, each with its library, its language and the place of its
  // entry; the include directories, and the cores whose whole order the core's own file takes in,
  // in the order of their entries.
  std::vector<KelSource> GetSynthesisSources() const;
  std::vector<KelSource> GetSimulationSources() const;
  std::vector<KelIncludeDirectory> GetVerilogIncludeDirectories() const;
  std::vector<KelInclude> GetIncludes() const;

 private:
  const Kel_Index& index;
  AnalyseOrder order;
};

}  // namespace Tarvo

#endif
