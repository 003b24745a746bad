#ifndef PORT_REGEXP_H
#define PORT_REGEXP_H

#include <memory>

#include "Port_Export.h"
#include "Port_Range.h"

// A regular expression over bytes, in Perl's syntax. A "$" at its end matches at the very end of
// the text alone, not in front of a final line end.
//
// Making an object for a pattern that was just used is cheap: the last program compiled is kept.
// Matching takes no recursion and a bounded number of steps.
//
// Threads: objects may be made and used from several threads; who assigns to one must be alone.
class PORT_EXPORT Port_Regexp {
 public:
  // Throws std::invalid_argument for a pattern that is none, and std::bad_alloc.
  explicit Port_Regexp(const char* pattern);
  Port_Regexp(const Port_Regexp&);
  Port_Regexp& operator=(const Port_Regexp&);
  ~Port_Regexp();

  // The first match in the NUL-terminated text at or behind index `start`; an empty range if there
  // is none, or if it matches nothing. Throws std::bad_alloc, and std::runtime_error when a match
  // would take more steps than the bound allows.
  Port_Range GetRangeOfMatch(const char* text, unsigned start) const;

 private:
  struct Program;
  PORT_LOCAL static std::shared_ptr<const Program> Compile(const char* pattern);

  std::shared_ptr<const Program> program;
};

#endif
