// What the library reports is shown as diagnostics where there are any, since these have places,
// and as messages where not.

#include "Messages.h"

#include <unistd.h>

#include <iostream>
#include <set>
#include <sstream>

#include "Diagnostics.h"
#include "Port_MsgManData.h"
#include "Tarvo_DebugMessenger.h"
#include "Text.h"

namespace Messages {

namespace {

using Tarvo::KelDiagnostic;

int errorCount = 0;
bool isQuiet = false;
DiagnosticWriter writer;
// An error of a repository would come again with each question to it.
std::set<std::string> shownTexts;

void ShowOnce(const std::string& text) {
  if (!isQuiet && shownTexts.insert(text).second) std::cerr << text;
}

// Wrapped texts bring line ends of their own, so empty lines are left out.
std::string Wrapped(std::string start, const std::string& text) {
  std::istringstream lines(text);
  std::string wrapped = "kel: ";
  for (std::string line; std::getline(lines, line);) {
    if (line.empty()) continue;
    wrapped += start + Printable(line) + '\n';
    start = "  ";
  }
  return wrapped;
}

void Say(KelDiagnostic::Severity severity, const std::string& text) {
  const std::string lead = std::string(SeverityWord(severity)) + ": ";
  ShowOnce(Wrapped(writer.withColour ? Coloured(lead, severity) : lead, text));
}

void TakeMessage(const Port_Message& message, const Tarvo::KelDiagnosticLog& log) {
  // Counted also when nothing is shown: the exit status tells.
  if (message.severity != Port_Message::Warning) ++errorCount;
  for (const KelDiagnostic& diagnostic : log.Take()) Show(diagnostic);
}

}  // namespace

Session::Session(const Request& request) {
  isQuiet = request.Has("--quiet");
  writer.relativeTo = request.Value("--relative-to");
  writer.withColour = WantsColour(request.Value("--color"), STDERR_FILENO);
  // Pipes get the lines that lead to a place too, since messages have no other way to tell them.
  writer.withRelated = true;
  writer.withHelp = ::isatty(STDERR_FILENO) != 0;
  Port_MsgManData::setHandler([this](const Port_Message& message) { TakeMessage(message, log); });
  if (!request.Has("--trace") || isQuiet) return;
  Tarvo::DebugMessengerFactory::GetLogger(Tarvo::kLoggerName)
      ->SetSink([](const Tarvo::StringBase& text) { std::cerr << Wrapped("trace: ", Text(text)); });
}

Session::~Session() {
  Tarvo::DebugMessengerFactory::GetLogger(Tarvo::kLoggerName)->SetSink({});
  Port_MsgManData::setHandler({});
}

void Show(const KelDiagnostic& diagnostic) {
  if (diagnostic.place.file.GetLength() > 0) {
    ShowOnce(writer.Write(diagnostic));
  } else {
    Say(diagnostic.severity, Text(diagnostic.text));
  }
}

void Note(const std::string& text) { Say(KelDiagnostic::Note, text); }

void Warn(const std::string& text) { Say(KelDiagnostic::Warning, text); }

void Error(const std::string& text) {
  ++errorCount;
  Say(KelDiagnostic::Error, text);
}

int ErrorCount() { return errorCount; }

}  // namespace Messages
