#include "Codes.h"

#include <array>
#include <iostream>
#include <sstream>

#include "Tarvo_KelChecker.h"

namespace {

using Tarvo::KelDiagnosticCode;

// Sentences in lines of a terminal's width, indented.
void WriteWrapped(const std::string& text) {
  constexpr std::size_t width = 78;
  std::istringstream words(text);
  std::string line = " ";
  for (std::string word; words >> word;) {
    if (line.size() + 1 + word.size() > width) {
      std::cout << line << '\n';
      line = " ";
    }
    line += " " + word;
  }
  std::cout << line << '\n';
}

void Write(const KelDiagnosticCode& code) {
  std::cout << code.code << " (" << SeverityWord(code.severity) << "): " << code.title << '\n';
  WriteWrapped(code.help);
}

}  // namespace

const std::vector<KelDiagnosticCode>& Codes() {
  static const std::vector<KelDiagnosticCode> codes = Tarvo::KelChecker::ListCodes();
  return codes;
}

const char* SeverityWord(Tarvo::KelDiagnostic::Severity severity) {
  constexpr std::array words = {"note", "warning", "error"};
  return words.at(severity);
}

bool ShowCodes(const std::string& topic) {
  bool isTopic = false;
  for (const KelDiagnosticCode& code : Codes()) {
    if (topic != "diagnostics" && topic != code.code) continue;
    isTopic = true;
    Write(code);
  }
  return isTopic;
}
