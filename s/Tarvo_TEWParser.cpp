// The table is read once and never changes. Which rows apply is found out anew for each question,
// from the parameters as they are then, and so is the absolute path of a netlist, from the current
// directory.

#include "Tarvo_TEWParser.h"

#include <algorithm>
#include <filesystem>
#include <functional>
#include <string_view>
#include <tuple>
#include <utility>

#include "Port_Input.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_Report.h"
#include "Tarvo_TEWLine.h"
#include "Tarvo_TellFault.h"
#include "Tarvo_TellUnknown.h"

namespace Tarvo {

using Port::FileName;

namespace {

constexpr Report::Module kModule{"s/Tarvo_TEWParser", "1.0"};

// The first name that is no parameter, or null.
const std::string_view* FindUnknown(const TEWLine::Header& header,
                                    const std::unordered_set<StringBase>& parameters) {
  for (const std::string_view& name : header.names) {
    if (parameters.find(StringBase(name)) == parameters.end()) return &name;
  }
  return nullptr;
}

// Of what stands behind the last separator, which the current directory in front does not change.
std::size_t HashOfTail(std::string_view path) {
  return std::hash<std::string_view>()(path.substr(path.find_last_of('/') + 1));
}

}  // namespace

TEWParser::TEWParser(const Kel_Index& theIndex, const Kel_Key& key, const QVRParser* description)
    : TEWParser(
          Kel_Index::GetDataFile(theIndex.GetIPLocation(key), key, Kel_Index::KEL_TEW_EXTENSION),
          theIndex, key, description) {}

TEWParser::TEWParser(const FileName& file, const Kel_Index& theIndex, const Kel_Key& key,
                     const QVRParser* description)
    : index(theIndex), qvrParser(description), tewFile(file.GetName()) {
  Parse(file, key);
}

TEWParser::~TEWParser() = default;

// A line that fails as the header leaves its turn to the next one; a bad row ends all reading.
void TEWParser::Parse(const FileName& file, const Kel_Key& key) {
  TARVO_TRACE("  Parsing TEW File for %s\n", key.GetKey());
  Port_Input input(tewFile);
  FileScanner lines = ScanFile(file, Codes::kMissingTable);
  // Once, since the header may take several tries.
  const StringList names = ListParameters();
  const NameSet parameters(names.begin(), names.end());
  std::string_view line;
  unsigned lineNumber = 0;
  bool ok = false;
  while (!ok && lines.GetNextLine(line, lineNumber)) {
    input.AtLine(lineNumber);
    ok = ParseHeader(lines, line, parameters);
  }
  const bool hasHeader = ok;
  while (ok && lines.GetNextLine(line, lineNumber)) {
    input.AtLine(lineNumber);
    if (!line.empty()) ok = ParseRow(lines, line, key);
  }
  if (!ok) {
    if (!hasHeader && !isHeaderTold) TellMissingHeader();
    throw Report::Told(Report::Exception(AppException::Failure, "Invalid TEW %s\n", tewFile));
  }
  MakePlaces();
  TARVO_TRACE("  Parse successful\n");
}

void TEWParser::MakePlaces() {
  for (unsigned row = 0; row < rows.size(); ++row) {
    for (unsigned netlist = 0; netlist < rows[row].netlists.size(); ++netlist) {
      const StringBase name = rows[row].netlists[netlist].location.GetName();
      places.push_back({HashOfTail(name.View()), row, netlist});
      hasRelative = hasRelative || !name.View().starts_with('/');
    }
  }
  std::sort(places.begin(), places.end(), [](const Place& left, const Place& right) {
    return std::tie(left.tail, left.row, left.netlist) <
           std::tie(right.tail, right.row, right.netlist);
  });
}

void TEWParser::TellMissingHeader() const {
  Diagnosis::Add([&] {
    return Diagnosis::Of(Codes::kBadHeader, tewFile,
                         "missing header: names of parameters, then FILES");
  });
}

// The names of a line that turns out to be no header stay. Each such line has its message, but only
// one that ends in FILES was meant for a header.
bool TEWParser::ParseHeader(const FileScanner& lines, std::string_view line,
                            const NameSet& parameters) {
  TEWLine::Header header;
  LineFault fault;
  if (!TEWLine::ReadHeader(line, header, fault)) return false;
  const std::string_view* const unknown = FindUnknown(header, parameters);
  for (const std::string_view& name : header.names) {
    if (&name == unknown) break;
    // Of a line that turns out to be no header, the names in front of the fault stay.
    headerNames.emplace_back(name);
  }
  if (header.isEnded && !unknown) return true;
  if (unknown && header.isEnded) {
    Diagnosis::Add([&] { return TellUnknownParameter(lines, *unknown, ListParameters()); });
    isHeaderTold = true;
  }
  kModule.Error("TEW unparsable header: %s line %d, %s\n", tewFile,
                Port_Input::GetCurrent()->GetLine(), StringBase(line));
  return false;
}

// False for a line that states nothing, which ends all reading as well.
bool TEWParser::ParseRow(const FileScanner& lines, std::string_view line, const Kel_Key& key) {
  TEWLine::Row text;
  LineFault fault;
  const TEWLine::Result result = TEWLine::ReadRow(line, headerNames.size(), text, fault);
  const unsigned number = Port_Input::GetCurrent()->GetLine();
  Row row{{}, {}, StringBase(text.rest), number};
  for (const std::string_view value : text.values) row.values.emplace_back(value);
  // Before the row is judged: a library that is unknown is told first, as what stands further left.
  for (const std::string_view netlist : text.netlists) {
    row.netlists.push_back(MakeNetlist(lines, netlist, key));
  }
  rows.push_back(std::move(row));
  if (result == TEWLine::Read) return true;
  Diagnosis::Add([&] { return TellFault(Codes::kBadRow, lines, fault); });
  if (result == TEWLine::StatesNothing) return false;
  throw Report::Told(Report::Exception(AppException::Failure,
                                       "TEW unparsable file entry: %s line %d, %s\n", tewFile,
                                       number, StringBase(line)));
}

TEWParser::Netlist TEWParser::MakeNetlist(const FileScanner& lines, std::string_view text,
                                          const Kel_Key& key) const {
  const TEWLine::Netlist split = TEWLine::SplitNetlist(text);
  // A netlist without a library is the core's own.
  const std::string_view library = split.hasLibrary ? split.library : key.GetKey().View();
  try {
    Netlist netlist{index.GetIPKey(Kel_Key(StringBase(library))), {}};
    netlist.location = index.GetIPLocation(netlist.library);
    netlist.location.PushPathEnd(Kel_Index::KEL_NETLIST_SUBDIRECTORY);
    netlist.location.SetTail(StringBase(split.name));
    return netlist;
  } catch (AppException& exception) {
    Diagnosis::Add(
        [&] { return TellUnknownLibrary(lines, index, split.hasLibrary ? split.library : text); });
    throw Report::Told(exception);
  }
}

StringList TEWParser::ListParameters() const {
  return qvrParser ? qvrParser->ListParameters() : StringList();
}

// Asked anew for each question, since a parameter may be set in between.
StringList TEWParser::GetParameterValues() const {
  StringList values;
  if (!qvrParser) return values;
  values.reserve(headerNames.size());
  for (const StringBase& name : headerNames) {
    values.push_back(qvrParser->GetParameterProperty(name, QVRParser::QVR_PROPERTY_VALUE));
  }
  return values;
}

std::vector<const TEWParser::Netlist*> TEWParser::Select() const {
  const StringList values = GetParameterValues();
  std::vector<const Netlist*> selected;
  for (const Row& row : rows) {
    // Texts are compared, byte by byte: 016 is not 16.
    if (row.values != values) continue;
    for (const Netlist& netlist : row.netlists) selected.push_back(&netlist);
  }
  return selected;
}

// Whether each netlist has an absolute path now.
bool TEWParser::HavePaths() const {
  try {
    if (hasRelative) FileName(".").GetAbsolutePath();
    return true;
  } catch (const std::filesystem::filesystem_error&) {
    return false;
  }
}

// The selected netlists among which one of that path must be, in the order of the table.
std::vector<const TEWParser::Netlist*> TEWParser::SelectCalledLike(const StringBase& path) const {
  // Without the current directory, the first netlist that needs it is a failure, however it is
  // called.
  if (!HavePaths()) return Select();
  const StringList values = GetParameterValues();
  const std::size_t tail = HashOfTail(path.View());
  auto place = std::lower_bound(places.begin(), places.end(), tail,
                                [](const Place& one, std::size_t hash) { return one.tail < hash; });
  std::vector<const Netlist*> selected;
  for (; place != places.end() && place->tail == tail; ++place) {
    const Row& row = rows[place->row];
    if (row.values == values) selected.push_back(&row.netlists[place->netlist]);
  }
  return selected;
}

KelNetlistTable TEWParser::GetTable() const {
  const StringList current = GetParameterValues();
  KelNetlistTable table{headerNames, {}};
  for (const Row& row : rows) {
    const bool applies = row.values == current;
    KelNetlistRow described{row.values, {}, row.ignored, applies, {tewFile, row.line, 0, 0}};
    for (const Netlist& netlist : row.netlists) {
      described.netlists.push_back({netlist.location.GetAbsolutePath(), netlist.library});
    }
    table.rows.push_back(std::move(described));
  }
  return table;
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
  // Rows say nothing of an order among libraries.
  std::sort(libraries.begin(), libraries.end());
  libraries.erase(std::unique(libraries.begin(), libraries.end()), libraries.end());
  return libraries;
}

Kel_Key TEWParser::GetFileLibrary(const FileName& file) const {
  const StringBase path = file.GetAbsolutePath();
  for (const Netlist* const netlist : SelectCalledLike(path)) {
    if (netlist->location.GetAbsolutePath() == path) return index.GetIPKey(netlist->library);
  }
  throw Report::Exception(AppException::Failure,
                          "Could not find netlist %s in order to identify library\n",
                          file.GetName());
}

}  // namespace Tarvo
