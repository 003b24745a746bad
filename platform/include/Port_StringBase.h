#ifndef PORT_STRINGBASE_H
#define PORT_STRINGBASE_H

#include <functional>
#include <string>
#include <string_view>
#include <type_traits>
#ifdef __cpp_impl_three_way_comparison
#include <compare>
#endif

#include "Port_Export.h"
#include "Port_Range.h"

namespace Port {

template <class Character>
class StringBase;

// A string of bytes that knows its length; a NUL byte stands behind the last one. Copies are
// independent values. Nothing here depends on the locale: letters are the ASCII letters, and order
// is that of the bytes.
//
// A string holds at most 4 GiB - 2 bytes; what would grow beyond throws std::length_error, and any
// operation that grows a string may throw std::bad_alloc. In both cases the string keeps its
// content.
//
// Where a text is wanted as `const char*`, a string converts by itself, and the pointer is good
// until the string changes or ends: of a result that no variable keeps, only to the end of the
// statement. What reads it by that pointer sees the text end at a NUL byte; View()
// gives all of it. The comparisons below take part in overload resolution ahead of that
// conversion, so that `a < b` never compares addresses.
//
// Threads: like an int. Several may read one string; who writes must be alone.
template <>
class PORT_EXPORT StringBase<char> {
 public:
  enum CompareType { CompareExact = 0, CompareIgnoreCase = 1 };
  enum TrimType { TrimStart = 0, TrimEnd = 1, TrimBoth = 2 };

  // As a count: the whole NUL-terminated text. As an index: there is none.
  static constexpr unsigned All = ~0U;
  static constexpr unsigned None = ~0U;

  StringBase() noexcept = default;
  // The NUL-terminated text; a null pointer gives the empty string.
  StringBase(const char* content);
  // The bytes of the view, NULs included.
  explicit StringBase(std::string_view content);

  operator const char*() const noexcept PORT_LIFETIME_BOUND { return text.c_str(); }
  const char* GetText() const noexcept PORT_LIFETIME_BOUND { return text.c_str(); }
  // Would be true for the empty string too: ask for GetLength() instead.
  explicit operator bool() const = delete;

  unsigned GetLength() const noexcept { return static_cast<unsigned>(text.size()); }
  std::string_view View() const noexcept PORT_LIFETIME_BOUND { return text; }

  // Replaces the content. The flag has no effect; a count is refused, since it would be taken for
  // the flag.
  void Assign(const StringBase& content, bool reserved = false);
  template <class Text, class Count, class = std::enable_if_t<std::is_same_v<Text, StringBase>>>
  void Assign(const Text& content, Count count) = delete;
  // Replaces the content by the first `count` bytes of the text, which must have so many, or by the
  // whole NUL-terminated text for All. The text may lie within this string.
  void Assign(const char* content, unsigned count = All);

  // The same two, but behind the content.
  void Append(const StringBase& content);
  void Append(const StringBase& content, unsigned count) = delete;
  void Append(const char* content, unsigned count = All);

  // Makes the length 0.
  void Empty() noexcept { text.clear(); }

  // 0 for a match, else the sign of the first difference as bytes. CompareIgnoreCase takes the
  // ASCII letters of either case as one.
  int Compare(const StringBase& other, CompareType type) const noexcept;

  // The bytes from range.first through range.last. A range that reaches past the end stops there;
  // an empty one, or one that begins behind the end, gives the empty string.
  StringBase Extract(const Port_Range& range) const;

  // The index of the first such character, or None. The second argument has no effect.
  unsigned GetIndexOfFirstChar(char character, char reserved = 0) const noexcept;

  // Reads the range as a decimal number. False, with the value untouched, if anything in it is not
  // a digit, if it is empty, or if the number does not fit into 32 bits.
  bool GetUINT32(const Port_Range& range, unsigned* value) const noexcept;

  // Lower-cases the ASCII letters in place.
  void MakeLower() noexcept;

  // Replaces each `from` by `to` and gives the number of replacements.
  unsigned ReplaceChars(char from, char to) noexcept;

  // Removes the characters of the NUL-terminated set from the ends that the type names.
  void Trim(const char* set, TrimType type) noexcept;

  // The text that printf would write, at most 2 GiB of it: a longer one throws std::length_error.
  static StringBase doFormat(const char* format, ...) PORT_PRINTF(1, 2);

 private:
  PORT_LOCAL std::string_view Slice(const Port_Range& range) const noexcept;

  std::string text;
};

inline std::string_view ToView(const char* text) noexcept {
  return text ? text : std::string_view();
}
inline std::string_view ToView(const StringBase<char>& text) noexcept { return text.View(); }

// Comparisons are exact: length and bytes, as unsigned values. Where one text begins with the
// other, the shorter one comes first.
#define PORT_COMPARE_STRINGS(op)                                                                  \
  inline bool operator op(const StringBase<char>& left, const StringBase<char>& right) noexcept { \
    return left.View() op right.View();                                                           \
  }                                                                                               \
  inline bool operator op(const StringBase<char>& left, const char* right) noexcept {             \
    return left.View() op ToView(right);                                                          \
  }                                                                                               \
  inline bool operator op(const char* left, const StringBase<char>& right) noexcept {             \
    return ToView(left) op right.View();                                                          \
  }
PORT_COMPARE_STRINGS(==)
PORT_COMPARE_STRINGS(!=)
PORT_COMPARE_STRINGS(<)
PORT_COMPARE_STRINGS(>)
PORT_COMPARE_STRINGS(<=)
PORT_COMPARE_STRINGS(>=)
#undef PORT_COMPARE_STRINGS

// From C++20 on a tuple of strings asks for this one, and would get that of their addresses.
#ifdef __cpp_impl_three_way_comparison
inline std::strong_ordering operator<=>(const StringBase<char>& left,
                                        const StringBase<char>& right) noexcept {
  return left.View().compare(right.View()) <=> 0;
}
inline std::strong_ordering operator<=>(const StringBase<char>& left, const char* right) noexcept {
  return left.View().compare(ToView(right)) <=> 0;
}
#endif

}  // namespace Port

// Not noexcept: so the standard library keeps the hash of each text in a table, as it does for its
// own strings, and hashes none again when it looks along a bucket.
template <>
struct std::hash<Port::StringBase<char>> {
  std::size_t operator()(const Port::StringBase<char>& text) const {
    return std::hash<std::string_view>()(text.View());
  }
};

#endif
