#ifndef TARVO_QVRSTATEMENT_H
#define TARVO_QVRSTATEMENT_H

#include <string_view>
#include <vector>

#include "Tarvo_Export.h"
#include "Tarvo_LineFault.h"

// The statements of a core description, for all of its readers: that of options alone, that of
// everything, and the checker. A statement is a line that begins with one of five keywords:
//
//     OPTION name = value                         the value runs to the end of the line
//     PARAMETER name = value, key = value, ...    and likewise PORT and the two interfaces
//
// Values are those of TokenReader. In a list a comma goes on to a further pair if something stands
// behind it; at anything else the list is over, and the rest of the line is ignored. All views are
// parts of the line.
namespace Tarvo::QVRStatement {

enum Keyword { None, Option, Parameter, BusInterface, IoInterface, Port };

// The keywords' texts, in the order of their numbers, without that of None.
StringList ListKeywords();

// What the text in front of a line's first blank is.
Keyword KeywordOf(std::string_view line);

// What cuts a line into tokens. They differ in the comma, which an option's value may hold, and in
// the colon, which only the reader of options takes for a delimiter.
extern const char* const kOptionDelimiters;
extern const char* const kListDelimiters;
extern const char* const kScannerDelimiters;

// Whether the first token of a cleaned line is that word.
bool BeginsWith(std::string_view line, const StringBase& keyword, const char* delimiters);

// What became of a statement. One that names nothing is a keyword alone on its line.
enum Result { Read, NamesNothing, Unparsable };

struct Pair {
  std::string_view key;
  std::string_view value;  // without its quotes
};

// An option: its pair, and what stands behind that, which belongs to the value.
struct OptionText {
  Pair pair;
  std::string_view tail;
};

// Reads the option that a line states; its first token is taken for the keyword.
Result ReadOption(std::string_view line, const char* delimiters, OptionText& option,
                  LineFault& fault);

// Name and value, the latter without blanks at its ends.
Property MakeOption(const OptionText& option);

// The pairs of a list statement, and what stands behind them.
struct List {
  std::vector<Pair> pairs;
  std::string_view rest;  // from the comma or word on that ended the list; mostly empty
};

// Reads the pairs of a list statement, in their order; the first token is taken for the keyword.
// False if there is no pair, or one has no "=", no value, or a value that is not closed; the pairs
// in front of it are there.
bool ReadList(std::string_view line, List& list, LineFault& fault);

// Which pair names an interface: the only one with that key, or the last of several, those before
// it being empty. False without such a pair, and for a second one behind a name.
bool FindName(const List& list, const StringBase& key, std::size_t& position, LineFault& fault);

}  // namespace Tarvo::QVRStatement

#endif
