#include "Tarvo_FileScanner.h"

#include <memory>

#include "Port_File.h"
#include "Tarvo_Report.h"

namespace Tarvo {

namespace {

struct Closer {
  void operator()(Port::Stream* stream) const noexcept { Port::File::close(stream); }
};
using OpenStream = std::unique_ptr<Port::Stream, Closer>;

// The comment goes first, so that a tab in it is not counted. Gives the number of tabs.
unsigned Clean(StringBase& line) {
  const unsigned comment = line.GetIndexOfFirstChar('#');
  if (comment != StringBase::None) line.Assign(line.GetText(), comment);
  const unsigned tabs = line.ReplaceChars('\t', ' ');
  line.Trim(" \t", StringBase::TrimBoth);
  return tabs;
}

OpenStream Open(const StringBase& name) {
  if (!Port::File::canread(name)) {
    throw Report::Exception(AppException::Failure, "Cannot read file %s\n", name);
  }
  OpenStream stream(Port::File::open(name, Port::File::Read));
  if (!stream) throw Report::Exception(AppException::Failure, "Cannot open file %s\n", name);
  return stream;
}

}  // namespace

FileScanner::FileScanner(const Port::FileName& file) : fileName(file.GetName()) {
  TARVO_TRACE("Opening File %s\n", fileName);
  OpenStream stream = Open(fileName);
  StringBase line;
  bool tabs = false;
  while (!stream->geteof()) {
    if (stream->readline(line) > 0 && Clean(line) > 0) tabs = true;
    Add(line);
  }
  if (tabs) TARVO_TRACE("  Tabs found in file %s\n", fileName);
  if (!Port::File::close(stream.release())) {
    throw Report::Exception(AppException::Failure, "Cannot close file %s\n", fileName);
  }
  TARVO_TRACE("Closed File %s\n", fileName);
}

FileScanner::~FileScanner() = default;

void FileScanner::Add(const StringBase& line) {
  lines.push_back({text.size(), line.GetLength()});
  text += line.View();
}

bool FileScanner::GetNextLine(StringBase& line) {
  if (current == lines.size()) {
    line.Empty();
    return false;
  }
  const Line& next = lines[current];
  line.Assign(text.data() + next.start, static_cast<unsigned>(next.length));
  ++current;
  return true;
}

bool FileScanner::GetNextLine(StringBase& line, unsigned int& lineNumber) {
  const bool found = GetNextLine(line);
  lineNumber = found ? current : current + 1;
  return found;
}

void FileScanner::GoToStart() { current = 0; }

}  // namespace Tarvo
