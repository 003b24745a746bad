#ifndef COMMANDLINE_H
#define COMMANDLINE_H

#include <string>

// What a shell command wrote, and its exit status.
struct CommandResult {
  int status;
  std::string output;
  std::string errors;
};

CommandResult RunCommand(const std::string& command);

#endif
