// A cursor over the tokens of a line. All that it gives are parts of the line, so that whoever
// finds a fault knows its column.

#include "Tarvo_TokenReader.h"

namespace Tarvo {

std::string_view FirstWord(std::string_view line) {
  const std::size_t blank = line.find(' ');
  return blank == std::string_view::npos ? std::string_view() : line.substr(0, blank);
}

// Each delimiter is a token, blanks among them, so that all tokens together are the line.
TokenReader::TokenReader(std::string_view wholeLine, const char* delimiters, Groups withGroups)
    : line(wholeLine),
      groups(withGroups),
      tokenizer(wholeLine.data(), wholeLine.data() + wholeLine.size(),
                boost::char_separator<char>("", delimiters, boost::drop_empty_tokens)),
      token(tokenizer.begin()) {}

bool TokenReader::MoreTokens() {
  while (!token.at_end() && GetToken() == " ") ++token;
  return !token.at_end();
}

std::string_view TokenReader::GetRest() const {
  return token.at_end() ? std::string_view() : line.substr(PositionOf(GetToken()));
}

void TokenReader::Step() {
  if (!token.at_end()) ++token;
}

TokenReader::Value TokenReader::ReadValue() {
  // For who tells a fault: where the value begins, or the end of the line if there is none.
  tried = line.size();
  if (!MoreTokens()) return {{}, false};
  const std::string_view first = GetToken();
  tried = PositionOf(first);
  if (first == "\"" || first == "'") return ReadQuoted();
  if (groups == WithGroups && first == "(") return ReadGroup(")");
  if (groups == WithGroups && first == "[") return ReadGroup("]");
  return {first, true};
}

// Of a value that is not whole nothing is passed over.
bool TokenReader::ReadField(std::string_view& text) {
  const Value value = ReadValue();
  if (!value.whole) return false;
  text = value.text;
  Step();
  return true;
}

// From the opening quote to the token equal to it.
TokenReader::Value TokenReader::ReadQuoted() {
  const std::string_view quote = GetToken();
  const std::size_t start = PositionOf(quote) + 1;
  // A quote of the other kind, a bracket and a comma are letters in here.
  for (Step(); !token.at_end(); ++token) {
    if (GetToken() == quote) return {line.substr(start, PositionOf(GetToken()) - start), true};
  }
  return {line.substr(start), false};
}

// From the opening bracket to the one that closes it, both included.
TokenReader::Value TokenReader::ReadGroup(std::string_view closing) {
  const std::string_view opening = GetToken();
  const std::size_t start = PositionOf(opening);
  // Brackets of the other kind, and quotes, are letters in here.
  std::size_t depth = 1;
  for (Step(); !token.at_end(); ++token) {
    if (GetToken() == opening) ++depth;
    if (GetToken() == closing && --depth == 0) {
      return {line.substr(start, PositionOf(GetToken()) + 1 - start), true};
    }
  }
  return {line.substr(start), false};
}

bool ReadNeeded(TokenReader& tokens, std::string_view& field, const char* missing,
                LineFault& fault) {
  if (tokens.ReadField(field)) return true;
  const std::string_view tried = tokens.GetTried();
  fault = tried.empty() ? LineFault{tried, missing} : NotClosed(tokens);
  return false;
}

LineFault NotClosed(const TokenReader& tokens) {
  const std::string_view tried = tokens.GetTried();
  const bool isQuote = tried.front() == '"' || tried.front() == '\'';
  return {tried, isQuote ? "quote is not closed" : "bracket is not closed", true};
}

}  // namespace Tarvo
