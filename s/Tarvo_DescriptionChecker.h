#ifndef TARVO_DESCRIPTIONCHECKER_H
#define TARVO_DESCRIPTIONCHECKER_H

#include <vector>

#include "Port_FileName.h"
#include "Tarvo_Export.h"

namespace Tarvo {

// What a description says that the checks of the core's other files go by. Where it is bad, it is
// what its good lines say.
struct DescribedParameter {
  StringBase name;
  StringBase range;  // RANGE and VALUES as stated, or empty
  StringBase values;
};
struct DescribedCore {
  bool isStyleKnown = true;  // whether there is a description, and its STYLE is one
  bool hasSources = true;
  bool hasNetlists = false;
  StringBase language;
  std::vector<DescribedParameter> parameters;
  bool hasAllParameters = true;  // no statement of one is bad
};

// Tells all that is wrong with a description, line by line, to the collector of this thread.
DescribedCore CheckDescription(const Port::FileName& file);

}  // namespace Tarvo

#endif
