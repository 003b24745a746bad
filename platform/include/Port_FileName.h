#ifndef PORT_FILENAME_H
#define PORT_FILENAME_H

#include "Port_Export.h"
#include "Port_StringBase.h"

namespace Port {

// The name of a file or directory, as a value: a directory part (the head) and a last component
// (the tail), which is a base and an optional extension. Levels are separated by "/". A name may
// hold a head alone, as the location of a directory does.
//
// An extension is what stands behind the last dot of a component, and is given and compared without
// that dot. A dot at the start or at the end of a component makes none: `.profile` and `a.` are
// bases. SetBase takes its text as it is, so a base may hold dots.
//
// No operation but GetAbsolutePath looks at the disk, and none changes it. Text that comes in ends
// at its first NUL byte. Operations that build text may throw std::bad_alloc; one that changes the
// name and throws leaves some of it old and some new.
//
// Threads: like an int. Several may read one name; who changes it must be alone.
class PORT_EXPORT FileName {
 public:
  FileName() = default;
  // Splits the text at its last "/". GetName() gives the same text again.
  explicit FileName(const char* name);
  FileName(const FileName&) = default;
  FileName& operator=(const FileName&) = default;
  FileName(FileName&&) noexcept = default;
  FileName& operator=(FileName&&) noexcept = default;
  virtual ~FileName();

  // The whole name as text.
  StringBase<char> GetName() const;

  // The name as an absolute path: an absolute name comes back as it is, neither normalised nor
  // resolved, and a relative one is put behind the current directory. The flag has no effect.
  // Throws std::filesystem::filesystem_error if there is no current directory any more.
  StringBase<char> GetAbsolutePath(bool reserved = false) const;

  // The directory part, without the separator in front of the tail; "/" for the root. The flags
  // have no effect.
  StringBase<char> GetHead(bool reserved1 = false, bool reserved2 = false) const;

  // The levels of the directory part, without a root in front: fit for PushPathEnd.
  StringBase<char> GetPath() const;

  // The last component with its extension, without it, and whether it has one.
  StringBase<char> GetTail() const;
  StringBase<char> GetBase() const { return base; }
  bool HasExtension() const noexcept { return extension.GetLength() > 0; }
  // Exact, letter case included.
  bool HasExtension(const char* other) const noexcept {
    return HasExtension() && extension == other;
  }

  // Makes the directory part this text. The last component stays.
  void SetHead(const char* directory);
  // Replaces the last component. Levels in the text go to the end of the directory part.
  void SetTail(const char* tail);
  // Replaces the last component by a base without an extension.
  void SetBase(const char* name);
  // Replaces the extension; an empty text removes it.
  void SetExtension(const char* text) { extension = text; }

  // Adds one or more levels at the end of the directory part. Separators at either end of the text
  // count for nothing, and the empty text changes nothing.
  void PushPathEnd(const char* levels);
  // Removes the last level of the directory part and gives it. Gives the empty text when only a
  // root or nothing is left.
  StringBase<char> PopPathEnd();

  // The name with "." and ".." steps and repeated separators resolved as text, links not followed.
  // The flag has no effect.
  StringBase<char> Normalize(bool reserved = true) const;

 private:
  PORT_LOCAL void Split(std::string_view tail);

  StringBase<char> head;  // may end in separators: joining adds one only where there is none
  StringBase<char> base;
  StringBase<char> extension;
};

}  // namespace Port

#endif
