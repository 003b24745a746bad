#ifndef TARVO_KELLIBRARY_UTILS_H
#define TARVO_KELLIBRARY_UTILS_H

#include "Tarvo_Export.h"

namespace Tarvo {

// The two list splitters. A piece is a longest run without the delimiter, so delimiters at the
// ends or in a row give no empty pieces. Nothing else happens to a piece: no trimming, no quoting,
// no change of case, and equal pieces all stay. Results come in the order of the text.
//
// Both may throw std::bad_alloc and may be called from several threads.
class TARVO_EXPORT KelLibrary_Utils {
 public:
  // Splits a repository path at ";" and tests each piece: the first that is no directory ends the
  // operation with AppException, level Failure, that names it.
  static StringList GetPathVector(const StringBase& path);

  // Splits the names of interfaces at ":". Nothing is tested.
  static StringList GetInterfaceVector(const StringBase& interfaces);

  KelLibrary_Utils() = delete;
};

}  // namespace Tarvo

#endif
