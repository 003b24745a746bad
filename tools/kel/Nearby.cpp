#include "Nearby.h"

#include <algorithm>
#include <filesystem>
#include <numeric>
#include <set>
#include <utility>

#include "Messages.h"
#include "Tarvo_Kel_Index.h"
#include "Text.h"
#include "Verbs.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Key;
using Tarvo::StringBase;

// How many letters must be added, left out, changed or exchanged with their neighbour to make one
// text of the other.
std::size_t Distance(const std::string& left, const std::string& right) {
  using Row = std::vector<std::size_t>;
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

bool IsRepository(const fs::path& directory) {
  std::error_code error;
  return fs::is_directory(directory / "ipmods", error);
}

// The nearest repository above a directory, and those right in it.
std::set<std::string> RepositoriesNear(const fs::path& directory) {
  std::set<std::string> near;
  for (fs::path above = directory; near.empty() && above != above.root_path();) {
    above = above.parent_path();
    if (IsRepository(above)) near.insert(above);
  }
  std::error_code error;
  for (fs::directory_iterator entry(directory, error), end; !error && entry != end;
       entry.increment(error)) {
    if (IsRepository(entry->path())) near.insert(entry->path());
  }
  return near;
}

bool IsNear(const std::string& word, const std::string& text) {
  const std::size_t most = std::max<std::size_t>(1, text.size() / 3);
  if (text.empty() || text.size() > word.size() + most) return false;  // of any length
  return word.rfind(text, 0) == 0 || Distance(word, text) <= most;
}

std::string Question(const std::set<std::string>& names) {
  return names.empty() ? "" : "; did you mean " + Join(names, " or ") + "?";
}

}  // namespace

std::string DidYouMean(const std::vector<std::string>& words, const std::string& text) {
  std::set<std::string> near;
  for (const std::string& word : words) {
    if (IsNear(word, text)) near.insert(word);
  }
  return Question(near);
}

void SuggestKeys(const Tarvo::KelLibrary& library, const std::string& key) {
  const Kel_Key asked{StringBase(key.c_str())};
  StringBase wanted = asked.GetName();
  wanted.MakeLower();
  std::set<std::string> versions;
  std::set<std::string> names;
  for (const StringBase& text : library.GetIndex().GetAllVersionKeys()) {
    const Kel_Key other(text);
    StringBase name = other.GetName();
    if (name == asked.GetName()) {
      if (!asked.IsValid() || other == asked) return;
      versions.insert(Text(text));
    }
    name.MakeLower();
    if (IsNear(Text(name), Text(wanted))) names.insert(Text(other.GetName()));
  }
  if (!versions.empty()) {
    Messages::Note("the versions of this core are " + Join(versions));
  } else if (!names.empty()) {
    Messages::Note("no core is named " + Text(asked.GetName()) + Question(names));
  }
}

void SuggestRepositories(const Call& call) {
  for (const std::string& repository : Repositories(call)) {
    std::error_code error;
    if (!fs::is_directory(repository, error) || IsRepository(repository)) continue;
    const auto near = RepositoriesNear(fs::absolute(repository).lexically_normal());
    if (!near.empty()) Messages::Note(repository + " is no repository" + Question(near));
  }
}
