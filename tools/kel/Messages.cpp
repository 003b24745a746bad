#include "Messages.h"

#include <atomic>
#include <iostream>
#include <sstream>
#include <string>

#include "Port_MsgManData.h"

namespace Messages {

namespace {

std::atomic<int> errorCount = 0;

const char* Lead(Port_Message::Severity severity) {
  return severity == Port_Message::Warning ? "warning: " : "error: ";
}

// Wrapped texts bring line ends of their own, so empty lines are left out.
void Show(const Port_Message& message) {
  if (message.severity != Port_Message::Warning) ++errorCount;
  std::istringstream lines(message.text);
  std::string shown = "kel: ";
  const char* lead = Lead(message.severity);
  for (std::string line; std::getline(lines, line);) {
    if (line.empty()) continue;
    shown += lead + line + '\n';
    lead = "  ";
  }
  std::cerr << shown;
}

}  // namespace

void Install() { Port_MsgManData::setHandler(Show); }

int ErrorCount() { return errorCount; }

}  // namespace Messages
