#ifndef KEL_NEARBY_H
#define KEL_NEARBY_H

#include <string>

#include "Tarvo_KelLibrary.h"

// Notes for a key that could not be opened: the versions that its core has, or the names that are
// near to it. None for a key that the library knows, whose own error tells enough.
void SuggestKeys(const Tarvo::KelLibrary& library, const std::string& key);

#endif
