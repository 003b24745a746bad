#include "Port_File.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstring>
#include <stdexcept>

namespace Port {

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

}  // namespace

Stream::~Stream() { Close(); }

// Closes once. The descriptor is gone whatever the system answers.
bool Stream::Close() noexcept {
  const int open = descriptor;
  descriptor = -1;
  return open < 0 || ::close(open) == 0;
}

// Without O_NONBLOCK a pipe that took the file's place would block until somebody writes to it.
bool Stream::Open(const char* name) noexcept {
  descriptor = ::open(name, O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK);
  return descriptor >= 0;
}

void Stream::Grow() {
  const std::size_t grown = 2 * capacity;
  std::unique_ptr<char[]> larger(new char[grown]);
  std::memcpy(larger.get(), content.get(), size);
  content = std::move(larger);
  capacity = grown;
}

// One byte more than the file's length lets the end show without growing. The length is only where
// to begin: some file systems give 0 for files with content, and a file may grow meanwhile.
bool Stream::ReadAll() {
  struct stat status = {};
  if (::fstat(descriptor, &status) != 0 || !S_ISREG(status.st_mode)) return false;
  capacity = static_cast<std::size_t>(status.st_size) + 1;
  content.reset(new char[capacity]);
  if (!ReadBytes()) return false;
  if (std::string_view(content.get(), size).substr(0, kByteOrderMark.size()) == kByteOrderMark) {
    position = kByteOrderMark.size();
  }
  return true;
}

bool Stream::ReadBytes() {
  for (;;) {
    if (size == capacity) Grow();
    const ssize_t count = ::read(descriptor, content.get() + size, capacity - size);
    if (count == 0) return true;
    if (count < 0 && errno != EINTR) return false;
    if (count > 0) size += static_cast<std::size_t>(count);
  }
}

int Stream::readline(StringBase<char>& line) {
  line.Empty();
  if (geteof()) return -1;
  const char* const start = content.get() + position;
  const std::size_t left = size - position;
  const auto* const end = static_cast<const char*>(std::memchr(start, '\n', left));
  std::size_t length = end ? static_cast<std::size_t>(end - start) : left;
  const std::size_t next = position + (end ? length + 1 : length);
  if (end && length > 0 && start[length - 1] == '\r') --length;
  if (length >= StringBase<char>::All) throw std::length_error("line of more than 4 GiB");
  line.Assign(start, static_cast<unsigned>(length));
  position = next;
  return static_cast<int>(std::min<std::size_t>(length, INT_MAX));
}

bool File::canread(const char* name) noexcept {
  struct stat status = {};
  return ::stat(name, &status) == 0 && S_ISREG(status.st_mode) &&
         ::faccessat(AT_FDCWD, name, R_OK, AT_EACCESS) == 0;
}

Stream* File::open(const char* name, Access /*access*/, bool /*reserved*/) {
  std::unique_ptr<Stream> stream(new Stream);
  return stream->Open(name) && stream->ReadAll() ? stream.release() : nullptr;
}

bool File::close(Stream* stream) noexcept {
  const std::unique_ptr<Stream> owner(stream);
  return stream != nullptr && stream->Close();
}

}  // namespace Port
