#ifndef TARVO_PROPERTYLIST_H
#define TARVO_PROPERTYLIST_H

#include <algorithm>
#include <span>

#include "Tarvo_Export.h"
#include "Tarvo_Word.h"

namespace Tarvo {

// What all users of a PropertyList share: the first match, the names, and rows of defaults.

// A row of a table of defaults, and what the properties must show for it to apply, if anything. It
// points at exported constants, so that no table depends on the order in which modules load.
struct DefaultRow {
  const StringBase* name;
  const StringBase* value;
  bool (*applies)(const PropertyList& properties) = nullptr;
};
using DefaultRows = std::span<const DefaultRow>;

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

inline bool Applies(const DefaultRow& row, const PropertyList& properties) {
  return row.applies == nullptr || row.applies(properties);
}

// The default of that name, in either letter case, or null.
inline const StringBase* FindDefault(const PropertyList& properties, DefaultRows defaults,
                                     const StringBase& name) {
  const auto found = std::find_if(defaults.begin(), defaults.end(), [&](const DefaultRow& row) {
    return Matches(name, *row.name) && Applies(row, properties);
  });
  return found == defaults.end() ? nullptr : found->value;
}

// Gives `add` each row that applies and whose name is missing, in their order.
template <class Add>
void ForEachMissing(const PropertyList& properties, DefaultRows defaults, const Add& add) {
  for (const DefaultRow& row : defaults) {
    if (!FindValue(properties, *row.name) && Applies(row, properties)) add(row);
  }
}

}  // namespace Tarvo

#endif
