#ifndef TARVO_FILESCANNER_H
#define TARVO_FILESCANNER_H

#include <cstddef>
#include <string>
#include <vector>

#include "Port_FileName.h"
#include "Tarvo_Export.h"

namespace Tarvo {

// The cleaned lines of a text file, with their true numbers. What all file formats share is settled
// here: a comment runs from the first "#" of a line to its end, whatever stands before it; tabs
// become blanks; blanks at both ends go. Nothing else happens to a line, none is joined to another,
// and none is left out: an empty line, and one that becomes empty, is handed out as such.
//
// The whole file is read by the constructor, and closed again before it returns.
//
// Memory is in proportion to the file. Threads: for one at a time.
class TARVO_EXPORT FileScanner {
 public:
  // Throws AppException with level Failure, the file's name in its text, if the file can't be read,
  // opened or closed. May throw std::bad_alloc, and std::length_error for a line beyond 4 GiB.
  explicit FileScanner(const Port::FileName& file);
  ~FileScanner();

  // Gives the next line. False, with an empty line, when none is left. May throw std::bad_alloc;
  // the line is then still the next one.
  bool GetNextLine(StringBase& line);
  // The same with the line's number, counted from 1. At the end it is the number that a further
  // line would have.
  bool GetNextLine(StringBase& line, unsigned int& lineNumber);

  // Makes the first line the next one, without touching the file.
  void GoToStart();

 private:
  // Where a cleaned line stands in the text.
  struct Line {
    std::size_t start;
    std::size_t length;
  };

  TARVO_LOCAL void Add(const StringBase& line);

  unsigned int current = 0;
  StringBase fileName;
  std::string text;
  std::vector<Line> lines;
};

}  // namespace Tarvo

#endif
