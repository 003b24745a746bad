// The grammar of a netlist table. Values and netlists are words or quoted texts; how many values a
// row has, its header says.

#include "Tarvo_TEWLine.h"

#include "Tarvo_TokenReader.h"
#include "Tarvo_Word.h"

namespace Tarvo::TEWLine {

namespace {

const char* const kDelimiters = " ,\"'";
constexpr std::string_view kEndOfHeader = "FILES";

// Without groups, since a value may begin with a bracket that nothing closes.
TokenReader Cut(std::string_view line) {
  return TokenReader(line, kDelimiters, TokenReader::WithoutGroups);
}

// Goes behind a comma that something follows. False at the end of a row's netlists; a comma that
// nothing follows belongs to the rest.
bool NextNetlist(TokenReader& tokens, Row& row) {
  if (!tokens.MoreTokens()) return false;
  const std::string_view rest = tokens.GetRest();
  const bool isComma = tokens.GetToken() == ",";
  if (isComma) tokens.Step();
  if (isComma && tokens.MoreTokens()) return true;
  row.rest = rest;
  return false;
}

}  // namespace

bool ReadHeader(std::string_view line, Header& header, LineFault& fault) {
  TokenReader tokens = Cut(line);
  header = Header();
  std::string_view field;
  if (!ReadNeeded(tokens, field, "missing name", fault)) return false;
  while (!EqualsIgnoringCase(field, kEndOfHeader)) {
    header.names.push_back(field);
    // A line of names alone is no header, but its names count; see docs/decisions.
    if (!ReadNeeded(tokens, field, "missing FILES after the names", fault)) return true;
  }
  header.isEnded = true;
  return true;
}

Result ReadRow(std::string_view line, std::size_t columns, Row& row, LineFault& fault) {
  TokenReader tokens = Cut(line);
  row = Row();
  std::string_view field;
  if (!ReadNeeded(tokens, field, "missing value", fault)) return StatesNothing;
  // A netlist follows the last value, so each step has read one field ahead.
  while (row.values.size() < columns) {
    row.values.push_back(field);
    const bool isLast = row.values.size() == columns;
    const char* const missing = isLast ? "missing netlist after the values" : "missing value";
    if (!ReadNeeded(tokens, field, missing, fault)) return Unparsable;
  }
  row.netlists.push_back(field);
  while (NextNetlist(tokens, row)) {
    if (!ReadNeeded(tokens, field, "missing netlist", fault)) return Unparsable;
    row.netlists.push_back(field);
  }
  return Read;
}

Netlist SplitNetlist(std::string_view text) {
  // The first colon: a file may have more in its name, a library has none.
  const std::size_t colon = text.find(':');
  if (colon == std::string_view::npos) return {false, {}, text};
  return {true, text.substr(0, colon), text.substr(colon + 1)};
}

}  // namespace Tarvo::TEWLine
