#include "Tarvo_KelLibrary_Utils.h"

#include <algorithm>
#include <boost/filesystem.hpp>
#include <numeric>
#include <string_view>
#include <utility>

#include "Tarvo_Report.h"
#include "Tarvo_Word.h"

namespace Tarvo {

namespace {

constexpr char kPathDelimiter = ';';

StringList Split(const StringBase& list, char delimiter) {
  StringList pieces;
  ForEachPiece(list.View(), delimiter, [&](std::string_view piece) { pieces.emplace_back(piece); });
  return pieces;
}

// A path with a NUL byte in it would be tested, and used, without what stands behind.
bool IsDirectory(const StringBase& path) {
  if (path.View().find('\0') != std::string_view::npos) return false;
  boost::system::error_code error;
  return boost::filesystem::is_directory(path.GetText(), error);
}

// How many letters must be added, left out, changed or exchanged with their neighbour to make one
// text of the other.
std::size_t Distance(std::string_view left, std::string_view right) {
  using Row = std::vector<std::size_t>;
  // Of the table of distances between all beginnings of both texts, only three rows are needed at a
  // time.
  Row before;
  Row above(right.size() + 1);
  std::iota(above.begin(), above.end(), 0U);
  for (std::size_t i = 0; i < left.size(); ++i) {
    Row row = {i + 1};
    for (std::size_t j = 0; j < right.size(); ++j) {
      const std::size_t change = above[j] + (left[i] == right[j] ? 0 : 1);
      row.push_back(std::min({change, above[j + 1] + 1, row[j] + 1}));
      const bool exchanged = i > 0 && j > 0 && left[i] == right[j - 1] && left[i - 1] == right[j];
      if (exchanged) row.back() = std::min(row.back(), before[j - 1] + 1);
    }
    before = std::exchange(above, std::move(row));
  }
  return above.back();
}

// A text of many letters may have more of them wrong. One that is far longer or shorter than the
// word is refused before letters are compared.
bool IsNear(std::string_view text, std::string_view word) {
  if (text.size() < 2) return false;
  // Who wrote the beginning of a word meant that word, however long it is.
  if (word.substr(0, text.size()) == text) return true;
  const std::size_t most = std::max<std::size_t>(1, text.size() / 3);
  if (text.size() > word.size() + most || word.size() > text.size() + most) return false;
  return Distance(word, text) <= most;
}

StringBase Lower(StringBase text) {
  text.MakeLower();
  return text;
}

}  // namespace

StringList KelLibrary_Utils::ListNear(const StringBase& text, const StringList& words) {
  const StringBase wanted = Lower(text);
  StringList near;
  for (const StringBase& word : words) {
    if (IsNear(wanted.View(), Lower(word).View())) near.push_back(word);
  }
  return near;
}

StringList KelLibrary_Utils::GetPathVector(const StringBase& path) {
  // All or none: with one piece left out, a tool would go on with other versions than it was told.
  StringList directories = Split(path, kPathDelimiter);
  for (const StringBase& directory : directories) {
    if (!IsDirectory(directory)) {
      throw Report::Exception(AppException::Failure, "Invalid path directory %s\n", directory);
    }
  }
  return directories;
}

StringList KelLibrary_Utils::GetInterfaceVector(const StringBase& interfaces) {
  return Split(interfaces, kInterfaceDelimiter);
}

}  // namespace Tarvo
