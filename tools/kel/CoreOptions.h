#ifndef KEL_COREOPTIONS_H
#define KEL_COREOPTIONS_H

#include <set>
#include <string>
#include <vector>

#include "Tarvo_KelLibrary.h"

// What the descriptions of cores say for the command itself.
class CoreOptions {
 public:
  // The library must outlive it.
  explicit CoreOptions(const Tarvo::KelLibrary& theLibrary);

  // An option of a core, or nothing where its description has none or could not be read. No message
  // is issued: who reads the sources of a core needs no description of it.
  std::string Value(const std::string& key, const char* option) const;
  // The same for a list with commas.
  std::vector<std::string> Values(const std::string& key, const char* option) const;

 private:
  const Tarvo::KelLibrary& library;
  std::set<std::string> keys;
};

#endif
