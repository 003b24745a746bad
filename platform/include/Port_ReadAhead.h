#ifndef PORT_READAHEAD_H
#define PORT_READAHEAD_H

#include <cstddef>
#include <memory>
#include <string>

#include "Port_Export.h"
#include "Port_File.h"

namespace Port {

// Reads small files ahead of their turn, for who reads many of them, one after another, from a disk
// where each look takes long.
//
//     ReadAhead files;
//     while (...) {
//       while (files.HasRoom() && ...) files.Expect(name of a file further on);
//       FoundFile file = files.Take();
//     }
//
// The files come in the order in which they were expected, each as FoundFile finds it at that time
// or a little earlier. Only what could be read, and what is known to be missing, comes from a
// helper; all else is looked for again by the caller, so that it gets what it would get alone.
//
// On a fast disk nothing is read ahead, and no thread is made. Once several looks in a row have
// taken longer than 0.2 ms, eight helpers read up to 64 files ahead, of at most 256 KiB each. They
// take no signals, and end before the destructor does. In a process that forks meanwhile, the child
// goes on alone. Where there are no threads or no memory for it, the caller reads itself.
//
// Threads: for one at a time.
class PORT_EXPORT ReadAhead {
 public:
  // Throws std::bad_alloc, as the others do.
  ReadAhead();
  ~ReadAhead();
  ReadAhead(const ReadAhead&) = delete;
  ReadAhead& operator=(const ReadAhead&) = delete;

  // Whether one more file should be expected, as far as there is one. There is always room for one.
  bool HasRoom() const noexcept;
  // If it throws, the file is not expected.
  void Expect(std::string name);
  std::size_t CountExpected() const noexcept;

  // The file that has been expected for longest; there must be one.
  FoundFile Take();

 private:
  class Helpers;

  PORT_LOCAL bool HasHelpers();
  PORT_LOCAL FoundFile Look(const std::string& name);
  PORT_LOCAL void CallForHelp() noexcept;

  struct State;
  std::unique_ptr<State> state;
};

}  // namespace Port

#endif
