// Views are cut from both ends of a path instead of making its levels one by one: this runs for
// every source.

#include "Tarvo_FileKey.h"

#include <algorithm>
#include <string_view>

#include "Tarvo_Kel_Index.h"

namespace Tarvo::FileKey {

namespace {

const char* const kBetweenLibraryAndFile = " ";

// Takes the last level off a path; empty if there is none.
std::string_view PopLevel(std::string_view& path) {
  while (!path.empty() && path.back() == '/') path.remove_suffix(1);
  const std::size_t slash = path.rfind('/');
  const std::size_t start = slash == std::string_view::npos ? 0 : slash + 1;
  const std::string_view level = path.substr(start);
  path = path.substr(0, start);
  return level;
}

bool IsLanguageDirectory(std::string_view level) {
  return level == Kel_Index::KEL_VHDL_SUBDIRECTORY.View() ||
         level == Kel_Index::KEL_VERILOG_SUBDIRECTORY.View();
}

// Appends the levels of a path, each with one separator behind it.
void AppendLevels(StringBase& text, std::string_view path) {
  while (!path.empty()) {
    const std::size_t end = std::min(path.find('/'), path.size());
    text.Append(path.data(), static_cast<unsigned>(end));
    // A doubled slash is no level, so it doesn't show in a key.
    if (end > 0) text.Append("/");
    path.remove_prefix(std::min(end + 1, path.size()));
  }
}

}  // namespace

// Upwards from the file to the directory of a language. Above that stands `hdl`, whatever it is
// called, and above that the version.
StringBase OfLocation(const Port::FileName& location) {
  const StringBase directory = location.GetPath();
  std::string_view rest = directory.View();
  std::size_t behindLanguage = rest.size();
  std::string_view level = PopLevel(rest);
  for (; !level.empty() && !IsLanguageDirectory(level); level = PopLevel(rest)) {
    behindLanguage = rest.size();
  }
  StringBase fileKey;
  if (!level.empty()) {
    PopLevel(rest);
    fileKey = StringBase(PopLevel(rest));
    fileKey.Append(kBetweenLibraryAndFile);
  }
  AppendLevels(fileKey, directory.View().substr(behindLanguage));
  fileKey.Append(location.GetTail());
  return fileKey;
}

StringBase OfEntry(const Kel_Key& library, const StringBase& file,
                   const StringBase& missingExtension) {
  StringBase fileKey = library.GetKey();
  fileKey.Append(kBetweenLibraryAndFile);
  AppendName(fileKey, file, missingExtension);
  return fileKey;
}

void AppendName(StringBase& fileKey, const StringBase& file, const StringBase& missingExtension) {
  fileKey.Append(file.GetText());
  if (missingExtension.GetLength() == 0) return;
  fileKey.Append(".");
  fileKey.Append(missingExtension);
}

}  // namespace Tarvo::FileKey
