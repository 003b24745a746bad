#ifndef TARVO_PROPERTYNAMES_H
#define TARVO_PROPERTYNAMES_H

#include "Tarvo_Export.h"

// The names of the properties that have a meaning, for a core and for each kind of record. The
// catalogues of KelLibrary and KelIP are made of them.
namespace Tarvo::PropertyNames {

StringList OfCores();  // NAME, VERSION and options
StringList OfParameters();
StringList OfPorts();
StringList OfBusInterfaces();
StringList OfIoInterfaces();

}  // namespace Tarvo::PropertyNames

#endif
