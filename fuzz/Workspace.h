#ifndef KEL_FUZZ_WORKSPACE_H
#define KEL_FUZZ_WORKSPACE_H

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>

// A directory for the files of one fuzzer, gone when it ends.
class Workspace {
 public:
  Workspace() {
    std::string pattern = std::filesystem::temp_directory_path() / "kel-fuzz-XXXXXX";
    if (!::mkdtemp(pattern.data())) std::abort();
    directory = pattern;
  }
  ~Workspace() { std::filesystem::remove_all(directory); }
  Workspace(const Workspace&) = delete;
  Workspace& operator=(const Workspace&) = delete;

  // The path of a file below it, whose directory is made.
  std::string Path(const std::string& name) const {
    std::filesystem::create_directories((directory / name).parent_path());
    return directory / name;
  }

  std::string Write(const std::string& name, std::string_view content) const {
    const std::string path = Path(name);
    std::ofstream(path, std::ios::binary) << content;
    return path;
  }

 private:
  std::filesystem::path directory;
};

#endif
