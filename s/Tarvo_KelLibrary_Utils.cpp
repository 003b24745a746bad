#include "Tarvo_KelLibrary_Utils.h"

#include <boost/filesystem.hpp>
#include <boost/tokenizer.hpp>
#include <string>

#include "Tarvo_Report.h"

namespace Tarvo {

namespace {

const char* const kPathDelimiter = ";";
const char* const kInterfaceDelimiter = ":";

StringList Split(const StringBase& list, const char* delimiter) {
  const std::string text(list.View());
  const boost::tokenizer<boost::char_separator<char>> pieces(
      text, boost::char_separator<char>(delimiter));
  StringList result;
  for (const std::string& piece : pieces) result.emplace_back(std::string_view(piece));
  return result;
}

// A path with a NUL byte in it would be tested, and used, without what stands behind.
bool IsDirectory(const StringBase& path) {
  if (path.View().find('\0') != std::string_view::npos) return false;
  boost::system::error_code error;
  return boost::filesystem::is_directory(path.GetText(), error);
}

}  // namespace

StringList KelLibrary_Utils::GetPathVector(const StringBase& path) {
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
