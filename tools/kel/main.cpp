// The command `kel`: questions to repositories of IP cores, from a shell.

#include <poll.h>
#include <unistd.h>

#include <clocale>
#include <csignal>
#include <exception>
#include <iostream>
#include <map>
#include <sstream>

#include "Arguments.h"
#include "Messages.h"
#include "Nearby.h"
#include "Tarvo_Kel_Index.h"
#include "Text.h"
#include "Verbs.h"

std::vector<std::string> Repositories(const Call& call) {
  std::vector<std::string> repositories;
  for (const std::string& path : call.libraries) {
    std::istringstream pieces(path);
    for (std::string piece; std::getline(pieces, piece, ';');) {
      if (!piece.empty()) repositories.push_back(piece);
    }
  }
  return repositories;
}

namespace {

using Verb = Status (*)(const Tarvo::KelLibrary&, const Call&);
const std::map<std::string, Verb> kVerbs = {
    {"list", List}, {"which", Which}, {"show", Show}, {"sources", Sources}, {"netlists", Netlists}};

// Answers from whatever could be read: what could not has its message, and shows in the status,
// unless it is another core than those that are asked for.
Status Run(const Call& call) {
  const Messages::Session session(call);
  Tarvo::KelLibrary library;
  if (call.verb == "check") return Check(library, call);
  if (!library.SetRepositoryPath(Join(Repositories(call), ";").c_str())) {
    SuggestRepositories(call);
    if (library.GetIndex().GetFullIPCount() == 0) return StatusUnreadable;
  }
  const int walkErrors = call.verb == "list" ? 0 : Messages::ErrorCount();
  const Status status = kVerbs.at(call.verb)(library, call);
  return Messages::ErrorCount() == walkErrors ? status : StatusFindings;
}

// Whoever reads standard output may close it when he has read enough.
bool IsClosedPipe() {
  pollfd output = {STDOUT_FILENO, 0, 0};
  return ::poll(&output, 1, 0) == 1 && (output.revents & POLLERR) != 0;
}

}  // namespace

int main(int argc, char** argv) try {
  if (std::signal(SIGPIPE, SIG_IGN) == SIG_ERR) return StatusFindings;
  static_cast<void>(std::setlocale(LC_CTYPE, "C.UTF-8"));  // for the width of characters
  Status status = StatusClean;
  const std::optional<Call> call = ReadCall(argc, argv, status);
  if (call) status = Run(*call);
  if (std::cout.flush() || IsClosedPipe()) return status;
  std::cerr << "kel: error: Unable to write to standard output\n";
  return StatusFindings;
} catch (const std::exception& exception) {
  std::cerr << "kel: error: " << exception.what() << '\n';
  return StatusFindings;
}
