#ifndef KEL_CELLS_H
#define KEL_CELLS_H

#include <cstddef>
#include <string>
#include <string_view>

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
