// What somebody may have meant. Nothing here is an answer, so it may look at more than was asked
// for.

#include "Suggestions.h"

#include <filesystem>
#include <set>

#include "Tarvo_KelLibrary_Utils.h"
#include "Tarvo_Kel_Index.h"
#include "Text.h"
#include "Verb.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Key;
using Tarvo::KelLibrary_Utils;
using Tarvo::StringBase;
using Tarvo::StringList;

bool IsRepository(const fs::path& directory) {
  std::error_code error;
  return fs::is_directory(directory / Tarvo::Kel_Index::KEL_VERSIONS_SUBDIRECTORY.GetText(), error);
}

// The nearest repository above a directory, and those right in it.
std::set<std::string> RepositoriesNear(const fs::path& directory) {
  std::set<std::string> near;
  // People stand within a repository, or right above several.
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

std::string Question(const std::set<std::string>& names) {
  return names.empty() ? "" : "; did you mean " + Join(names, " or ") + "?";
}

}  // namespace

std::string DidYouMean(const std::vector<std::string>& words, const std::string& text) {
  StringList list;
  for (const std::string& word : words) list.emplace_back(std::string_view(word));
  std::set<std::string> near;
  for (const StringBase& word : KelLibrary_Utils::ListNear(text.c_str(), list)) {
    near.insert(Text(word));
  }
  return Question(near);
}

std::string NearNames(const Tarvo::KelLibrary& library, const std::string& name) {
  std::vector<std::string> names;
  for (const StringBase& key : library.GetIndex().GetAllVersionKeys()) {
    names.push_back(Text(Kel_Key(key).GetName()));
  }
  return DidYouMean(names, name);
}

void SuggestKeys(const Tarvo::KelLibrary& library, const std::string& key) {
  const Kel_Key asked{StringBase(key.c_str())};
  std::set<std::string> versions;
  for (const StringBase& text : library.GetIndex().GetAllVersionKeys()) {
    const Kel_Key other(text);
    if (other.GetName() != asked.GetName()) continue;
    // The core is there, so what can't be opened has told its own error.
    if (!asked.IsValid() || other == asked) return;
    versions.insert(Text(text));
  }
  const std::string near = NearNames(library, Text(asked.GetName()));
  if (!versions.empty()) {
    Messages::Note("the versions of this core are " + Join(versions));
  } else if (!near.empty()) {
    Messages::Note("no core is named " + Text(asked.GetName()) + near);
  }
}

void SuggestRepositories(const Request& request) {
  for (const std::string& repository : Repositories(request)) {
    std::error_code error;
    if (!fs::is_directory(repository, error) || IsRepository(repository)) continue;
    const auto near = RepositoriesNear(fs::absolute(repository).lexically_normal());
    if (!near.empty()) Messages::Note(repository + " is not a repository" + Question(near));
  }
}
