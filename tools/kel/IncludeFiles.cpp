#include "IncludeFiles.h"

#include <algorithm>
#include <filesystem>
#include <set>
#include <system_error>

#include "Messages.h"

namespace {

namespace fs = std::filesystem;

constexpr unsigned kMostLevels = 16;
constexpr std::size_t kMostFiles = 10'000;

class Listing {
 public:
  std::vector<std::string> files;

  // Lists a directory, whose own name is put before those of its files.
  void Add(const fs::path& directory, const std::string& name, unsigned level) {
    std::error_code error;
    const fs::path real = fs::canonical(directory, error);
    if (!error && !known.insert(real).second) return;
    if (level == kMostLevels) return Stop(directory, "It is nested too deeply");
    fs::directory_iterator entry(directory, error);
    while (!error && !isOver && entry != fs::directory_iterator()) {
      error = Add(*entry, name, level);
      if (!error) entry.increment(error);
    }
    if (error) Stop(directory, error.message());
  }

 private:
  std::error_code Add(const fs::directory_entry& entry, const std::string& name, unsigned level) {
    std::error_code error;
    const fs::file_type type = entry.status(error).type();
    if (type == fs::file_type::none) return error;
    const std::string file = name + entry.path().filename().string();
    if (type == fs::file_type::directory) Add(entry.path(), file + "/", level + 1);
    if (type != fs::file_type::regular) return {};
    files.push_back(file);
    if (files.size() > kMostFiles) Stop(entry.path().parent_path(), "It has too many files");
    return {};
  }

  void Stop(const fs::path& directory, const std::string& reason) {
    if (!isOver) Messages::Error("Unable to list " + directory.string() + "\n" + reason);
    isOver = true;
  }

  std::set<fs::path> known;
  bool isOver = false;
};

}  // namespace

std::vector<std::string> FilesBelow(const std::string& directory) {
  Listing listing;
  listing.Add(directory, "", 0);
  std::sort(listing.files.begin(), listing.files.end());
  return std::move(listing.files);
}
