#include "MissingFiles.h"

#include <filesystem>
#include <unordered_map>
#include <unordered_set>

namespace {

namespace fs = std::filesystem;

// Tells which files exist. Over a network each look takes long, so a directory is listed when its
// second file is asked for, and that answers for the others.
class Presence {
 public:
  bool Has(const std::string& file) {
    const std::size_t slash = file.rfind('/');
    const auto [found, isFirst] = directories.try_emplace(file.substr(0, slash));
    Directory& directory = found->second;
    if (!isFirst && !directory.isListed) List(found->first, directory);
    if (directory.names.contains(file.substr(slash + 1))) return true;
    std::error_code error;
    return fs::exists(file, error);
  }

 private:
  struct Directory {
    bool isListed = false;
    std::unordered_set<std::string> names;  // of what is there; maybe not all
  };

  // A huge directory may have little of what is asked for. What a link leads to is looked at.
  static void List(const fs::path& path, Directory& directory) {
    constexpr std::size_t kMostNames = 1000;
    directory.isListed = true;
    std::error_code error;
    fs::directory_iterator entry(path, error);
    while (!error && entry != fs::directory_iterator() && directory.names.size() < kMostNames) {
      if (!entry->is_symlink(error) && entry->is_regular_file(error)) {
        directory.names.insert(entry->path().filename());
      }
      if (!error) entry.increment(error);
    }
  }

  std::unordered_map<std::string, Directory> directories;
};

}  // namespace

std::vector<std::string> MissingFiles(const SourceList& list) {
  Presence presence;
  std::vector<std::string> missing;
  for (const Source& source : list.sources) {
    if (!presence.Has(source.location)) missing.push_back(source.path);
  }
  for (const Place& file : list.dataFiles) {
    if (!presence.Has(file.location)) missing.push_back(file.path);
  }
  return missing;
}
