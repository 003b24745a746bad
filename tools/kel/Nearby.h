#ifndef KEL_NEARBY_H
#define KEL_NEARBY_H

#include <string>

#include "Call.h"

// Notes for a key that could not be opened: the versions that its core has, or the names that are
// near to it. None for a core that is there but can't be opened, whose own error tells enough.
void SuggestKeys(const Call& call, const std::string& key);

#endif
