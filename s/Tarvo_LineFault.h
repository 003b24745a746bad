#ifndef TARVO_LINEFAULT_H
#define TARVO_LINEFAULT_H

#include <string_view>

namespace Tarvo {

// What a line that can't be read is wrong in: a part of the line, empty at the place where
// something is missing, and the fault in a few words.
struct LineFault {
  std::string_view where;
  const char* text = nullptr;
  bool isOpen = false;     // a quote or a bracket is not closed
  bool isKeyword = false;  // the first word is no keyword
};

}  // namespace Tarvo

#endif
