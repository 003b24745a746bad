// The verb `help`: texts that the parser makes of the rows, and the codes that the library
// explains.

#include <iostream>
#include <sstream>

#include "Arguments.h"
#include "Diagnostics.h"
#include "Suggestions.h"

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

// For one code, or for all of them.
bool ShowCodes(const std::string& topic) {
  bool isTopic = false;
  for (const KelDiagnosticCode& code : Codes()) {
    if (topic != "diagnostics" && topic != code.code) continue;
    isTopic = true;
    std::cout << code.code << " (" << SeverityWord(code.severity) << "): " << code.title << '\n';
    WriteWrapped(code.help);
  }
  return isTopic;
}

Choices Topics() {
  Choices topics = ChoicesOf(Verbs());
  topics.push_back({"diagnostics", "What check may report"});
  for (const KelDiagnosticCode& code : Codes()) topics.push_back({code.code, code.title});
  return topics;
}

Status Help(const Tarvo::KelLibrary& /*unread*/, const Request& request) {
  const std::string topic = request.Value("TOPIC");
  if (ShowCodes(topic)) return StatusClean;
  if (topic.empty() || FindVerb(topic) != nullptr) {
    std::cout << HelpText(topic);
    return StatusClean;
  }
  return Refuse("no help for '" + topic + "'" + DidYouMean(NamesOf(Topics()), topic), "");
}

}  // namespace

Verb DescribeHelp() {
  return {.name = "help",
          .help = "Shows this help, that of a verb, or what a diagnostic means",
          .words = {{.name = "TOPIC",
                     .help = "A verb, a code of a diagnostic, or diagnostics for all codes",
                     .choices = Topics}},
          .example = "help list-ends",
          .reads = Verb::Nothing,
          .answer = Help};
}
