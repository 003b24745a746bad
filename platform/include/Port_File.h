#ifndef PORT_FILE_H
#define PORT_FILE_H

#include <cstddef>
#include <string>
#include <string_view>

#include "Port_Export.h"
#include "Port_StringBase.h"

namespace Port {

// Takes the first line off a text, and gives it without its line end. A line ends at "\n" or
// "\r\n", or at the end of the text; a line end at the very end begins no further line. The text
// must not be empty. Throws std::length_error, with nothing taken, for a line that does not fit
// into a string.
PORT_EXPORT std::string_view TakeLine(std::string_view& text);

// An open text file. File::open makes it and File::close ends its life. The whole content is read
// at opening, as long as it then is, so later changes on disk do not show.
//
// Lines are those of TakeLine. A UTF-8 byte order mark at the start is skipped. All other bytes,
// NULs included, come as they are.
//
// Threads: for one at a time.
class PORT_EXPORT Stream {
 public:
  Stream(const Stream&) = delete;
  Stream& operator=(const Stream&) = delete;
  ~Stream();

  // True when no line is left.
  bool geteof() const noexcept { return position == content.size(); }

  // Replaces the buffer by the next line, without its line end, and gives the line's length (the
  // largest int for a longer one). Gives 0 and an empty buffer for an empty line, -1 and an empty
  // buffer when no line is left. Throws std::bad_alloc, and std::length_error for a line that does
  // not fit into a string; the line is then still the next one.
  int readline(StringBase<char>& line);

  // All that is left, line ends included; then no line is.
  std::string TakeRest();

 private:
  friend class File;

  Stream() noexcept = default;

  PORT_LOCAL bool Open(const char* name) noexcept;
  PORT_LOCAL bool ReadAll();
  PORT_LOCAL bool ReadBytes();
  PORT_LOCAL bool Close() noexcept;

  int descriptor = -1;
  std::string content;
  std::size_t position = 0;
};

// Opens and closes text files. All operations are static and may be called from several threads.
class PORT_EXPORT File {
 public:
  enum Access { Read = 1 };

  // True for a regular file that this process may read; false for anything else, so that a pipe or
  // a device never blocks a caller.
  static bool canread(const char* name) noexcept;

  // Reads the file whole. Null if it cannot be opened or read, or is not a regular file. Throws
  // std::bad_alloc. The flag has no effect.
  static Stream* open(const char* name, Access access, bool reserved = false);

  // Ends the stream's life, also when the result is false. Null gives false.
  static bool close(Stream* stream) noexcept;

  File() = delete;
};

}  // namespace Port

#endif
