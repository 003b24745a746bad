#include "Messages.h"

#include <unistd.h>

#include <cstdlib>
#include <iostream>
#include <set>
#include <sstream>

#include "Port_MsgManData.h"
#include "Table.h"
#include "Tarvo_DebugMessenger.h"
#include "Text.h"

namespace Messages {

namespace {

int errorCount = 0;
bool isQuiet = false;
bool isColoured = false;
bool withTraces = false;
std::set<std::string> shownTexts;

struct Lead {
  const char* word;
  const char* colour;
};
const Lead kError{"error: ", "\x1B[1;31m"};
const Lead kWarning{"warning: ", "\x1B[1;33m"};
const Lead kNote{"note: ", "\x1B[1;36m"};
const Lead kTrace{"trace: ", ""};

bool WantsColour(const std::string& choice) {
  if (choice != "auto") return choice == "always";
  const char* const refused = std::getenv("NO_COLOR");
  const char* const terminal = std::getenv("TERM");
  const bool isRefused = refused != nullptr && *refused != 0;
  const bool isDumb = terminal != nullptr && std::string(terminal) == "dumb";
  return ::isatty(STDERR_FILENO) != 0 && !isRefused && !isDumb;
}

// Wrapped texts bring line ends of their own, so empty lines are left out.
void Show(const Lead& lead, const std::string& text) {
  if (isQuiet) return;
  std::istringstream lines(text);
  std::string shown = "kel: ";
  const bool coloured = isColoured && *lead.colour != 0;
  std::string start = coloured ? std::string(lead.colour) + lead.word + "\x1B[0m" : lead.word;
  for (std::string line; std::getline(lines, line);) {
    if (line.empty()) continue;
    shown += start + Printable(line) + '\n';
    start = "  ";
  }
  std::cerr << shown;
}

void ShowMessage(const Port_Message& message) {
  const bool isWarning = message.severity == Port_Message::Warning;
  if (!isWarning) ++errorCount;
  if (shownTexts.insert(message.text).second) Show(isWarning ? kWarning : kError, message.text);
}

}  // namespace

void Install(const Call& call) {
  isQuiet = call.quiet;
  isColoured = WantsColour(call.color);
  Port_MsgManData::setHandler(ShowMessage);
  withTraces = call.withTraces;
  if (!withTraces) return;
  Tarvo::DebugMessengerFactory::GetLogger("BaseIP")->SetSink(
      [](const Tarvo::StringBase& text) { Trace(Text(text)); });
}

void Trace(const std::string& text) {
  if (withTraces) Show(kTrace, text);
}

void Note(const std::string& text) { Show(kNote, text); }

int ErrorCount() { return errorCount; }

}  // namespace Messages
