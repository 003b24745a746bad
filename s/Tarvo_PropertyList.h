#ifndef TARVO_PROPERTYLIST_H
#define TARVO_PROPERTYLIST_H

#include <algorithm>
#include <span>

#include "Tarvo_Export.h"
#include "Tarvo_Word.h"

namespace Tarvo {

// What all users of a PropertyList share: the first match, the names, and rows of known properties.

// A property that means something to tools: its name, and the default that it has where it is not
// stated, if there is one. A default may count for some records alone.
//
// A row points at exported constants, so that no table depends on the order in which modules load.
struct KnownProperty {
  using Condition = bool (*)(const PropertyList& record);

  constexpr KnownProperty(const char* name) : literal(name) {}
  constexpr KnownProperty(const StringBase& name, const StringBase* defaultValue = nullptr,
                          Condition hasDefault = nullptr)
      : constant(&name), value(defaultValue), condition(hasDefault) {}

  StringBase GetName() const { return constant ? *constant : StringBase(literal); }
  bool HasDefault(const PropertyList& record) const {
    return value != nullptr && (condition == nullptr || condition(record));
  }

  const char* literal = nullptr;
  const StringBase* constant = nullptr;  // the name of every property that has a default
  const StringBase* value = nullptr;     // the default, or null
  Condition condition = nullptr;         // null for a default that always counts
};
using KnownPropertyRows = std::span<const KnownProperty>;

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

inline StringList NamesOf(KnownPropertyRows rows) {
  StringList names;
  names.reserve(rows.size());
  for (const KnownProperty& row : rows) names.push_back(row.GetName());
  return names;
}

// The default of that name, in either letter case, or null.
inline const StringBase* FindDefault(const PropertyList& record, KnownPropertyRows known,
                                     const StringBase& name) {
  const auto found = std::find_if(known.begin(), known.end(), [&](const KnownProperty& row) {
    return row.value != nullptr && EqualsIgnoringCase(name, *row.constant) &&
           row.HasDefault(record);
  });
  return found == known.end() ? nullptr : found->value;
}

// Gives `add` the name and value of each default whose property is not stated, in their order.
template <class Add>
void ForEachMissing(const PropertyList& record, KnownPropertyRows known, const Add& add) {
  for (const KnownProperty& row : known) {
    if (row.value != nullptr && !FindValue(record, *row.constant) && row.HasDefault(record)) {
      add(*row.constant, *row.value);
    }
  }
}

}  // namespace Tarvo

#endif
