// Texts as a terminal shows them: what a byte, a character and a cell are, and how a long line is
// cut.

#include "Text.h"

#include <sys/ioctl.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <cwchar>
#include <deque>
#include <filesystem>

namespace {

constexpr std::string_view kCut = "...";
constexpr std::size_t kTabStop = 8;

// A glyph at its cell of an excerpt that nothing is cut from.
struct ShownGlyph {
  std::string shown;
  std::size_t cell;
  std::size_t end;
};

ShownGlyph ShowAt(const Glyph& glyph, std::size_t cell) {
  if (glyph.bytes == "\t") {
    const std::size_t blanks = kTabStop - cell % kTabStop;
    return {std::string(blanks, ' '), cell, cell + blanks};
  }
  const bool isEscaped = glyph.shown != glyph.bytes;
  return {glyph.shown, cell, cell + (isEscaped ? glyph.shown.size() : glyph.cells)};
}

// What of a line may be shown, and the cells of the part in it.
struct Layout {
  std::deque<ShownGlyph> glyphs;
  std::size_t end = 0;
  std::size_t partStart = 0;
  std::size_t partEnd = 0;
};

// Of a long line, only what is near to the start of the part is kept.
Layout LayOut(std::string_view line, std::size_t start, std::size_t length, std::size_t width) {
  Layout layout;
  for (std::size_t at = 0; at < line.size();) {
    const Glyph glyph = FirstGlyph(line.substr(at));
    const ShownGlyph placed = ShowAt(glyph, layout.end);
    // A line of megabytes is laid out around the part alone.
    if (at > start && placed.cell > layout.partStart + width) break;
    if (at <= start) layout.partStart = placed.cell;
    if (at < start + length) layout.partEnd = placed.end;
    layout.glyphs.push_back(placed);
    if (layout.glyphs.front().end + width < layout.partStart) layout.glyphs.pop_front();
    layout.end = placed.end;
    at += glyph.bytes.size();
  }
  if (start >= line.size()) layout.partStart = layout.end;
  layout.partEnd = std::max(layout.partEnd, layout.partStart + 1);
  return layout;
}

// The first cell that is shown: further on only if the part would not be seen otherwise.
std::size_t FirstCell(const Layout& layout, std::size_t width) {
  const std::size_t seen = std::min(layout.partEnd, layout.partStart + width / 2);
  if (layout.end <= width || seen + kCut.size() <= width) return 0;
  return std::min(layout.partStart - width / 4, layout.end - (width - kCut.size()));
}

}  // namespace

std::string Printable(std::string_view text, bool isControl) {
  std::string printable;
  for (const char c : text) {
    const bool isShown = !isControl && static_cast<unsigned char>(c) >= ' ' && c != '\x7F';
    printable += isShown ? std::string(1, c) : "\\x" + Hex(c);
  }
  return printable;
}

bool IsPlain(char character, std::string_view others) {
  const auto isIn = [&](char first, char last) { return character >= first && character <= last; };
  return isIn('a', 'z') || isIn('A', 'Z') || isIn('0', '9') ||
         others.find(character) != std::string_view::npos;
}

std::string Lower(std::string text) {
  for (char& c : text) c = c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
  return text;
}

std::string Hex(char byte) {
  constexpr std::string_view digits = "0123456789abcdef";
  const auto number = static_cast<unsigned char>(byte);
  return {digits[number / 16], digits[number % 16]};
}

std::string RelativeTo(const std::string& directory, const Tarvo::StringBase& path) {
  namespace fs = std::filesystem;
  std::string text = Text(path);
  if (directory.empty() || text.empty()) return text;
  const fs::path base = fs::absolute(directory).lexically_normal();
  const std::string relative =
      fs::absolute(text).lexically_normal().lexically_relative(base).string();
  // A name that begins with a sign could be an option of the tool that reads it.
  const bool isPlain = relative.find_first_of("-+#/") != 0;
  return isPlain ? relative : "./" + relative;
}

Glyph FirstGlyph(std::string_view text) {
  std::mbstate_t state{};
  wchar_t character = 0;
  // By the locale, which main() sets to UTF-8: bytes that are no character are escaped.
  const std::size_t size = std::mbrtowc(&character, text.data(), text.size(), &state);
  const bool isCharacter = size > 0 && size <= text.size();
  const int cells = isCharacter ? ::wcwidth(character) : -1;
  if (cells < 0) return {text.substr(0, 1), Printable(text.substr(0, 1), true), 1};
  const std::string_view bytes = text.substr(0, size);
  return {bytes, std::string(bytes), static_cast<std::size_t>(cells)};
}

std::size_t CountCells(std::string_view text) {
  std::size_t count = 0;
  while (!text.empty()) {
    const Glyph glyph = FirstGlyph(text);
    count += glyph.cells;
    text.remove_prefix(glyph.bytes.size());
  }
  return count;
}

std::size_t CountCodePoints(std::string_view text) {
  const auto begins = [](char c) { return (static_cast<unsigned char>(c) & 0xC0U) != 0x80U; };
  return static_cast<std::size_t>(std::count_if(text.begin(), text.end(), begins));
}

Excerpt MakeExcerpt(std::string_view line, std::size_t start, std::size_t length,
                    std::size_t width) {
  Layout layout = LayOut(line, start, length, width);
  const std::size_t first = FirstCell(layout, width);
  while (!layout.glyphs.empty() && layout.glyphs.front().cell < first) layout.glyphs.pop_front();
  const std::string lead(first > 0 ? kCut : "");
  const std::size_t shift = layout.glyphs.empty() ? 0 : layout.glyphs.front().cell;
  std::size_t last = shift + width - lead.size();
  const bool isCut = layout.end > last;
  if (isCut) last -= kCut.size();
  Excerpt excerpt = {lead, std::string(lead.size() + layout.partStart - shift, ' ')};
  for (const ShownGlyph& glyph : layout.glyphs) {
    if (glyph.end <= last) excerpt.line += glyph.shown;
  }
  if (isCut) excerpt.line += kCut;
  const std::size_t end = isCut ? std::min(layout.partEnd, last) : layout.partEnd;
  excerpt.marks += std::string(std::max(end, layout.partStart + 1) - layout.partStart, '^');
  return excerpt;
}

std::size_t TerminalWidth() {
  constexpr long usual = 80;
  constexpr long least = 40;
  winsize size{};
  const char* const columns = std::getenv("COLUMNS");
  long width = ::ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0 ? size.ws_col : 0;
  if (width == 0 && columns != nullptr) width = std::strtol(columns, nullptr, 10);
  return static_cast<std::size_t>(width > 0 ? std::max(width, least) : usual);
}
