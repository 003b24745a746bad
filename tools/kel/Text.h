#ifndef KEL_TEXT_H
#define KEL_TEXT_H

#include <string>
#include <string_view>
#include <vector>

#include "Tarvo_Export.h"

// All bytes of a text, as the Standard Library's strings hold them.
inline std::string Text(const Tarvo::StringBase& text) { return std::string(text.View()); }

// The text with control characters written as \xNN, so that a line stays one line and a terminal
// obeys nothing that a file held.
std::string Printable(std::string_view text);

// All texts of a list or set, with the same between each two.
template <class Texts>
std::string Join(const Texts& texts, const char* between = ", ") {
  std::string joined;
  for (const auto& text : texts) joined.append(joined.empty() ? "" : between).append(text);
  return joined;
}

// The fields of a line of a data file: words between blanks, each of the marks being a field of its
// own, and what stands between quotes.
std::vector<std::string> Fields(std::string_view line, const std::string& marks = "");

#endif
