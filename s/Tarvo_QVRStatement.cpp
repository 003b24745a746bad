#include "Tarvo_QVRStatement.h"

#include <string_view>
#include <utility>

#include "Tarvo_TokenReader.h"

namespace Tarvo::QVRStatement {

const char* const kOptionDelimiters = " =()[]\"'";
const char* const kListDelimiters = " ,=()[]\"'";
const char* const kScannerDelimiters = " =:()[]\"'";

namespace {

// key "=" value, from the current token on; the current token is then the value's last one.
bool ReadPair(TokenReader& tokens, Property& pair) {
  if (!tokens.MoreTokens()) return false;
  const std::string_view key = tokens.GetToken();
  tokens.Step();
  if (!tokens.MoreTokens() || tokens.GetToken() != "=") return false;
  tokens.Step();
  const TokenReader::Value value = tokens.ReadValue();
  if (!value.whole) return false;
  pair = Property(StringBase(key), StringBase(value.text));
  return true;
}

// Goes to the next pair of the list, if one follows.
bool NextPair(TokenReader& tokens) {
  tokens.Step();
  if (!tokens.MoreTokens() || tokens.GetToken() != ",") return false;
  tokens.Step();
  return tokens.MoreTokens();
}

void PassKeyword(TokenReader& tokens) {
  tokens.MoreTokens();
  tokens.Step();
}

}  // namespace

bool BeginsWith(std::string_view line, const StringBase& keyword, const char* delimiters) {
  if (!line.starts_with(keyword.View())) return false;
  const std::string_view behind = line.substr(keyword.GetLength(), 1);
  return behind.empty() || std::string_view(delimiters).find(behind) != std::string_view::npos;
}

Result ReadOption(std::string_view line, const char* delimiters, Property& option) {
  TokenReader tokens(line, delimiters, TokenReader::WithGroups);
  PassKeyword(tokens);
  if (!tokens.MoreTokens()) return NamesNothing;
  Property read;
  if (!ReadPair(tokens, read)) return Unparsable;
  tokens.Step();
  const std::string_view tail = tokens.GetRest();
  read.second.Append(tail.data(), static_cast<unsigned>(tail.size()));
  read.second.Trim(" \t", StringBase::TrimBoth);
  option = std::move(read);
  return Read;
}

bool ReadPairs(std::string_view line, PropertyList& pairs) {
  TokenReader tokens(line, kListDelimiters, TokenReader::WithGroups);
  PassKeyword(tokens);
  PropertyList read;
  do {
    Property pair;
    if (!ReadPair(tokens, pair)) return false;
    read.push_back(std::move(pair));
  } while (NextPair(tokens));
  pairs = std::move(read);
  return true;
}

}  // namespace Tarvo::QVRStatement
