// A Standard Library string with lengths of 32 bits, as the interfaces have them. Each way to make
// a longer one is closed by an exception.

#include "Port_StringBase.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdarg>
#include <cstdio>
#include <stdexcept>

namespace Port {

namespace {

using String = StringBase<char>;

constexpr std::size_t kLongest = String::All - 1;

void CheckLength(std::size_t length) {
  if (length > kLongest) throw std::length_error("text of more than 4 GiB");
}

std::string_view FirstBytes(const char* content, unsigned count) {
  return count == String::All ? ToView(content) : std::string_view(content, count);
}

constexpr char Lower(char c) noexcept {
  return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

// Orders by bytes as unsigned values, whatever the sign of char.
int CompareBytes(char left, char right) noexcept {
  return static_cast<int>(static_cast<unsigned char>(left)) - static_cast<unsigned char>(right);
}

int CompareFolded(std::string_view left, std::string_view right) noexcept {
  const std::size_t common = std::min(left.size(), right.size());
  for (std::size_t i = 0; i < common; ++i) {
    if (const int order = CompareBytes(Lower(left[i]), Lower(right[i]))) return order;
  }
  return left.size() < right.size() ? -1 : static_cast<int>(left.size() > right.size());
}

}  // namespace

String::StringBase(const char* content) : StringBase(ToView(content)) {}

String::StringBase(std::string_view content) {
  CheckLength(content.size());
  text = content;
}

void String::Assign(const StringBase& content, bool /*reserved*/) { text = content.text; }

void String::Assign(const char* content, unsigned count) {
  const std::string_view bytes = FirstBytes(content, count);
  CheckLength(bytes.size());
  text.assign(bytes.data(), bytes.size());
}

void String::Append(const StringBase& content) {
  CheckLength(text.size() + content.text.size());
  text += content.text;
}

void String::Append(const char* content, unsigned count) {
  const std::string_view bytes = FirstBytes(content, count);
  CheckLength(text.size() + bytes.size());
  text.append(bytes.data(), bytes.size());
}

int String::Compare(const StringBase& other, CompareType type) const noexcept {
  return type == CompareIgnoreCase ? CompareFolded(text, other.text) : text.compare(other.text);
}

// Counts in 64 bits, since a range may end at the largest unsigned value.
std::string_view String::Slice(const Port_Range& range) const noexcept {
  if (range.IsEmpty() || range.first >= text.size()) return {};
  const std::size_t length = static_cast<std::size_t>(range.last) - range.first + 1;
  return View().substr(range.first, length);
}

String String::Extract(const Port_Range& range) const { return String(Slice(range)); }

unsigned String::GetIndexOfFirstChar(char character, char /*reserved*/) const noexcept {
  const std::size_t index = text.find(character);
  return index == std::string::npos ? None : static_cast<unsigned>(index);
}

bool String::GetUINT32(const Port_Range& range, unsigned* value) const noexcept {
  const std::string_view digits = Slice(range);
  const char* const end = digits.data() + digits.size();
  unsigned number = 0;
  const auto [stop, error] = std::from_chars(digits.data(), end, number);
  if (error != std::errc() || stop != end) return false;
  *value = number;
  return true;
}

void String::MakeLower() noexcept { std::transform(text.begin(), text.end(), text.begin(), Lower); }

unsigned String::ReplaceChars(char from, char to) noexcept {
  unsigned count = 0;
  std::size_t at = 0;
  while ((at = text.find(from, at)) != std::string::npos) {
    text[at++] = to;
    ++count;
  }
  return count;
}

void String::Trim(const char* set, TrimType type) noexcept {
  // Where no other character is found, the place is npos, and npos + 1 the beginning.
  if (type != TrimStart) text.erase(text.find_last_not_of(set) + 1);
  if (type != TrimEnd) text.erase(0, text.find_first_not_of(set));
}

// Most texts are short: those are written once and copied, longer ones are measured by that.
String String::doFormat(const char* format, ...) {
  std::array<char, 256> brief;
  std::va_list arguments;
  va_start(arguments, format);
  const int length = std::vsnprintf(brief.data(), brief.size(), format, arguments);
  va_end(arguments);
  if (length < 0) throw std::length_error("formatted text of more than 2 GiB");
  // Formatted once more only if the short buffer was too small.
  const auto size = static_cast<std::size_t>(length);
  if (size < brief.size()) return String(std::string_view(brief.data(), size));

  String result;
  result.text.resize(size);
  va_start(arguments, format);
  static_cast<void>(std::vsnprintf(result.text.data(), size + 1, format, arguments));
  va_end(arguments);
  return result;
}

}  // namespace Port
