#include "Text.h"

#include <algorithm>

std::string Printable(std::string_view text) {
  constexpr std::string_view digits = "0123456789abcdef";
  std::string printable;
  for (const char c : text) {
    const auto byte = static_cast<unsigned char>(c);
    if (byte >= ' ' && byte != 0x7F) {
      printable += c;
    } else {
      printable += {'\\', 'x', digits[byte / 16], digits[byte % 16]};
    }
  }
  return printable;
}

std::vector<std::string> Fields(std::string_view line, const std::string& marks) {
  std::vector<std::string> fields;
  const std::string ends = " \"'" + marks;
  while (!line.empty()) {
    const char first = line.front();
    const bool quoted = first == '"' || first == '\'';
    std::size_t size = quoted ? line.find(first, 1) : line.find_first_of(ends);
    if (size == std::string_view::npos) size = line.size();
    if (quoted) {
      fields.emplace_back(line.substr(1, size - 1));
      ++size;
    } else if (size > 0) {
      fields.emplace_back(line.substr(0, size));
    } else {
      if (first != ' ') fields.emplace_back(1, first);
      ++size;
    }
    line.remove_prefix(std::min(size, line.size()));
  }
  return fields;
}
