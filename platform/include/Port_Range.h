#ifndef PORT_RANGE_H
#define PORT_RANGE_H

// A run of positions in a text, counted from 0, both ends inclusive. A range whose `last` lies
// below its `first` is empty; so is a new one.
struct Port_Range {
  constexpr Port_Range() noexcept = default;
  constexpr Port_Range(unsigned firstIndex, unsigned lastIndex) noexcept
      : first(firstIndex), last(lastIndex) {}

  constexpr bool IsEmpty() const noexcept { return last < first; }

  unsigned first = 1;
  unsigned last = 0;
};

#endif
