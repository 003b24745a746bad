#ifndef KEL_TEXT_H
#define KEL_TEXT_H

#include <string>
#include <string_view>

#include "Tarvo_Export.h"

// All bytes of a text, as the Standard Library's strings hold them.
inline std::string Text(const Tarvo::StringBase& text) { return std::string(text.View()); }

// The text with control characters written as \xNN, so that a line stays one line and a terminal
// obeys nothing that a file held. All bytes are written so if they are said to be controls.
std::string Printable(std::string_view text, bool isControl = false);

// Whether a character is a letter or digit of ASCII, or one of the others.
bool IsPlain(char character, std::string_view others);

// A byte as two hexadecimal digits.
std::string Hex(char byte);

// All texts of a list or set, with the same between each two.
template <class Texts>
std::string Join(const Texts& texts, const char* between = ", ") {
  std::string joined;
  for (const auto& text : texts) joined.append(joined.empty() ? "" : between).append(text);
  return joined;
}

// A path relative to a directory, or as it is if there is none. Paths are compared as texts; links
// are not followed. No relative path begins like an option.
std::string RelativeTo(const std::string& directory, const Tarvo::StringBase& path);

#endif
