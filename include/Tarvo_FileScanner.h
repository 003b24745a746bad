#ifndef TARVO_FILESCANNER_H
#define TARVO_FILESCANNER_H

#include <cstddef>
#include <string>
#include <string_view>

#include "Port_File.h"
#include "Port_FileName.h"
#include "Tarvo_Export.h"

namespace Tarvo {

// The cleaned lines of a text file, with their true numbers. What all file formats share is settled
// here: a comment runs from the first "#" of a line to its end, whatever stands before it; tabs
// become blanks; blanks at both ends go. Nothing else happens to a line, none is joined to another,
// and none is left out: an empty line, and one that becomes empty, is handed out as such.
//
// The whole file is read by the constructor, and closed again before it returns; a line is cleaned
// when it is handed out. Memory is that of the file. Threads: for one at a time.
class TARVO_EXPORT FileScanner {
 public:
  // Throws AppException with level Failure, the file's name in its text, if the file can't be read,
  // opened or closed. May throw std::bad_alloc.
  explicit FileScanner(const Port::FileName& file);
  // The same for a file that was looked for already, under that name.
  FileScanner(const Port::FileName& file, Port::FoundFile found);
  ~FileScanner();

  // Gives the next line. False, with an empty line, when none is left. May throw std::bad_alloc,
  // and std::length_error for a line beyond 4 GiB; the line is then still the next one.
  bool GetNextLine(StringBase& line);
  // The same with the line's number, counted from 1. At the end it is the number that a further
  // line would have.
  bool GetNextLine(StringBase& line, unsigned int& lineNumber);
  // The same without a copy. The view is good while the scanner lives and is not moved.
  bool GetNextLine(std::string_view& line, unsigned int& lineNumber);

  // The column at which a part of the last view begins, in its line as it stands in the file:
  // counted from 1, in bytes, tabs as one. An empty part may stand right behind the line.
  unsigned int GetColumn(std::string_view part) const noexcept;

  // The comment that was taken off the last line that was handed out, from its "#" on and without
  // blanks at its end; empty if there was none. GetColumn tells where it stands. The view is good
  // while the scanner lives and is not moved.
  std::string_view GetComment() const noexcept;

  // Makes the first line the next one, without touching the file.
  void GoToStart();

 private:
  TARVO_LOCAL std::string_view FindLine(std::size_t& next);
  TARVO_LOCAL bool StepTo(std::size_t next, unsigned int& lineNumber);

  unsigned int current = 0;  // how many lines were handed out
  StringBase fileName;
  std::string text;  // with a blank for each tab that was handed out
  std::size_t position = 0;
  std::size_t lastPosition = 0;  // of the last line that was handed out
};

}  // namespace Tarvo

#endif
