#ifndef TARVO_QVRSTATEMENT_H
#define TARVO_QVRSTATEMENT_H

#include "Tarvo_Export.h"
#include "Tarvo_PropertyList.h"

// The statements of a core description, for both of its readers: the one of options alone, and the
// one of everything. A statement is a line that begins with one of five keywords:
//
//     OPTION name = value                         the value runs to the end of the line
//     PARAMETER name = value, key = value, ...    and likewise PORT and the two interfaces
//
// Values are those of TokenReader. In a list a comma goes on to a further pair if something stands
// behind it; at anything else the list is over, and the rest of the line is ignored.
namespace Tarvo::QVRStatement {

// What cuts a line into tokens. They differ in the comma, which an option's value may hold, and in
// the colon, which only the reader of options takes for a delimiter.
extern const char* const kOptionDelimiters;
extern const char* const kListDelimiters;
extern const char* const kScannerDelimiters;

// Whether the first token of a cleaned line is that word.
bool BeginsWith(std::string_view line, const StringBase& keyword, const char* delimiters);

// What became of a statement. One that names nothing is a keyword alone on its line.
enum Result { Read, NamesNothing, Unparsable };

// Reads the option that a line states; its first token is taken for the keyword. The output changes
// only on Read.
Result ReadOption(std::string_view line, const char* delimiters, Property& option);

// Reads the pairs of a list statement, in their order; the first token is taken for the keyword.
// False, with the output unchanged, if there is no pair, or one has no "=", no value, or a value
// that is not closed.
bool ReadPairs(std::string_view line, PropertyList& pairs);

}  // namespace Tarvo::QVRStatement

#endif
