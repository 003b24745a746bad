#ifndef TARVO_EXPORT_H
#define TARVO_EXPORT_H

// What every header of the library begins with: the marks of an exported class and of its members
// that stay hidden, and the short names of the types that all interfaces pass.

#include <utility>
#include <vector>

#include "Port_Export.h"
#include "Port_StringBase.h"

#define TARVO_EXPORT PORT_EXPORT
#define TARVO_LOCAL PORT_LOCAL

namespace Tarvo {

using StringBase = Port::StringBase<char>;
using StringList = std::vector<StringBase>;

// Names with their values, in order. A name may stand more than once; its first entry counts.
using Property = std::pair<StringBase, StringBase>;
using PropertyList = std::vector<Property>;

// The name of the logger that the traces of the library go to; see Tarvo_DebugMessenger.h.
inline constexpr char kLoggerName[] = "BaseIP";

}  // namespace Tarvo

#endif
