#ifndef TARVO_KELLIBRARY_UTILS_H
#define TARVO_KELLIBRARY_UTILS_H

#include "Tarvo_Export.h"

namespace Tarvo {

// What others than the library need too: the two list splitters, what a misspelt word may have
// meant, and which names VHDL libraries may have. A piece of a list is a longest run without the
// delimiter, so delimiters at the ends or in a row give no empty pieces. Nothing else happens to a
// piece: no trimming, no quoting, no change of case, and equal pieces all stay. Results come in the
// order of the text.
//
// All may throw std::bad_alloc and may be called from several threads.
class TARVO_EXPORT KelLibrary_Utils {
 public:
  // Splits a repository path at ";" and tests each piece: the first that is no directory ends the
  // operation with AppException, level Failure, that names it.
  static StringList GetPathVector(const StringBase& path);

  // Splits the names of interfaces at ":". Nothing is tested.
  static StringList GetInterfaceVector(const StringBase& interfaces);

  // Those of the words that a text may have been meant for, in their order: they differ from it in
  // letter case or in few letters, or it is how they begin.
  static StringList ListNear(const StringBase& text, const StringList& words);

  // Whether a text may be the logical name of a VHDL library that sources are analysed into:
  // letters of ASCII, digits and single "_", a letter first and no "_" last; no reserved word up to
  // VHDL-2019; and neither std nor ieee, which are there already. In either letter case.
  static bool IsHdlLibrary(const StringBase& text);

  KelLibrary_Utils() = delete;
};

}  // namespace Tarvo

#endif
