#ifndef KEL_TEXT_H
#define KEL_TEXT_H

#include <string>

#include "Tarvo_Export.h"

// All bytes of a text, as the Standard Library's strings hold them.
inline std::string Text(const Tarvo::StringBase& text) { return std::string(text.View()); }

#endif
