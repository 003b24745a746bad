// A table is read twice: first to find the line that is its header, then to judge each line. So
// rows are checked also below a header with a misspelt name.

#include "Tarvo_TableChecker.h"

#include <algorithm>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "Port_Input.h"
#include "Tarvo_AppException.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_RangeText.h"
#include "Tarvo_TEWLine.h"
#include "Tarvo_TellFault.h"
#include "Tarvo_TellUnknown.h"

namespace Tarvo {

namespace {

using Diagnosis::At;
using Diagnosis::Say;
using Text = std::string_view;

// A value against what its parameter takes: false only where that is sure.
bool MayTake(const DescribedParameter& parameter, Text value) {
  const std::vector<Text> words = ReadValues(parameter.values.View());
  // A list of words is exact. A range is judged only where everything is a number: a bound may be
  // an expression.
  if (!words.empty()) return std::find(words.begin(), words.end(), value) != words.end();
  const auto range = ReadRange(parameter.range.View());
  const auto number = ReadNumber(value);
  if (!range || !number) return true;
  return std::any_of(range->items.begin(), range->items.end(), [&](const RangeText::Item& item) {
    const auto low = ReadNumber(item.low);
    const auto high = ReadNumber(item.high);
    return !low || !high || (*low <= *number && *number <= *high);
  });
}

class TableChecker {
 public:
  TableChecker(const Port::FileName& file, const Kel_Index& theIndex, const Kel_Key& theKey,
               const DescribedCore& theCore)
      : name(file.GetName()),
        input(name),
        lines(ScanFile(file, Codes::kMissingTable)),
        index(theIndex),
        key(theKey),
        core(theCore) {
    for (const DescribedParameter& parameter : core.parameters)
      parameters.push_back(parameter.name);
  }

  std::vector<ListedNetlist> Check();

 private:
  unsigned FindHeader();
  void TellNoHeader(Text line) const;
  void CheckHeader(Text line, bool isChosen);
  void TellHeader(const TEWLine::Header& header, const LineFault& fault) const;
  void CheckRow(Text line);
  void CheckValues(const TEWLine::Row& row) const;
  void CheckNetlist(const StringList& values, Text text);
  bool CheckCommas(const TEWLine::Row& row) const;
  void CheckEnd(Text line, const TEWLine::Row& row) const;
  const DescribedParameter* FindParameter(const StringBase& parameter) const;

  void Tell(const KelDiagnosticCode& code, Text part, const StringBase& text,
            const StringBase& hint = {}) const {
    Diagnosis::Add([&] { return At(code, SpanOf(lines, part), text, hint); });
  }

  void TellBad(const KelDiagnosticCode& code, const LineFault& fault) const {
    Diagnosis::Add([&] { return TellFault(code, lines, fault); });
  }

  StringBase name;
  Port_Input input;
  FileScanner lines;
  const Kel_Index& index;
  const Kel_Key& key;
  const DescribedCore& core;
  StringList parameters;
  StringList columns;
  std::map<std::pair<StringList, StringBase>, KelPlace> rows;  // by values and netlist
  std::vector<ListedNetlist> netlists;
};

std::vector<ListedNetlist> TableChecker::Check() {
  const unsigned headerLine = FindHeader();
  lines.GoToStart();
  Text line;
  for (unsigned number = 0; lines.GetNextLine(line, number);) {
    input.AtLine(number);
    if (line.empty()) continue;
    if (number <= headerLine) {
      CheckHeader(line, number == headerLine);
    } else if (headerLine > 0) {
      CheckRow(line);
    } else {
      TellNoHeader(line);
      return {};
    }
  }
  if (headerLine == 0) TellNoHeader({});
  return std::move(netlists);
}

// The line that the library takes for the header, or else the first that ends in FILES: so the rows
// of a header with a misspelt name are checked all the same. 0 if there is none.
unsigned TableChecker::FindHeader() {
  unsigned first = 0;
  Text line;
  for (unsigned number = 0; lines.GetNextLine(line, number);) {
    TEWLine::Header header;
    LineFault fault;
    if (!TEWLine::ReadHeader(line, header, fault) || !header.isEnded) continue;
    const auto isKnown = [&](Text column) { return FindParameter(StringBase(column)) != nullptr; };
    if (std::all_of(header.names.begin(), header.names.end(), isKnown)) return number;
    // A line that ends in FILES was meant for the header, whatever it names.
    if (first == 0) first = number;
  }
  return first;
}

void TableChecker::TellNoHeader(Text line) const {
  const char* const text = "missing header: names of parameters, then FILES";
  TellCut(lines, line);
  TEWLine::Header header;
  LineFault fault;
  const bool hasNames = TEWLine::ReadHeader(line, header, fault) && !header.names.empty();
  if (!hasNames) {
    return Diagnosis::Add([&] { return Diagnosis::Of(Codes::kBadHeader, name, text); });
  }
  // FILES is the last word of a header, so the last name is the one to look at.
  const StringBase meant = FindMisspelt(header.names.back(), {"FILES"});
  const bool isMisspelt = meant.GetLength() > 0;
  Tell(Codes::kBadHeader, isMisspelt ? header.names.back() : line, text,
       isMisspelt ? "did you mean FILES?" : "");
}

// The names of a line that turns out to be no header stay, up to the first that is no parameter.
void TableChecker::CheckHeader(Text line, bool isChosen) {
  TEWLine::Header header;
  LineFault fault;
  if (!TEWLine::ReadHeader(line, header, fault)) {
    return TellBad(Codes::kBadHeader, fault);
  }
  TellHeader(header, fault);
  if (isChosen) TellCut(lines, line);
  for (const Text column : header.names) {
    if (!isChosen && FindParameter(StringBase(column)) == nullptr) return;
    if (column != ",") columns.emplace_back(column);
  }
}

void TableChecker::TellHeader(const TEWLine::Header& header, const LineFault& fault) const {
  for (const Text column : header.names) {
    if (column == ",") {
      Tell(Codes::kBadHeader, column, "a comma is read as a name", "separate names by blanks only");
    } else if (core.hasAllParameters && FindParameter(StringBase(column)) == nullptr) {
      Diagnosis::Add([&] { return TellUnknownParameter(lines, column, parameters); });
    }
  }
  if (!header.isEnded) TellBad(Codes::kBadHeader, fault);
}

const DescribedParameter* TableChecker::FindParameter(const StringBase& parameter) const {
  const auto found =
      std::find_if(core.parameters.begin(), core.parameters.end(),
                   [&](const DescribedParameter& known) { return known.name == parameter; });
  return found == core.parameters.end() ? nullptr : &*found;
}

void TableChecker::CheckRow(Text line) {
  TEWLine::Row row;
  LineFault fault;
  if (TEWLine::ReadRow(line, columns.size(), row, fault) != TEWLine::Read) {
    TellBad(Codes::kBadRow, fault);
  } else {
    TellCut(lines, line);
  }
  // What stands in front of a fault is looked at all the same.
  if (CheckCommas(row)) return;
  CheckValues(row);
  StringList values;
  for (const Text value : row.values) values.emplace_back(value);
  for (const Text netlist : row.netlists) CheckNetlist(values, netlist);
  CheckEnd(line, row);
}

// Whether a comma is read as a value, or as the first netlist: then nothing of the row is as it was
// meant.
bool TableChecker::CheckCommas(const TEWLine::Row& row) const {
  const auto value = std::find(row.values.begin(), row.values.end(), ",");
  const bool isNetlist = !row.netlists.empty() && row.netlists.front() == ",";
  if (value == row.values.end() && !isNetlist) return false;
  Tell(Codes::kRowNeverApplies, isNetlist ? row.netlists.front() : *value,
       isNetlist ? "the comma is read as a netlist" : "the comma is read as a value",
       "separate values by blanks only");
  return true;
}

void TableChecker::CheckValues(const TEWLine::Row& row) const {
  for (std::size_t i = 0; i < row.values.size(); ++i) {
    const Text value = row.values[i];
    // A parameter may head two columns. A row with two values for it can't apply.
    const auto first = std::find(columns.begin(), columns.end(), columns[i]);
    const Text before = row.values[static_cast<std::size_t>(first - columns.begin())];
    const DescribedParameter* const parameter = FindParameter(columns[i]);
    if (value != before) {
      Tell(Codes::kRowNeverApplies, value,
           Say({"the row gives ", columns[i].View(), " two values: '", before, "' and '", value,
                "'"}));
    } else if (parameter && !MayTake(*parameter, value)) {
      Tell(Codes::kRowNeverApplies, value,
           Say({columns[i].View(), " does not take the value '", value, "'"}));
    }
  }
}

void TableChecker::CheckNetlist(const StringList& values, Text text) {
  if (text == ",") return Tell(Codes::kMissingNetlist, text, "one comma too many");
  const TEWLine::Netlist split = TEWLine::SplitNetlist(text);
  if (split.hasLibrary && split.library.empty()) {
    return Tell(Codes::kUnknownLibrary, text, "missing library before ':'");
  }
  if (split.name.empty()) return Tell(Codes::kMissingNetlist, text, "missing netlist after ':'");
  const Text library = split.hasLibrary ? split.library : key.GetKey().View();
  ListedNetlist netlist{{}, {}, Diagnosis::Here(SpanOf(lines, text))};
  try {
    netlist.library = index.GetIPKey(Kel_Key(StringBase(library)));
    netlist.location = index.GetIPLocation(netlist.library);
  } catch (const AppException&) {
    return Diagnosis::Add([&] { return TellUnknownLibrary(lines, index, library); });
  }
  netlist.location.PushPathEnd(Kel_Index::KEL_NETLIST_SUBDIRECTORY);
  netlist.location.SetTail(StringBase(split.name));
  // The same netlist for the same values adds nothing.
  const auto [first, isNew] = rows.try_emplace({values, netlist.location.GetName()}, netlist.place);
  if (!isNew) {
    Diagnosis::Add([&, place = first->second] {
      return Diagnosis::With(At(Codes::kDuplicateRow, SpanOf(lines, text),
                                Say({"'", split.name, "' is already listed for these values"})),
                             place, "first listed here");
    });
  }
  netlists.push_back(std::move(netlist));
}

void TableChecker::CheckEnd(Text line, const TEWLine::Row& row) const {
  if (row.rest.empty()) return;
  if (row.rest == ",") {
    return Tell(Codes::kTrailingComma, row.rest,
                "the row ends in a comma, but can't continue on the next line", "remove the comma");
  }
  const Text word = row.rest.substr(0, row.rest.find_first_of(" ,"));
  Text last = row.netlists.back();
  const auto start = static_cast<std::size_t>(last.data() - line.data());
  // Some write a semicolon where a comma is wanted. Whether a comma mends the row is tried.
  last = last.substr(0, last.find_last_not_of(';') + 1);
  const StringBase mended = Say({line.substr(0, start), last, ", ", row.rest});
  TEWLine::Row read;
  LineFault fault;
  const bool isMended =
      TEWLine::ReadRow(mended.View(), columns.size(), read, fault) == TEWLine::Read &&
      read.rest.empty();
  Tell(Codes::kListEnds, word,
       Say({"missing ',' before ", word, "; the rest of the line is ignored"}),
       isMended ? Say({"write ", last, ", ", row.rest}) : StringBase());
}

}  // namespace

std::vector<ListedNetlist> CheckTable(const Port::FileName& file, const Kel_Index& index,
                                      const Kel_Key& key, const DescribedCore& core) {
  return TableChecker(file, index, key, core).Check();
}

}  // namespace Tarvo
