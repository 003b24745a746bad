#ifndef TARVO_OPTIONDEFAULTS_H
#define TARVO_OPTIONDEFAULTS_H

#include "Tarvo_PropertyList.h"

namespace Tarvo {

// The options that every core has, stated or not. The one table for both readers of core
// descriptions; it stands with OptionScanner, whose constants it points at.
extern const DefaultRow kOptionDefaults[4];

}  // namespace Tarvo

#endif
