#ifndef KEL_REQUEST_H
#define KEL_REQUEST_H

#include <map>
#include <string>
#include <vector>

// What a command line asks for: a verb, and what was given for each word that the rows of the verbs
// describe, by its last name, as "KEY", "--all" or "--library". To ask for any other word throws.
struct Request {
  std::string verb;
  std::map<std::string, std::vector<std::string>> given;

  const std::vector<std::string>& Values(const std::string& word) const { return given.at(word); }
  bool Has(const std::string& word) const { return !Values(word).empty(); }
  std::string Value(const std::string& word) const {
    return Has(word) ? Values(word).back() : std::string();
  }
};

#endif
