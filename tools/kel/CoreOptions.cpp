#include "CoreOptions.h"

#include <sstream>

#include "Text.h"

namespace {

std::string Trimmed(const std::string& text) {
  const std::size_t first = text.find_first_not_of(" \t");
  if (first == std::string::npos) return "";
  return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

}  // namespace

CoreOptions::CoreOptions(const Tarvo::KelLibrary& theLibrary) : library(theLibrary) {
  Tarvo::StringList list;
  library.ListAllIPKeys(list);
  for (const Tarvo::StringBase& key : list) keys.insert(Text(key));
}

std::string CoreOptions::Value(const std::string& key, const char* option) const {
  Tarvo::StringBase value;
  if (keys.contains(key)) library.GetIPProperty(key.c_str(), option, value);
  return Trimmed(Text(value));
}

std::vector<std::string> CoreOptions::Values(const std::string& key, const char* option) const {
  std::istringstream pieces(Value(key, option));
  std::vector<std::string> values;
  for (std::string piece; std::getline(pieces, piece, ',');) {
    if (!Trimmed(piece).empty()) values.push_back(Trimmed(piece));
  }
  return values;
}
