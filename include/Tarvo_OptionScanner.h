#ifndef TARVO_OPTIONSCANNER_H
#define TARVO_OPTIONSCANNER_H

#include "Port_File.h"
#include "Port_FileName.h"
#include "Tarvo_Export.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

// Reads the options of a core description, and nothing else of it: what a walk over a repository
// wants to know of each version. The result is complete in itself; it holds the version's own name
// and version, taken from its key, and every default.
//
// The file is read by the constructor. Threads: like an int; several may read one object.
class TARVO_EXPORT OptionScanner {
 public:
  static const StringBase QVR_TRUE;
  static const StringBase QVR_FALSE;
  static const StringBase QVR_OPTION;
  static const StringBase QVR_OPTION_NAME;
  static const StringBase QVR_OPTION_VERSION;
  static const StringBase QVR_OPTION_IMP_NETLIST;
  static const StringBase QVR_OPTION_RUN_TRAMFOLD;
  static const StringBase QVR_OPTION_STYLE;
  static const StringBase QVR_OPTION_STYLE_HDL;
  static const StringBase QVR_OPTION_USAGE_LEVEL;
  static const StringBase QVR_OPTION_USAGE_LEVEL_ADVANCED;

  // Reads the options from the file. Throws AppException with level Failure if the key is not valid
  // (then the file is not touched), if the file can't be read, or, after the whole file, if a
  // statement was bad: each bad one was then issued as an error with its line. May throw
  // std::bad_alloc, and std::length_error for a line beyond 4 GiB.
  OptionScanner(const Kel_Key& key, const Port::FileName& file);
  // The same for a file that was looked for already, under that name.
  OptionScanner(const Kel_Key& key, const Port::FileName& file, Port::FoundFile found);
  ~OptionScanner();

  // NAME and VERSION, then the options of the file in its order, duplicates included, then the
  // defaults of IMP_NETLIST, RUN_TRAMFOLD, STYLE and USAGE_LEVEL that are missing.
  PropertyList GetOptions() const;
  // The same, handed over without a copy. Afterwards the scanner has none.
  PropertyList TakeOptions();

  // The value of the first entry with exactly that name; empty if there is none.
  static StringBase GetOptionValue(const PropertyList& options, const StringBase& name);

 private:
  PropertyList options;
};

}  // namespace Tarvo

#endif
