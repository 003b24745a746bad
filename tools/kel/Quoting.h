#ifndef KEL_QUOTING_H
#define KEL_QUOTING_H

#include <string>
#include <string_view>

// One word or string of the languages that the formats are written in. A path may hold any byte
// but NUL.
namespace Quoting {

// The text with a backslash in front of each of these characters.
std::string Backslashed(const std::string& text, std::string_view special);

// For file lists of Verilog tools, which can't hold a line end.
std::string FileListWord(const std::string& text);

// With quotes only where they are needed, since people read these files too.
std::string ShellWord(const std::string& text);

// A string with quotes, of UTF-8.
std::string TomlString(const std::string& text);

std::string TclWord(const std::string& text);

// For a list of file names, which can't hold a blank.
std::string MakeWord(const std::string& text);

// A string with quotes, which is one element of a list.
std::string CMakeWord(const std::string& text);

// A pattern that stands for this path alone.
std::string GlobLiteral(const std::string& path);

bool IsUtf8(const std::string& text);

}  // namespace Quoting

#endif
