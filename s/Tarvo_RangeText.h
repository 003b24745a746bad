#ifndef TARVO_RANGETEXT_H
#define TARVO_RANGETEXT_H

#include <optional>
#include <string_view>
#include <vector>

namespace Tarvo {

// The ranges of a description: a VEC is "[LEFT:RIGHT]", a RANGE "(ITEM, ...)" with items that are
// values or LOW:HIGH. Sides that are sums and products of numbers and names are read; of any other
// expression only the frame is looked at, and there are no items.
struct RangeText {
  struct Item {
    std::string_view low;
    std::string_view high;  // the same as the low one for a single value
  };

  std::vector<Item> items;
  std::vector<std::string_view> names;  // that the expressions use
};

// Reads them. Without a result where the text has another form.
std::optional<RangeText> ReadVector(std::string_view text);
std::optional<RangeText> ReadRange(std::string_view text);

// The number that a text is, in decimal or with 0x in front, or nothing.
std::optional<long long> ReadNumber(std::string_view text);

// The words of a VALUES, "(WORD: what it means; ...)" or with commas between.
std::vector<std::string_view> ReadValues(std::string_view text);

}  // namespace Tarvo

#endif
