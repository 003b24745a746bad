#ifndef TARVO_WORD_H
#define TARVO_WORD_H

#include <algorithm>
#include <string_view>

#include "Tarvo_Export.h"

namespace Tarvo {

// How a word from a file is tested against a fixed word of its format: in either letter case. Names
// that a file gives are compared exactly instead.
inline bool EqualsIgnoringCase(const StringBase& text, const StringBase& word) noexcept {
  return text.GetLength() == word.GetLength() &&
         text.Compare(word, StringBase::CompareIgnoreCase) == 0;
}

// The same for a part of a line, of which no text is made unless it is as long as the word.
inline bool EqualsIgnoringCase(std::string_view text, std::string_view word) {
  return text.size() == word.size() && EqualsIgnoringCase(StringBase(text), StringBase(word));
}

// Stands between the interfaces that a record names.
inline constexpr char kInterfaceDelimiter = ':';

// Gives `take` each piece of a list in a text, in their order. Empty pieces are left out.
template <class Take>
void ForEachPiece(std::string_view list, char delimiter, const Take& take) {
  while (!list.empty()) {
    const std::string_view piece = list.substr(0, list.find(delimiter));
    if (!piece.empty()) take(piece);
    list.remove_prefix(std::min(piece.size() + 1, list.size()));
  }
}

}  // namespace Tarvo

#endif
