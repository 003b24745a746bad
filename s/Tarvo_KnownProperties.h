#ifndef TARVO_KNOWNPROPERTIES_H
#define TARVO_KNOWNPROPERTIES_H

#include "Tarvo_PropertyList.h"

// The properties that have a meaning, and their defaults: the one table for the readers of core
// descriptions, for the lists of property names that callers get, and for the checker. A core may
// state others; they are kept like these.
namespace Tarvo::KnownProperties {

KnownPropertyRows OfCores();  // NAME, VERSION and options
KnownPropertyRows OfParameters();
KnownPropertyRows OfPorts();
KnownPropertyRows OfBusInterfaces();
KnownPropertyRows OfIoInterfaces();

}  // namespace Tarvo::KnownProperties

#endif
