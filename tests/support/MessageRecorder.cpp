#include "MessageRecorder.h"

#include <utility>

#include "Tarvo_DebugMessenger.h"

namespace {

// All of the library's messages have one domain and revision, so only others show.
std::string Dump(const Port_Message& message) {
  const char* const severities[] = {"warning ", "error ", "fatal "};
  const std::string domain = message.domain;
  const std::string revision = message.revision;
  return severities[message.severity] + (domain == "tarvomsg" ? "" : domain + " ") + message.file +
         (revision == "1.0" ? "" : " " + revision) + ": " + message.text;
}

std::string DumpInput(const Port_Message& message) {
  const std::string file = message.inputFile;
  if (file.empty()) return message.inputLine == 0 ? "" : "a line of nothing";
  return file.substr(file.rfind('/') + 1) + ":" + std::to_string(message.inputLine);
}

Tarvo::DebugMessenger& Logger() {
  return *Tarvo::DebugMessengerFactory::GetLogger(Port::StringBase<char>("BaseIP"));
}

}  // namespace

MessageRecorder::MessageRecorder(What what) {
  previous = Port_MsgManData::setHandler([this](const Port_Message& message) {
    entries.push_back(Dump(message));
    lines.push_back(message.line);
    inputs.push_back(DumpInput(message));
  });
  if (what == MessagesAndTraces) {
    Logger().SetSink([this](const Port::StringBase<char>& text) {
      entries.push_back(std::string("trace: ") + text.GetText());
    });
  }
}

MessageRecorder::~MessageRecorder() {
  Port_MsgManData::setHandler(previous);
  Logger().SetSink({});
}

std::vector<std::string> MessageRecorder::Take() { return std::exchange(entries, {}); }
