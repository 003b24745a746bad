#ifndef KEL_NEARBY_H
#define KEL_NEARBY_H

#include <string>

#include "Call.h"

// Notes for a key that could not be opened: the versions that its core has, or the names that are
// near to it. None for a core that is there but can't be opened, whose own error tells enough.
void SuggestKeys(const Call& call, const std::string& key);

// A note for each directory of a call that is no repository, with those that are near to it.
void SuggestRepositories(const Call& call);

// Whether somebody who wrote the text may well have meant the word: it begins so, or differs in at
// most a third of its letters. Two neighbours that changed places are one difference.
bool IsNear(const std::string& word, const std::string& text);

#endif
