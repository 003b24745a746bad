#include "Tarvo_TEWParser.h"

#include <algorithm>
#include <string_view>
#include <utility>

#include "Tarvo_FileScanner.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_Report.h"
#include "Tarvo_TokenReader.h"
#include "Tarvo_Word.h"

namespace Tarvo {

using Port::FileName;

// A table: a header that names parameters, and rows with a value for each of them and netlists.
//
//     MODE WIDTH FILES
//     fast 32    a.edn, b.edn
//     fast 64    OTHER_CORE:c.edn
//
// Values may be quoted. What stands behind FILES, and behind the last netlist, is ignored.
namespace {

constexpr Report::Module kModule{"s/Tarvo_TEWParser", "1.0"};

const char* const kDelimiters = " ,\"'";
const char* const kEndOfHeader = "FILES";

TokenReader Cut(std::string_view line) {
  return TokenReader(line, kDelimiters, TokenReader::WithoutGroups);
}

// Goes behind a comma that something follows. False at the end of a row's netlists.
bool NextFile(TokenReader& tokens) {
  if (!tokens.MoreTokens() || tokens.GetToken() != ",") return false;
  tokens.Step();
  return tokens.MoreTokens();
}

}  // namespace

TEWParser::TEWParser(const Kel_Index& theIndex, const Kel_Key& key, const QVRParser* description)
    : TEWParser(
          Kel_Index::GetDataFile(theIndex.GetIPLocation(key), key, Kel_Index::KEL_TEW_EXTENSION),
          theIndex, key, description) {}

TEWParser::TEWParser(const FileName& tewFile, const Kel_Index& theIndex, const Kel_Key& key,
                     const QVRParser* description)
    : index(theIndex), qvrParser(description) {
  Parse(tewFile, key);
}

TEWParser::~TEWParser() = default;

// A line that fails as the header leaves its turn to the next one; a bad row ends all reading.
void TEWParser::Parse(const FileName& tewFile, const Kel_Key& key) {
  const StringBase name = tewFile.GetName();
  TARVO_TRACE("  Parsing TEW File for %s\n", key.GetKey());
  FileScanner lines(tewFile);
  const StringList names = qvrParser ? qvrParser->ListParameters() : StringList();
  const NameSet parameterNames(names.begin(), names.end());
  std::string_view line;
  unsigned lineNumber = 0;
  Result result = StatesNothing;
  while (result != Read && lines.GetNextLine(line, lineNumber)) {
    result = ParseHeader(line, parameterNames);
    if (result != Unparsable) continue;
    kModule.Error("TEW unparsable header: %s line %d, %s\n", name, lineNumber, StringBase(line));
  }
  while (result == Read && lines.GetNextLine(line, lineNumber)) {
    if (!line.empty()) result = ParseFileEntry(line, key);
    if (result != Unparsable) continue;
    throw Report::Exception(AppException::Failure, "TEW unparsable file entry: %s line %d, %s\n",
                            name, lineNumber, StringBase(line));
  }
  if (result != Read) throw Report::Exception(AppException::Failure, "Invalid TEW %s\n", name);
  TARVO_TRACE("  Parse successful\n");
}

// The names of a line that turns out to be no header stay.
TEWParser::Result TEWParser::ParseHeader(std::string_view line, const NameSet& parameterNames) {
  TokenReader tokens = Cut(line);
  std::string_view field;
  if (!tokens.ReadField(field)) return StatesNothing;
  for (StringBase name(field); !Matches(name, kEndOfHeader); name = StringBase(field)) {
    if (parameterNames.find(name) == parameterNames.end()) return Unparsable;
    headerNames.push_back(std::move(name));
    if (!tokens.ReadField(field)) return Unparsable;
  }
  return Read;
}

// A comma between values is a value itself.
TEWParser::Result TEWParser::ParseFileEntry(std::string_view line, const Kel_Key& key) {
  TokenReader tokens = Cut(line);
  std::string_view field;
  if (!tokens.ReadField(field)) return StatesNothing;
  Row row;
  while (row.values.size() < headerNames.size()) {
    row.values.emplace_back(field);
    if (!tokens.ReadField(field)) return Unparsable;
  }
  row.netlists.push_back(MakeNetlist(field, key));
  while (NextFile(tokens)) {
    if (!tokens.ReadField(field)) return Unparsable;
    row.netlists.push_back(MakeNetlist(field, key));
  }
  rows.push_back(std::move(row));
  return Read;
}

// Reads NAME, or LIBRARY:NAME, cut at the first colon.
TEWParser::Netlist TEWParser::MakeNetlist(std::string_view name, const Kel_Key& key) const {
  std::string_view library = key.GetKey().View();
  const std::size_t colon = name.find(':');
  if (colon != std::string_view::npos) {
    library = name.substr(0, colon);
    name.remove_prefix(colon + 1);
  }
  Netlist netlist;
  netlist.library = index.GetIPKey(Kel_Key(StringBase(library)));
  netlist.location = index.GetIPLocation(netlist.library);
  netlist.location.PushPathEnd(Kel_Index::KEL_NETLIST_SUBDIRECTORY);
  netlist.location.SetTail(StringBase(name));
  return netlist;
}

StringList TEWParser::GetParameterValues() const {
  StringList values;
  if (!qvrParser) return values;
  for (const StringBase& name : headerNames) {
    values.push_back(qvrParser->GetParameterProperty(name, QVRParser::QVR_PROPERTY_VALUE));
  }
  return values;
}

std::vector<const TEWParser::Netlist*> TEWParser::Select() const {
  const StringList values = GetParameterValues();
  std::vector<const Netlist*> selected;
  for (const Row& row : rows) {
    if (row.values != values) continue;
    for (const Netlist& netlist : row.netlists) selected.push_back(&netlist);
  }
  return selected;
}

StringList TEWParser::ListFiles() const {
  StringList files;
  for (const Netlist* const netlist : Select()) {
    files.push_back(netlist->location.GetAbsolutePath());
  }
  return files;
}

StringList TEWParser::ListLibraries() const {
  StringList libraries;
  for (const Netlist* const netlist : Select()) {
    libraries.push_back(index.GetIPLocation(netlist->library).GetAbsolutePath());
  }
  std::sort(libraries.begin(), libraries.end());
  libraries.erase(std::unique(libraries.begin(), libraries.end()), libraries.end());
  return libraries;
}

Kel_Key TEWParser::GetFileLibrary(const FileName& file) const {
  const StringBase path = file.GetAbsolutePath();
  for (const Netlist* const netlist : Select()) {
    if (netlist->location.GetAbsolutePath() == path) return index.GetIPKey(netlist->library);
  }
  throw Report::Exception(AppException::Failure,
                          "Could not find netlist %s in order to identify library\n",
                          file.GetName());
}

}  // namespace Tarvo
