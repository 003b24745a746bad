#ifndef KEL_CALL_H
#define KEL_CALL_H

#include <string>
#include <vector>

// What the words of a call say.
struct Call {
  std::string verb;
  std::vector<std::string> libraries;

  std::string key;                // of the core that a verb asks, or one pattern
  std::vector<std::string> keys;  // or keys, or patterns, of several
  std::vector<std::string> sections;
  std::vector<std::string> settings;  // each NAME=VALUE
  std::vector<std::string> warnings;  // each "error" or "no-CODE"
  std::string purpose;                // synthesis or simulation
  std::string format;
  std::string relativeTo;  // a directory; empty for absolute paths
  std::string color = "auto";
  bool allVersions = false;
  bool wholeTable = false;
  bool withExcerpts = false;
  bool asJson = false;
  bool withTraces = false;
  bool quiet = false;
};

#endif
