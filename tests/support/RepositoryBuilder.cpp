#include "RepositoryBuilder.h"

#include <cstdlib>
#include <fstream>
#include <stdexcept>

namespace fs = std::filesystem;

namespace {

void Write(const fs::path& file, const std::string& text) {
  fs::create_directories(file.parent_path());
  std::ofstream(file, std::ios::binary) << text;
}

// The base name that the data files of a version bear, for keys in the usual form.
std::string BaseName(const fs::path& directory) {
  const std::string key = directory.filename();
  return key.substr(0, key.find_last_of("vV") - 1);
}

}  // namespace

RepositoryBuilder::RepositoryBuilder() {
  std::string pattern = fs::temp_directory_path() / "kel-test-XXXXXX";
  if (!::mkdtemp(pattern.data())) throw std::runtime_error("no directory for a test");
  root = pattern;
  fs::permissions(root, fs::perms(0755));
}

RepositoryBuilder::~RepositoryBuilder() { fs::remove_all(root); }

RepositoryBuilder::CoreBuilder RepositoryBuilder::Core(const std::string& key) {
  const fs::path location = root / "ipmods" / key;
  fs::create_directories(location);
  return CoreBuilder(location);
}

void RepositoryBuilder::File(const std::string& name, const std::string& text) {
  Write(root / name, text);
}

RepositoryBuilder::CoreBuilder& RepositoryBuilder::CoreBuilder::File(const std::string& name,
                                                                     const std::string& text) {
  Write(directory / name, text);
  return *this;
}

RepositoryBuilder::CoreBuilder& RepositoryBuilder::CoreBuilder::Data(const std::string& extension,
                                                                     const std::string& text) {
  return File("data/" + BaseName(directory) + "_v2_1_0." + extension, text);
}
