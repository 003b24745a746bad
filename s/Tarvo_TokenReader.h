#ifndef TARVO_TOKENREADER_H
#define TARVO_TOKENREADER_H

#include <boost/tokenizer.hpp>
#include <string_view>

#include "Tarvo_Export.h"
#include "Tarvo_LineFault.h"

namespace Tarvo {

// The text before the first blank of a cleaned line; empty for a line without one. All formats tell
// their statements apart by it.
std::string_view FirstWord(std::string_view line);

// Reads the tokens and values of a line, for all three formats. Each delimiter is a token of its
// own, each longest run of other characters is one, and nothing is dropped: the tokens of a line,
// joined, give the line back.
//
// A value is one of
//     "..." or '...'     all up to the next such quote, which may be nothing
//     (...) or [...]     all up to the closing bracket, inner ones of that kind counted; where the
//                        format has groups
//     any other token    that token, even if it is a delimiter
// There is no escape character, and only a bracket that is a token of its own opens a group.
//
// All texts are views of the line, which must outlive them.
class TokenReader {
 public:
  enum Groups { WithoutGroups, WithGroups };

  // A value's text, quotes left out and brackets kept. It is not whole if there was none, or if
  // the line ended before its quote or bracket was closed; then the text is what was there.
  struct Value {
    std::string_view text;
    bool whole;
  };

  TokenReader(std::string_view wholeLine, const char* delimiters, Groups withGroups);

  // Passes over blanks. True if a token remains, which is then the current one.
  bool MoreTokens();

  // The current token. There must be one.
  std::string_view GetToken() const { return token->text; }
  // The line from the current token on; empty at its end.
  std::string_view GetRest() const;

  // The line from the value on that was tried last: what is not closed, or, where there was none,
  // the empty text at the line's end.
  std::string_view GetTried() const { return line.substr(tried); }

  // Goes to the next token; at the end of the line it does nothing.
  void Step();

  // Passes over blanks and reads a value. The current token is then the value's last one.
  Value ReadValue();

  // Reads a value that must be whole and steps behind it. False, with the text unchanged, if there
  // is none or it is not closed.
  bool ReadField(std::string_view& text);

 private:
  // A token in place. The tokenizer assigns it as it would a string.
  struct Token {
    void assign(const char* begin, const char* end) {
      text = std::string_view(begin, static_cast<std::size_t>(end - begin));
    }
    std::string_view text;
  };
  using Tokenizer = boost::tokenizer<boost::char_separator<char>, const char*, Token>;

  std::size_t PositionOf(std::string_view part) const {
    return static_cast<std::size_t>(part.data() - line.data());
  }
  Value ReadQuoted();
  Value ReadGroup(std::string_view closing);

  std::string_view line;
  Groups groups;
  Tokenizer tokenizer;
  Tokenizer::iterator token;
  std::size_t tried = 0;
};

// Reads a field that must be there. False with a fault, the text for a missing one, or that it is
// not closed.
bool ReadNeeded(TokenReader& tokens, std::string_view& field, const char* missing,
                LineFault& fault);

// The fault of the value that was tried last, which is not closed.
LineFault NotClosed(const TokenReader& tokens);

}  // namespace Tarvo

#endif
