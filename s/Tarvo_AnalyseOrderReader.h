#ifndef TARVO_ANALYSEORDERREADER_H
#define TARVO_ANALYSEORDERREADER_H

#include "Port_FileName.h"
#include "Tarvo_AnalyseOrder.h"
#include "Tarvo_Export.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

class Kel_Index;

// The order that a file gives, taken for that of the version, with those of the cores that it
// includes. The root is the version that nothing below may include; an invalid key stands for the
// version itself. Defined beside LDXParser, whose messages it issues and whose header tells what it
// throws.
AnalyseOrder ReadAnalyseOrder(const Port::FileName& file, const Kel_Index& index,
                              const Kel_Key& version, const Kel_Key& root,
                              const StringBase& language);

}  // namespace Tarvo

#endif
