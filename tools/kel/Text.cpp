#include "Text.h"

#include <filesystem>

std::string Printable(std::string_view text, bool isControl) {
  std::string printable;
  for (const char c : text) {
    const bool isShown = !isControl && static_cast<unsigned char>(c) >= ' ' && c != '\x7F';
    printable += isShown ? std::string(1, c) : "\\x" + Hex(c);
  }
  return printable;
}

bool IsPlain(char character, std::string_view others) {
  const auto isIn = [&](char first, char last) { return character >= first && character <= last; };
  return isIn('a', 'z') || isIn('A', 'Z') || isIn('0', '9') ||
         others.find(character) != std::string_view::npos;
}

std::string Hex(char byte) {
  constexpr std::string_view digits = "0123456789abcdef";
  const auto number = static_cast<unsigned char>(byte);
  return {digits[number / 16], digits[number % 16]};
}

std::string RelativeTo(const std::string& directory, const Tarvo::StringBase& path) {
  namespace fs = std::filesystem;
  std::string text = Text(path);
  if (directory.empty() || text.empty()) return text;
  const fs::path base = fs::absolute(directory).lexically_normal();
  const std::string relative =
      fs::absolute(text).lexically_normal().lexically_relative(base).string();
  const bool isPlain = relative.find_first_of("-+#/") != 0;
  return isPlain ? relative : "./" + relative;
}
