// A file is read whole, and only if it is a plain one: no pipe or device can hold up a reader, and
// no other program's changes can reach it afterwards.
//
// Where files lie on a network, each look at a name may take as long as reading a hundred files, so
// there is one for a plain file: it is opened, and then asked what it is. A link may lead out of
// the repository, to a device that opening alone sets going, so what is behind one is looked at
// before.

#include "Port_File.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <memory>
#include <stdexcept>
#include <utility>

namespace Port {

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

// How much to ask of a file that does not tell its length.
constexpr std::size_t kFirstBytes = 4096;

bool IsRegular(const char* name) noexcept {
  struct stat status = {};
  return ::stat(name, &status) == 0 && S_ISREG(status.st_mode);
}

}  // namespace

std::string_view TakeLine(std::string_view& text) {
  const std::size_t end = text.find('\n');
  const bool ended = end != std::string_view::npos;
  std::string_view line = text.substr(0, end);
  if (ended && !line.empty() && line.back() == '\r') line.remove_suffix(1);
  if (line.size() >= StringBase<char>::All) throw std::length_error("line of more than 4 GiB");
  text.remove_prefix(ended ? end + 1 : text.size());
  return line;
}

Stream::~Stream() { Close(); }

// Closes once. The descriptor is gone whatever the system answers.
bool Stream::Close() noexcept {
  const int open = descriptor;
  descriptor = -1;
  return open < 0 || ::close(open) == 0;
}

bool Stream::Open(const char* name) noexcept {
  if (OpenPlain(name, false)) return true;
  return errno == ELOOP && IsRegular(name) && OpenPlain(name, true);
}

// Without O_NONBLOCK a pipe would block until somebody writes to it. False, with the reason in
// errno, for what is no plain file.
bool Stream::OpenPlain(const char* name, bool followsLink) noexcept {
  constexpr int how = O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK;
  descriptor = followsLink ? ::open(name, how) : ::open(name, how | O_NOFOLLOW);
  if (descriptor < 0) return false;
  struct stat status = {};
  if (::fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode)) {
    length = static_cast<std::size_t>(status.st_size);
    return true;
  }
  Close();
  errno = EINVAL;
  return false;
}

// Up to the length that the file had when it was opened: what is added meanwhile does not count.
bool Stream::ReadAll() {
  if (isRead) return true;
  content.resize(length);
  if (!ReadBytes()) return false;
  if (std::string_view(content).substr(0, kByteOrderMark.size()) == kByteOrderMark) {
    position = kByteOrderMark.size();
  }
  isRead = true;
  return true;
}

// Fills the content. One of no length grows until the end shows: some file systems give 0 for files
// with content.
bool Stream::ReadBytes() {
  const bool lengthKnown = !content.empty();
  std::size_t size = 0;
  while (!lengthKnown || size < content.size()) {
    if (size == content.size()) content.resize(std::max(2 * size, kFirstBytes));
    const ssize_t count = ::read(descriptor, content.data() + size, content.size() - size);
    if (count == 0) break;
    if (count < 0 && errno != EINTR) return false;
    if (count > 0) size += static_cast<std::size_t>(count);
  }
  content.resize(size);
  return true;
}

int Stream::readline(StringBase<char>& line) {
  line.Empty();
  if (geteof()) return -1;
  std::string_view rest = std::string_view(content).substr(position);
  const std::string_view found = TakeLine(rest);
  line.Assign(found.data(), static_cast<unsigned>(found.size()));
  position = content.size() - rest.size();
  return static_cast<int>(std::min<std::size_t>(found.size(), INT_MAX));
}

std::string Stream::TakeRest() {
  content.erase(0, std::exchange(position, 0));
  return std::exchange(content, {});
}

// What does not open may be there all the same.
FoundFile::FoundFile(const char* name) : stream(new Stream) {
  if (stream->Open(name)) {
    existence = Existence::Yes;
    return;
  }
  existence = errno == ENOENT ? Existence::No : File::LookFor(name);
  stream.reset();
}

Stream* FoundFile::TakeStream() {
  std::unique_ptr<Stream> taken = std::move(stream);
  return taken && taken->ReadAll() ? taken.release() : nullptr;
}

bool FoundFile::ReadAhead(std::size_t longest) {
  if (existence == Existence::No) return true;
  return stream && stream->length <= longest && stream->ReadAll() && stream->Close();
}

Existence File::LookFor(const char* name) noexcept {
  struct stat status = {};
  if (::stat(name, &status) == 0) return Existence::Yes;
  const bool isMissing = errno == ENOENT || errno == ENOTDIR || errno == ENAMETOOLONG;
  return isMissing ? Existence::No : Existence::Unknown;
}

bool File::canread(const char* name) noexcept {
  return IsRegular(name) && ::faccessat(AT_FDCWD, name, R_OK, AT_EACCESS) == 0;
}

Stream* File::open(const char* name, Access /*access*/, bool /*reserved*/) {
  return FoundFile(name).TakeStream();
}

bool File::close(Stream* stream) noexcept {
  const std::unique_ptr<Stream> owner(stream);
  return stream != nullptr && stream->Close();
}

}  // namespace Port
