#include "Findings.h"

#include <algorithm>
#include <filesystem>
#include <optional>
#include <sstream>
#include <tuple>

#include "Messages.h"
#include "Tarvo_DebugMessenger.h"
#include "Text.h"

namespace {

const char* const kError = "error";
const char* const kWarning = "warning";

bool BeginsWith(const std::string& text, const std::string& start) {
  return text.rfind(start, 0) == 0;
}

std::vector<std::string> Lines(const std::string& text) {
  std::vector<std::string> lines;
  std::istringstream stream(text);
  for (std::string line; std::getline(stream, line);) {
    if (!line.empty()) lines.push_back(line);
  }
  return lines;
}

// A message of the form "... unparsable WHAT: FILE line NUMBER, LINE".
struct BadLine {
  std::string file;
  unsigned line;
  std::string text;
};

std::optional<BadLine> ReadBadLine(const std::string& message) {
  const std::size_t start = message.find(" unparsable ");
  const std::size_t file = message.find(": ", start == std::string::npos ? 0 : start);
  const std::size_t number = message.find(" line ", file == std::string::npos ? 0 : file);
  const std::size_t comma = message.find(", ", number == std::string::npos ? 0 : number);
  if (start != 3 || number == std::string::npos || comma == std::string::npos) return std::nullopt;
  const std::string digits = message.substr(number + 6, comma - number - 6);
  constexpr std::size_t longest = 9;
  if (digits.empty() || digits.size() > longest) return std::nullopt;
  if (digits.find_first_not_of("0123456789") != std::string::npos) return std::nullopt;
  const std::string what = message.substr(start + 1, file - start - 1);
  return BadLine{message.substr(file + 2, number - file - 2),
                 static_cast<unsigned>(std::stoul(digits)),
                 what + ": " + message.substr(comma + 2)};
}

// The file that a reason names behind one of these words, which are left as the reason.
const char* const kFileReasons[] = {"Invalid QVR", "Invalid LDX", "Invalid TEW",
                                    "Unable to parse QVR", "Cannot read file"};

std::string FileOf(const std::string& reason) {
  for (const std::string start : kFileReasons) {
    if (BeginsWith(reason, start + " ")) return reason.substr(start.size() + 1);
  }
  return "";
}

// Those of one line, which the message that names the line comes behind.
bool AnnouncesBadLine(const std::string& text) {
  const char* const starts[] = {"Unable to add file extension to ", "The include directory ",
                                "Unable to analyse library "};
  const auto fits = [&](const char* start) { return BeginsWith(text, start); };
  return std::any_of(std::begin(starts), std::end(starts), fits) ||
         (BeginsWith(text, "File ") && text.find(" declared to be ") != std::string::npos) ||
         (BeginsWith(text, "Library ") && text.find(" already has path ") != std::string::npos);
}

// A duplicate is told for synthesis and for simulation, and by each name that its core was called
// by. It is one finding all the same.
std::string WithoutSide(const std::string& text) {
  const std::size_t file = text.find(" - File ");
  const std::size_t end = text.find(" already exists in ");
  if (file == std::string::npos || end == std::string::npos) return text;
  return text.substr(file + 3, end - file - 3) + " is listed already";
}

}  // namespace

bool Finding::operator<(const Finding& other) const {
  return std::tie(file, line, severity, text, cause) <
         std::tie(other.file, other.line, other.severity, other.text, other.cause);
}

FindingCollector::FindingCollector() {
  previous =
      Port_MsgManData::setHandler([this](const Port_Message& message) { TakeMessage(message); });
  Tarvo::DebugMessengerFactory::GetLogger("BaseIP")->SetSink(
      [this](const Tarvo::StringBase& text) { TakeTrace(Text(text)); });
}

FindingCollector::~FindingCollector() {
  Tarvo::DebugMessengerFactory::GetLogger("BaseIP")->SetSink({});
  Port_MsgManData::setHandler(previous);
}

void FindingCollector::Begin(const std::string& file) {
  subject = file;
  reading.clear();
  pending.clear();
}

void FindingCollector::TakeTrace(const std::string& text) {
  Messages::Trace(text);
  const std::string start = "  Parsing LDX File ";
  if (BeginsWith(text, start)) {
    reading.push_back(text.substr(start.size(), text.size() - start.size() - 1));
  } else if (text == "  Parse successful\n" && !reading.empty()) {
    reading.pop_back();
  }
}

void FindingCollector::TakeMessage(const Port_Message& message) {
  const std::vector<std::string> lines = Lines(message.text);
  if (lines.empty()) return;
  if (const auto bad = ReadBadLine(lines[0])) {
    TakeBadLine(bad->file, bad->line, bad->text);
  } else if (lines.size() > 1) {
    TakeWrapped(lines[0], lines.back());
  } else if (AnnouncesBadLine(lines[0])) {
    pending.push_back({"", 0, kError, lines[0], ""});
  } else {
    const bool isWarning = message.severity == Port_Message::Warning;
    const std::string start = "Unable to add directory ";
    const std::string end = " to library";
    if (BeginsWith(lines[0], start) && lines[0].size() > start.size() + end.size()) {
      subject = lines[0].substr(start.size(), lines[0].size() - start.size() - end.size());
    }
    Add({reading.empty() ? subject : reading.back(), 0, isWarning ? kWarning : kError,
         WithoutSide(lines[0]), ""});
  }
}

// The innermost file that is read ends at its bad line. Where a header is bad, each line behind it
// is tried as one.
void FindingCollector::TakeBadLine(const std::string& file, unsigned line,
                                   const std::string& text) {
  while (!reading.empty()) {
    const bool found = reading.back() == file;
    reading.pop_back();
    if (found) break;
  }
  const bool isHeader = BeginsWith(text, "unparsable header: ");
  if (isHeader && !filesWithoutHeader.insert(file).second) return;
  if (pending.empty()) Add({file, line, kError, text, ""});
  for (Finding& reason : pending) Add({file, line, kError, reason.text, reason.cause});
  pending.clear();
}

// What an operation says in the end follows from its reason, and the reason stands for both.
void FindingCollector::TakeWrapped(const std::string& text, const std::string& reason) {
  const std::string file = FileOf(reason);
  if (AnnouncesBadLine(text) || BeginsWith(text, "Unable to determine location for library ")) {
    pending.push_back({"", 0, kError, text + ": " + reason, file});
  } else if (const auto bad = ReadBadLine(reason)) {
    Add({bad->file, bad->line, kError, bad->text, ""});
  } else if (file.empty()) {
    Add({subject, 0, kError, text + ": " + reason, ""});
  } else {
    std::error_code error;
    const bool exists = std::filesystem::exists(file, error);
    const std::string start = reason.substr(0, reason.size() - file.size() - 1);
    Add({file, 0, kError, exists ? start : "does not exist", exists ? file : ""});
  }
}

bool FindingCollector::IsToldBetter(const Finding& finding) const {
  if (finding.line > 0) return false;
  auto other = findings.upper_bound(finding);
  for (; other != findings.end() && other->file == finding.file; ++other) {
    if (other->line > 0 && BeginsWith(other->text, finding.text)) return true;
  }
  return false;
}

std::vector<Finding> FindingCollector::Take() const {
  std::set<std::string> filesWithFaults;
  for (const Finding& finding : findings) {
    if (finding.cause != finding.file) filesWithFaults.insert(finding.file);
  }
  std::vector<Finding> taken;
  for (const Finding& finding : findings) {
    const bool follows = !finding.cause.empty() && filesWithFaults.contains(finding.cause);
    if (!follows && !IsToldBetter(finding)) taken.push_back(finding);
  }
  return taken;
}
