#ifndef KEL_SUGGESTIONS_H
#define KEL_SUGGESTIONS_H

#include <string>
#include <vector>

#include "Request.h"
#include "Tarvo_KelLibrary.h"

// Notes for a key that could not be opened: the versions that its core has, or the names that are
// near to it. None for a core that is there but can't be opened, whose own error tells enough.
void SuggestKeys(const Tarvo::KelLibrary& library, const std::string& key);

// The names of cores that are near to one, as a question, or nothing.
std::string NearNames(const Tarvo::KelLibrary& library, const std::string& name);

// A note for each directory of a request that is no repository but has some near to it.
void SuggestRepositories(const Request& request);

// Those of the words that somebody who wrote the text may well have meant, as a question: a word
// that begins so, or differs in at most a third of its letters. Two neighbours that changed places
// are one difference. Empty if there is none.
std::string DidYouMean(const std::vector<std::string>& words, const std::string& text);

#endif
