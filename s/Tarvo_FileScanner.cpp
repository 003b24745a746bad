// A file is read in one piece and cleaned line by line within it. Readers get views of that piece,
// so a line that states nothing costs no memory at all.

#include "Tarvo_FileScanner.h"

#include <algorithm>
#include <memory>
#include <string_view>
#include <utility>

#include "Tarvo_Report.h"

namespace Tarvo {

namespace {

struct Closer {
  void operator()(Port::Stream* stream) const noexcept { Port::File::close(stream); }
};
using OpenStream = std::unique_ptr<Port::Stream, Closer>;

constexpr char kComment = '#';
constexpr char kTab = '\t';

constexpr bool IsBlank(char c) { return c == ' ' || c == kTab; }

std::string_view WithoutBlanks(std::string_view line) {
  while (!line.empty() && IsBlank(line.back())) line.remove_suffix(1);
  while (!line.empty() && IsBlank(line.front())) line.remove_prefix(1);
  return line;
}

// Whether a tab stands in front of a line's comment. From a tab in a comment, the search goes on at
// the next line.
bool HasTabs(std::string_view text) noexcept {
  std::size_t tab = text.find(kTab);
  while (tab != std::string_view::npos) {
    const std::size_t start = text.rfind('\n', tab) + 1;
    if (text.find(kComment, start) > tab) return true;
    tab = text.find(kTab, text.find('\n', tab));
  }
  return false;
}

// Whether it can be read is asked only where it could not be opened.
OpenStream Open(const StringBase& name, Port::FoundFile& found) {
  OpenStream stream(found.TakeStream());
  if (stream) return stream;
  if (!Port::File::canread(name)) {
    throw Report::Exception(AppException::Failure, "Cannot read file %s\n", name);
  }
  throw Report::Exception(AppException::Failure, "Cannot open file %s\n", name);
}

}  // namespace

FileScanner::FileScanner(const Port::FileName& file)
    : FileScanner(file, Port::FoundFile(file.GetName())) {}

FileScanner::FileScanner(const Port::FileName& file, Port::FoundFile found)
    : fileName(file.GetName()) {
  TARVO_TRACE("Opening File %s\n", fileName);
  OpenStream stream = Open(fileName, found);
  text = stream->TakeRest();
  // A search through the whole text, for a trace alone.
  if (Report::IsTracing() && HasTabs(text)) TARVO_TRACE("  Tabs found in file %s\n", fileName);
  if (!Port::File::close(stream.release())) {
    throw Report::Exception(AppException::Failure, "Cannot close file %s\n", fileName);
  }
  TARVO_TRACE("Closed File %s\n", fileName);
}

FileScanner::~FileScanner() = default;

// The next line, and where the one behind it begins. At the end it is empty, and `next` stays.
std::string_view FileScanner::FindLine(std::size_t& next) {
  std::string_view rest = std::string_view(text).substr(position);
  if (rest.empty()) return rest;
  const std::string_view line = Port::TakeLine(rest);
  next = text.size() - rest.size();
  const std::string_view cleaned = WithoutBlanks(line.substr(0, line.find(kComment)));
  const auto start = static_cast<std::size_t>(cleaned.data() - text.data());
  // In the text itself, so that no line is copied. A line that is handed out a second time is clean
  // already, and views of it stay what they were.
  for (std::size_t tab = 0; (tab = cleaned.find(kTab, tab)) != std::string_view::npos;) {
    text[start + tab] = ' ';
  }
  return cleaned;
}

// Goes behind the line that was found there, and gives its number. False at the end.
bool FileScanner::StepTo(std::size_t next, unsigned int& lineNumber) {
  lineNumber = current + 1;
  if (next == position) return false;
  lastPosition = std::exchange(position, next);
  ++current;
  return true;
}

bool FileScanner::GetNextLine(StringBase& line) {
  unsigned lineNumber = 0;
  return GetNextLine(line, lineNumber);
}

bool FileScanner::GetNextLine(StringBase& line, unsigned int& lineNumber) {
  std::size_t next = position;
  const std::string_view found = FindLine(next);
  // The step comes last: if memory runs out for the copy, the line is still the next one.
  line.Assign(found.data(), static_cast<unsigned>(found.size()));
  return StepTo(next, lineNumber);
}

bool FileScanner::GetNextLine(std::string_view& line, unsigned int& lineNumber) {
  std::size_t next = position;
  line = FindLine(next);
  return StepTo(next, lineNumber);
}

unsigned int FileScanner::GetColumn(std::string_view part) const noexcept {
  const auto offset = static_cast<std::size_t>(part.data() - text.data());
  return static_cast<unsigned>(offset - lastPosition + 1);
}

// Cleaning leaves the comment in the text.
std::string_view FileScanner::GetComment() const noexcept {
  std::string_view line = std::string_view(text).substr(lastPosition);
  line = line.substr(0, line.find('\n'));
  const std::string_view comment = line.substr(std::min(line.find(kComment), line.size()));
  return comment.substr(0, comment.find_last_not_of(" \t\r") + 1);
}

void FileScanner::GoToStart() {
  current = 0;
  position = 0;
}

}  // namespace Tarvo
