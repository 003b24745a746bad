// The grammar of a core description, for three readers. A statement is read whole or not at all;
// what becomes of a bad one is the caller's business.

#include "Tarvo_QVRStatement.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "Tarvo_TokenReader.h"
#include "Tarvo_Word.h"

namespace Tarvo::QVRStatement {

const char* const kOptionDelimiters = " =()[]\"'";
const char* const kListDelimiters = " ,=()[]\"'";
const char* const kScannerDelimiters = " =:()[]\"'";

namespace {

// Room for the pairs of most statements, so that the list seldom grows.
constexpr std::size_t kUsualPairs = 8;

constexpr std::string_view kKeywords[] = {"OPTION", "PARAMETER", "BUS_INTERFACE", "IO_INTERFACE",
                                          "PORT"};

// The fault is the current token, or the place behind the last one.
bool Refuse(TokenReader& tokens, const char* text, LineFault& fault) {
  const bool isEnd = !tokens.MoreTokens();
  if (isEnd) tokens.ReadValue();  // for the place alone
  fault = {isEnd ? tokens.GetTried() : tokens.GetToken(), text};
  return false;
}

// key "=" value, from the current token on; the current token is then the value's last one.
bool ReadPair(TokenReader& tokens, Pair& pair, LineFault& fault) {
  if (!tokens.MoreTokens()) return Refuse(tokens, "missing name", fault);
  pair.key = tokens.GetToken();
  tokens.Step();
  if (!tokens.MoreTokens() || tokens.GetToken() != "=") {
    Refuse(tokens, "missing '=' after the name", fault);
    if (pair.key == "=") fault = {pair.key, "missing name before '='"};
    if (pair.key == ",") fault = {pair.key, "one comma too many"};
    return false;
  }
  tokens.Step();
  if (!tokens.MoreTokens()) return Refuse(tokens, "missing value after '='", fault);
  const TokenReader::Value value = tokens.ReadValue();
  pair.value = value.text;
  if (!value.whole) fault = NotClosed(tokens);
  return value.whole;
}

void PassKeyword(TokenReader& tokens) {
  tokens.MoreTokens();
  tokens.Step();
}

}  // namespace

StringList ListKeywords() {
  StringList keywords;
  for (const std::string_view keyword : kKeywords) keywords.emplace_back(keyword);
  return keywords;
}

// A line without a blank has no first word, so a keyword alone on its line is none.
Keyword KeywordOf(std::string_view line) {
  const auto* const found = std::find(std::begin(kKeywords), std::end(kKeywords), FirstWord(line));
  if (found == std::end(kKeywords)) return None;
  return static_cast<Keyword>(found - std::begin(kKeywords) + 1);
}

// The walk asks this of every line of a library, so no tokens are made for it.
bool BeginsWith(std::string_view line, const StringBase& keyword, const char* delimiters) {
  if (!line.starts_with(keyword.View())) return false;
  const std::string_view behind = line.substr(keyword.GetLength(), 1);
  return behind.empty() || std::string_view(delimiters).find(behind) != std::string_view::npos;
}

Result ReadOption(std::string_view line, const char* delimiters, OptionText& option,
                  LineFault& fault) {
  TokenReader tokens(line, delimiters, TokenReader::WithGroups);
  PassKeyword(tokens);
  if (!tokens.MoreTokens()) return NamesNothing;
  if (!ReadPair(tokens, option.pair, fault)) return Unparsable;
  tokens.Step();
  option.tail = tokens.GetRest();
  return Read;
}

// Blanks are tokens too, so value and tail together are the text as it stands in the line; only the
// quotes of a quoted value are gone.
Property MakeOption(const OptionText& option) {
  StringBase value(option.pair.value);
  value.Append(option.tail.data(), static_cast<unsigned>(option.tail.size()));
  value.Trim(" \t", StringBase::TrimBoth);
  return Property(StringBase(option.pair.key), std::move(value));
}

bool ReadList(std::string_view line, List& list, LineFault& fault) {
  TokenReader tokens(line, kListDelimiters, TokenReader::WithGroups);
  PassKeyword(tokens);
  list = List();
  list.pairs.reserve(kUsualPairs);
  while (true) {
    Pair pair;
    if (!ReadPair(tokens, pair, fault)) return false;
    list.pairs.push_back(pair);
    tokens.Step();
    if (!tokens.MoreTokens()) return true;
    // A comma belongs to the rest, unless something stands behind it.
    list.rest = tokens.GetRest();
    if (tokens.GetToken() != ",") return true;
    tokens.Step();
    if (!tokens.MoreTokens()) return true;
    list.rest = {};
  }
}

bool FindName(const List& list, const StringBase& key, std::size_t& position, LineFault& fault) {
  bool isNamed = false;
  bool isFound = false;
  for (std::size_t i = 0; i < list.pairs.size(); ++i) {
    if (!EqualsIgnoringCase(StringBase(list.pairs[i].key), key)) continue;
    if (isNamed) {
      fault = {list.pairs[i].key, "the interface has two names"};
      return false;
    }
    // A name that is empty counts only if no other follows.
    isFound = true;
    isNamed = !list.pairs[i].value.empty();
    position = i;
  }
  if (!isFound) fault = {list.pairs.front().key, "the interface has no name"};
  return isFound;
}

}  // namespace Tarvo::QVRStatement
