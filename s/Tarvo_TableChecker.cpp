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
  void CheckHeader(Text line);
  void TellHeader(const TEWLine::Header& header, const LineFault& fault) const;
  void CheckRow(Text line);
  void CheckValues(const TEWLine::Row& row) const;
  void CheckNetlist(const StringList& values, Text text);
  void CheckEnd(const TEWLine::Row& row) const;
  const DescribedParameter* FindParameter(const StringBase& parameter) const;

  void Tell(const KelDiagnosticCode& code, Text part, const StringBase& text,
            const StringBase& hint = {}) const {
    Diagnosis::Add([&] { return At(code, SpanOf(lines, part), text, hint); });
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
      CheckHeader(line);
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

// The first line that ends in FILES, also if it names what is no parameter: then its rows are
// checked all the same. 0 if there is none.
unsigned TableChecker::FindHeader() {
  Text line;
  for (unsigned number = 0; lines.GetNextLine(line, number);) {
    TEWLine::Header header;
    LineFault fault;
    if (TEWLine::ReadHeader(line, header, fault) && header.isEnded) return number;
  }
  return 0;
}

void TableChecker::TellNoHeader(Text line) const {
  const char* const text = "missing header of parameters and the word FILES";
  if (!line.empty()) return Tell(Codes::kBadHeader, line, text);
  Diagnosis::Add([&] { return Diagnosis::Of(Codes::kBadHeader, name, text); });
}

// The names of a line that turns out to be no header stay, up to the first that is no parameter.
void TableChecker::CheckHeader(Text line) {
  TEWLine::Header header;
  LineFault fault;
  if (!TEWLine::ReadHeader(line, header, fault)) {
    return Tell(Codes::kBadHeader, fault.where, fault.text);
  }
  TellHeader(header, fault);
  for (const Text column : header.names) {
    if (!header.isEnded && !FindParameter(StringBase(column))) return;
    columns.emplace_back(column);
  }
}

void TableChecker::TellHeader(const TEWLine::Header& header, const LineFault& fault) const {
  for (const Text column : header.names) {
    if (core.hasAllParameters && !FindParameter(StringBase(column))) {
      Diagnosis::Add([&] { return TellUnknownParameter(lines, column, parameters); });
    }
  }
  if (!header.isEnded) Tell(Codes::kBadHeader, fault.where, fault.text);
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
    Tell(Codes::kBadRow, fault.where, fault.text);
  }
  CheckValues(row);
  StringList values;
  for (const Text value : row.values) values.emplace_back(value);
  for (const Text netlist : row.netlists) CheckNetlist(values, netlist);
  CheckEnd(row);
}

void TableChecker::CheckValues(const TEWLine::Row& row) const {
  for (std::size_t i = 0; i < row.values.size(); ++i) {
    const Text value = row.values[i];
    const auto first = std::find(columns.begin(), columns.end(), columns[i]);
    const Text before = row.values[static_cast<std::size_t>(first - columns.begin())];
    const DescribedParameter* const parameter = FindParameter(columns[i]);
    if (value == ",") {
      Tell(Codes::kRowNeverApplies, value, "a comma is taken for a value",
           "put blanks alone between values");
    } else if (value != before) {
      Tell(Codes::kRowNeverApplies, value,
           Say({"the row gives ", columns[i].View(), " two values: ", before, " and ", value}));
    } else if (parameter && !MayTake(*parameter, value)) {
      Tell(Codes::kRowNeverApplies, value,
           Say({columns[i].View(), " does not take the value ", value}));
    }
  }
}

void TableChecker::CheckNetlist(const StringList& values, Text text) {
  if (text == ",") {
    return Tell(Codes::kMissingNetlist, text, "a comma is taken for a netlist",
                "put blanks alone between values");
  }
  const TEWLine::Netlist split = TEWLine::SplitNetlist(text);
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
  const auto [first, isNew] = rows.try_emplace({values, netlist.location.GetName()}, netlist.place);
  if (!isNew) {
    Diagnosis::Add([&, place = first->second] {
      return Diagnosis::With(At(Codes::kDuplicateRow, SpanOf(lines, text),
                                Say({split.name, " is listed at these values already"})),
                             place, "first listed here");
    });
  }
  netlists.push_back(std::move(netlist));
}

void TableChecker::CheckEnd(const TEWLine::Row& row) const {
  if (row.rest.empty() || row.netlists.back() == ",") return;
  if (row.rest == ",") {
    return Tell(Codes::kTrailingComma, row.rest,
                "the row ends in a comma, and does not go on in the next line",
                "take the comma away");
  }
  const Text word = row.rest.substr(0, row.rest.find_first_of(" ,"));
  Tell(Codes::kListEnds, word,
       Say({"missing ',' before ", word, "; the rest of the line is ignored"}),
       Say({"write ", row.netlists.back(), ", ", row.rest}));
}

}  // namespace

std::vector<ListedNetlist> CheckTable(const Port::FileName& file, const Kel_Index& index,
                                      const Kel_Key& key, const DescribedCore& core) {
  return TableChecker(file, index, key, core).Check();
}

}  // namespace Tarvo
