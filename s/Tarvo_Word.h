#ifndef TARVO_WORD_H
#define TARVO_WORD_H

#include "Tarvo_Export.h"

namespace Tarvo {

// How a word from a file is tested against a fixed word of its format: in either letter case. Names
// that a file gives are compared exactly instead.
inline bool Matches(const StringBase& text, const StringBase& word) noexcept {
  return text.Compare(word, StringBase::CompareIgnoreCase) == 0;
}

}  // namespace Tarvo

#endif
