#ifndef TARVO_TEWPARSER_H
#define TARVO_TEWPARSER_H

#include <cstddef>
#include <string_view>
#include <unordered_set>
#include <vector>

#include "Port_FileName.h"
#include "Tarvo_Export.h"
#include "Tarvo_KelRecords.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

class FileScanner;
class Kel_Index;
class QVRParser;

// The netlists of a core: a table that says which of them apply at which values of the core's
// parameters. It is read once; each query selects the rows whose values equal, as texts, those that
// the parameters have at that moment.
//
//     const Tarvo::QVRParser description(index, key);
//     const Tarvo::TEWParser netlists(index, key, &description);
//     for (const auto& netlist : netlists.ListFiles()) std::cout << netlist << '\n';
//
// The file has a header and rows; `#` begins a comment.
//
//     MODE WIDTH FILES              names of parameters, and FILES in any letter case
//     fast 32    a.edn, b.edn       a value for each of them, then one or more netlists
//     fast 64    OTHER:sub/c.edn    a netlist of another core, by its key or bare name
//     "a b" ''   "my file.edn"      quotes for what holds blanks or commas, or is empty
//
// Values stand apart by blanks, netlists by commas. What stands behind FILES, and behind the last
// netlist, is ignored. Netlists lie in the `netlist` directory of their core, the library; whether
// one exists is not asked.
//
// A line that fails as the header is an error, unless it begins with a quote that is not closed,
// and the next line gets its turn. So a table may be good after errors; the names of such lines
// stay as columns.
//
// Failures: reading and asking may throw std::bad_alloc. A path throws
// std::filesystem::filesystem_error if the repository was given relative to a current directory
// that is gone.
//
// Costs: each query asks for the parameter of each column. GetFileLibrary then looks at the
// netlists that are called like the file, and the other queries at all rows.
//
// Lifetime: the index and the description must outlive the parser. Threads: like an int, together
// with these two; nobody may set a parameter while the parser is asked.
class TARVO_EXPORT TEWParser {
 public:
  // Reads the table of a version. The description may be null; then only a table without parameters
  // can be read. Throws AppException with level NotFound for a key, or the library of a netlist,
  // that is not in the index, and with level Failure if the file can't be read, has no usable
  // header or a bad row.
  TEWParser(const Kel_Index& theIndex, const Kel_Key& key, const QVRParser* description);
  // The same for a file of any name, taken for that of the version.
  TEWParser(const Port::FileName& file, const Kel_Index& theIndex, const Kel_Key& key,
            const QVRParser* description);
  ~TEWParser();
  TEWParser(const TEWParser&) = delete;
  TEWParser& operator=(const TEWParser&) = delete;

  // The absolute paths of the selected netlists, in the order of the table. One that stands in
  // several selected rows is listed for each.
  StringList ListFiles() const;

  // The absolute directories of the libraries of the selected netlists, in the order of their
  // bytes, each once. Throws AppException with level NotFound for a library that has left the index
  // since.
  StringList ListLibraries() const;

  // The library of a selected netlist, whose absolute path must be the very text of ListFiles.
  // Throws AppException with level Failure for any other file, and as ListLibraries does.
  Kel_Key GetFileLibrary(const Port::FileName& file) const;

  // The whole table, a row for each of the file's, in its order; those that are selected now are
  // marked. Throws what ListFiles throws.
  KelNetlistTable GetTable() const;

 private:
  struct Netlist {
    Kel_Key library;
    Port::FileName location;
  };
  struct Row {
    StringList values;
    std::vector<Netlist> netlists;
    StringBase ignored;
    unsigned line;
  };
  // Where a netlist stands, by the hash of the last component of its path.
  struct Place {
    std::size_t tail;
    unsigned row;
    unsigned netlist;
  };

  using NameSet = std::unordered_set<StringBase>;

  TARVO_LOCAL void Parse(const Port::FileName& file, const Kel_Key& key);
  TARVO_LOCAL void TellMissingHeader() const;
  TARVO_LOCAL bool ParseHeader(const FileScanner& lines, std::string_view line,
                               const NameSet& parameters);
  TARVO_LOCAL bool ParseRow(const FileScanner& lines, std::string_view line, const Kel_Key& key);
  TARVO_LOCAL Netlist MakeNetlist(const FileScanner& lines, std::string_view text,
                                  const Kel_Key& key) const;
  TARVO_LOCAL void MakePlaces();
  TARVO_LOCAL StringList ListParameters() const;
  TARVO_LOCAL StringList GetParameterValues() const;
  TARVO_LOCAL std::vector<const Netlist*> Select() const;
  TARVO_LOCAL std::vector<const Netlist*> SelectCalledLike(const StringBase& path) const;
  TARVO_LOCAL bool HavePaths() const;

  const Kel_Index& index;
  const QVRParser* qvrParser;
  StringBase tewFile;
  bool isHeaderTold = false;  // while reading: whether a diagnostic says what is wrong with it
  StringList headerNames;
  std::vector<Row> rows;
  std::vector<Place> places;  // sorted
  bool hasRelative = false;   // whether a location needs the current directory
};

}  // namespace Tarvo

#endif
