#include "CommandLine.h"

#include <sys/wait.h>

#include <cstdlib>
#include <fstream>
#include <iterator>

#include "RepositoryBuilder.h"

namespace {

std::string Read(const std::string& file) {
  std::ifstream stream(file, std::ios::binary);
  return {std::istreambuf_iterator<char>(stream), {}};
}

}  // namespace

CommandResult RunCommand(const std::string& command) {
  const RepositoryBuilder directory;
  const int status = std::system(
      ("( " + command + " ) >'" + directory / "out" + "' 2>'" + directory / "err" + "'").c_str());
  return {WEXITSTATUS(status), Read(directory / "out"), Read(directory / "err")};
}
