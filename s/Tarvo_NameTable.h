#ifndef TARVO_NAMETABLE_H
#define TARVO_NAMETABLE_H

#include <bit>
#include <cstddef>
#include <functional>
#include <string_view>
#include <utility>
#include <vector>

#include "Tarvo_Export.h"

// Leads from a name to the first entry that has it, in a list of records or properties: a structure
// of `entries` and their `table`. A table holds numbers of entries, never views or addresses, so
// that a copy of list and table is good by itself. Names of entries must not change.
namespace Tarvo::NameTable {

using Numbers = std::vector<unsigned>;

// Shorter lists have no table. To walk them is as fast, and most records have few properties.
inline constexpr std::size_t kShortest = 16;
inline constexpr unsigned kNone = ~0U;

inline std::string_view NameOf(const Property& property) { return property.first.View(); }
template <class Record>
std::string_view NameOf(const Record& record) {
  return record.name.View();
}

// The slot that holds the number of the first entry of that name, or the empty one where it would
// stand. Of the slots, whose number is a power of two, at least half are empty.
template <class Entry>
std::size_t SlotOf(const std::vector<Entry>& entries, const Numbers& table, std::string_view name) {
  const std::size_t mask = table.size() - 1;
  std::size_t slot = std::hash<std::string_view>()(name) & mask;
  while (table[slot] != kNone && NameOf(entries[table[slot]]) != name) slot = (slot + 1) & mask;
  return slot;
}

// Enters an entry, unless an earlier one has its name.
template <class Entry>
void Enter(const std::vector<Entry>& entries, Numbers& table, std::size_t number) {
  unsigned& owner = table[SlotOf(entries, table, NameOf(entries[number]))];
  if (owner == kNone) owner = static_cast<unsigned>(number);
}

// Makes the table that a list of so many entries needs, unless it has it.
template <class List>
void MakeRoom(List& list, std::size_t count) {
  if (count < kShortest || list.table.size() >= 2 * count) return;
  Numbers table(std::bit_ceil(2 * count), kNone);
  for (std::size_t i = 0; i < list.entries.size(); ++i) Enter(list.entries, table, i);
  list.table.swap(table);
}

// Makes the table of a list that is complete.
template <class List>
void Make(List& list) {
  MakeRoom(list, list.entries.size());
}

// Adds an entry to a list that has its table. If memory runs out, the list is as it was.
template <class List, class Entry>
void Append(List& list, Entry entry) {
  MakeRoom(list, list.entries.size() + 1);
  list.entries.push_back(std::move(entry));
  if (!list.table.empty()) Enter(list.entries, list.table, list.entries.size() - 1);
}

// The number of the first entry of that name, or how many entries there are. Needs no memory.
template <class List>
std::size_t Find(const List& list, std::string_view name) {
  const std::size_t count = list.entries.size();
  if (!list.table.empty()) {
    const unsigned number = list.table[SlotOf(list.entries, list.table, name)];
    return number == kNone ? count : number;
  }
  std::size_t number = 0;
  while (number < count && NameOf(list.entries[number]) != name) ++number;
  return number;
}

}  // namespace Tarvo::NameTable

#endif
