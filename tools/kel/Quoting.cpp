#include "Quoting.h"

#include <algorithm>

#include "Answer.h"
#include "Text.h"

namespace Quoting {

namespace {

// The text with another in place of each of these.
std::string Replaced(std::string text, std::string_view what, std::string_view by) {
  for (std::size_t at = 0; (at = text.find(what, at)) != std::string::npos; at += by.size()) {
    text.replace(at, what.size(), by);
  }
  return text;
}

}  // namespace

std::string Backslashed(const std::string& text, std::string_view special) {
  std::string escaped;
  for (const char c : text) {
    if (special.find(c) != std::string_view::npos) escaped += '\\';
    escaped += c;
  }
  return escaped;
}

std::string FileListWord(const std::string& text) { return Backslashed(text, " \t\\\"$"); }

std::string ShellWord(const std::string& text) {
  const auto isPlain = [](char c) { return IsPlain(c, "_-./,:+@%="); };
  if (!text.empty() && std::all_of(text.begin(), text.end(), isPlain)) return text;
  return "'" + Replaced(text, "'", "'\\''") + "'";
}

// TOML takes what JSON does, but for one control character.
std::string TomlString(const std::string& text) {
  return Replaced(Json(text).dump(-1, ' ', false, Json::error_handler_t::replace), "\x7F",
                  "\\u007F");
}

// Braces would need no escapes, but can't hold a path with a brace that nothing closes.
std::string TclWord(const std::string& text) {
  return "\"" + Replaced(Backslashed(text, "\\\"$[]{}"), "\n", "\\n") + "\"";
}

std::string MakeWord(const std::string& text) {
  return Replaced(Backslashed(text, "#"), "$", "$$");
}

std::string CMakeWord(const std::string& text) {
  return "\"" + Replaced(Backslashed(text, "\\\"$"), ";", "\\;") + "\"";
}

// A pattern has no other way to take its own characters as they are.
std::string GlobLiteral(const std::string& path) {
  std::string pattern;
  for (const char c : path) {
    const bool special = std::string_view("*?[]").find(c) != std::string_view::npos;
    pattern += special ? std::string("[") + c + "]" : std::string(1, c);
  }
  return pattern;
}

bool IsUtf8(const std::string& text) {
  try {
    static_cast<void>(Json(text).dump());
    return true;
  } catch (const Json::type_error&) {
    return false;
  }
}

}  // namespace Quoting
