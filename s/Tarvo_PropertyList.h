#ifndef TARVO_PROPERTYLIST_H
#define TARVO_PROPERTYLIST_H

#include <algorithm>

#include "Tarvo_Export.h"

namespace Tarvo {

// What all users of a PropertyList share: the first match, the names, and rows of defaults.

// A row of a table of defaults. It points at exported constants, so that no table depends on the
// order in which modules load.
struct DefaultRow {
  const StringBase* name;
  const StringBase* value;
};

// The value of the first entry with exactly that name, or null.
inline const StringBase* FindValue(const PropertyList& properties, const StringBase& name) {
  const auto found = std::find_if(properties.begin(), properties.end(),
                                  [&](const Property& property) { return property.first == name; });
  return found == properties.end() ? nullptr : &found->second;
}

// All names, duplicates included.
inline StringList NamesOf(const PropertyList& properties) {
  StringList names;
  names.reserve(properties.size());
  for (const Property& property : properties) names.push_back(property.first);
  return names;
}

// Appends the rows whose names are missing, in their order.
template <class Rows>
void AppendMissing(PropertyList& properties, const Rows& defaults) {
  for (const DefaultRow& row : defaults) {
    if (!FindValue(properties, *row.name)) properties.emplace_back(*row.name, *row.value);
  }
}

}  // namespace Tarvo

#endif
