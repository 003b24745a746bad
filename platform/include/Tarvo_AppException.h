#ifndef TARVO_APPEXCEPTION_H
#define TARVO_APPEXCEPTION_H

#include <stdexcept>

#include "Port_Export.h"
#include "Port_StringBase.h"

namespace Tarvo {

// The one exception that the library's own code throws. what() gives the text exactly, with its
// final line end; a text ends at its first NUL byte. Thrown by value, caught by reference. Making
// one may throw std::bad_alloc, copying one throws nothing. Threads: like an int.
class PORT_EXPORT AppException : public std::runtime_error {
 public:
  enum Level {
    NotFound = 0,  // a name that is not in a store
    Failure = 1,   // a file that can't be read or does not parse, a path that can't be used
    Fatal = 2      // for callers' own types: nothing in the library throws it
  };

  AppException(Level exceptionLevel, const Port::StringBase<char>& text);
  AppException(const AppException&) noexcept;
  AppException& operator=(const AppException&) noexcept;
  ~AppException() override;
  const char* what() const noexcept override;

  Level level;
  // Whether what went wrong has been told already, at the place where it was found: whoever catches
  // this then only tells what follows from it.
  bool told = false;
};

}  // namespace Tarvo

#endif
