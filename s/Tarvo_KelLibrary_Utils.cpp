#include "Tarvo_KelLibrary_Utils.h"

#include <algorithm>
#include <boost/filesystem.hpp>
#include <numeric>
#include <string>
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

// The reserved words of VHDL-2019 and of all editions before it, and the libraries that are there
// already; a blank before and behind each.
constexpr std::string_view kTakenNames =
    " abs access after alias all and architecture array assert assume assume_guarantee attribute "
    "begin block body buffer bus case component configuration constant context cover default "
    "disconnect downto else elsif end entity exit fairness file for force function generate "
    "generic group guarded if impure in inertial inout is label library linkage literal loop "
    "map mod nand new next nor not null of on open or others out package parameter port "
    "postponed private procedure process property protected pure range record register reject "
    "release rem report restrict restrict_guarantee return rol ror select sequence severity "
    "shared signal sla sll sra srl strong subtype then to transport type unaffected units until "
    "use variable view vmode vpkg vprop vunit wait when while with xnor xor ieee std ";

bool IsBasicIdentifier(std::string_view text) {
  const auto isLetter = [](char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); };
  const auto isPart = [&](char c) { return isLetter(c) || (c >= '0' && c <= '9') || c == '_'; };
  return !text.empty() && isLetter(text.front()) && text.back() != '_' &&
         text.find("__") == std::string_view::npos && std::all_of(text.begin(), text.end(), isPart);
}

}  // namespace

bool KelLibrary_Utils::IsHdlLibrary(const StringBase& text) {
  const std::string word = " " + std::string(Lower(text).View()) + " ";
  return IsBasicIdentifier(text.View()) && kTakenNames.find(word) == std::string_view::npos;
}

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
