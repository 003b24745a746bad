#ifndef PORT_INPUT_H
#define PORT_INPUT_H

#include "Port_Export.h"

// The file that is being read, and the line of it. While one of these lives, the messages of its
// thread say that they came up there. They nest: a file that is read in the middle of another one
// has its own, and the one outside tells from which line it was asked for.
//
//     const StringBase name = file.GetName();
//     Port_Input input(name);
//     while (lines.GetNextLine(line, number)) {
//       input.AtLine(number);
//       ...
//     }
//
// Threads: an input belongs to the thread that made it, and ends before those outside of it do.
class PORT_EXPORT Port_Input {
 public:
  // Begins a file, at no line. The name is not copied and must stay.
  explicit Port_Input(const char* fileName) noexcept;
  ~Port_Input();
  Port_Input(const Port_Input&) = delete;
  Port_Input& operator=(const Port_Input&) = delete;

  // Sets the line, counted from 1; 0 stands for the file as a whole.
  void AtLine(unsigned number) noexcept { line = number; }

  const char* GetFile() const noexcept { return file; }
  unsigned GetLine() const noexcept { return line; }
  // The input in the middle of which this one is read, or null.
  const Port_Input* GetOuter() const noexcept { return outer; }

  // The innermost input of this thread, or null if nothing is being read.
  static const Port_Input* GetCurrent() noexcept;

 private:
  const char* file;
  unsigned line = 0;
  const Port_Input* outer;
};

#endif
