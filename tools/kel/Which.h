#ifndef KEL_WHICH_H
#define KEL_WHICH_H

#include <string>
#include <vector>

#include "Status.h"
#include "Tarvo_KelLibrary.h"

// Writes a line for each key or bare name that the library knows: the key it resolves to, name,
// version and location, with a tab between. What it does not know is left to the messages.
Status Which(const Tarvo::KelLibrary& library, const std::vector<std::string>& keys);

#endif
