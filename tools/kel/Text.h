#ifndef KEL_TEXT_H
#define KEL_TEXT_H

#include <cstddef>
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

// In small letters, as far as ASCII goes.
std::string Lower(std::string text);

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

// How texts stand in the cells of a terminal, with the character set that main() sets.

// The first character of a text, or its first byte if that begins none or controls the terminal:
// such a byte counts for one cell, and is shown as \xNN.
struct Glyph {
  std::string_view bytes;
  std::string shown;
  std::size_t cells;
};
Glyph FirstGlyph(std::string_view text);

// The cells of a text, each tab being one of them.
std::size_t CountCells(std::string_view text);

// The number of Unicode characters of a text.
std::size_t CountCodePoints(std::string_view text);

// A line as it is shown in some cells, and marks below a part of it.
struct Excerpt {
  std::string line;
  std::string marks;
};
// Shows at most so many cells of a line: all, or what is around a part of it, with "..." where
// something is cut off. Tabs go to the next multiple of 8. The part is given in bytes, from 0 on;
// one without a length is the character there.
Excerpt MakeExcerpt(std::string_view line, std::size_t start, std::size_t length,
                    std::size_t width);

// The cells of a line on standard output.
std::size_t TerminalWidth();

#endif
