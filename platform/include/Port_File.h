#ifndef PORT_FILE_H
#define PORT_FILE_H

#include <cstddef>
#include <memory>
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
  friend class FoundFile;

  Stream() noexcept = default;

  PORT_LOCAL bool Open(const char* name) noexcept;
  PORT_LOCAL bool OpenPlain(const char* name, bool followsLink) noexcept;
  PORT_LOCAL bool ReadAll();
  PORT_LOCAL bool ReadBytes();
  PORT_LOCAL bool Close() noexcept;

  int descriptor = -1;
  std::size_t length = 0;  // when it was opened
  bool isRead = false;
  std::string content;
  std::size_t position = 0;
};

// What a look at the disk tells of a name. Unknown is what can't be looked at, as behind a
// directory without permission; a name that is too long for a file is known to be missing.
enum class Existence { No, Unknown, Yes };

// What one look at a name found: whether something is there and, if it is a plain file that this
// process may read, that file, opened. So who must know first whether a file exists, and then reads
// it, goes to the disk once.
//
// Threads: for one at a time.
class PORT_EXPORT FoundFile {
 public:
  // Of no name: nothing is there.
  FoundFile() noexcept = default;
  // Throws std::bad_alloc.
  explicit FoundFile(const char* name);
  FoundFile(FoundFile&&) noexcept = default;
  FoundFile& operator=(FoundFile&&) noexcept = default;

  Existence GetExistence() const noexcept { return existence; }

  // The open file, read whole; later nothing is left to take. Null for what is not there, can't be
  // read or is no plain file. Throws std::bad_alloc. File::close ends its life.
  Stream* TakeStream();

  // Reads the content ahead, if it is not longer than that. False where the file must be looked for
  // again to know what is wrong with it. Throws std::bad_alloc.
  bool ReadAhead(std::size_t longest);

 private:
  Existence existence = Existence::No;
  std::unique_ptr<Stream> stream;  // null for what is no readable plain file
};

// Opens and closes text files. All operations are static and may be called from several threads.
class PORT_EXPORT File {
 public:
  enum Access { Read = 1 };

  // True for a regular file that this process may read; false for anything else, so that a pipe or
  // a device never blocks a caller.
  static bool canread(const char* name) noexcept;

  // Looks for a file or directory, links followed.
  static Existence LookFor(const char* name) noexcept;

  // Reads the file whole. Null if it cannot be opened or read, or is not a regular file. Throws
  // std::bad_alloc. The flag has no effect.
  static Stream* open(const char* name, Access access, bool reserved = false);

  // Ends the stream's life, also when the result is false. Null gives false.
  static bool close(Stream* stream) noexcept;

  File() = delete;
};

}  // namespace Port

#endif
