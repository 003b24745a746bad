// The command `kel`: questions to repositories of IP cores, from a shell.

#include <poll.h>
#include <unistd.h>

#include <csignal>
#include <exception>
#include <iostream>
#include <map>
#include <sstream>

#include "Arguments.h"
#include "Messages.h"
#include "Nearby.h"
#include "Tarvo_AppException.h"
#include "Tarvo_KelLibrary_Utils.h"
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

Tarvo::StringBase RepositoryPath(const Call& call) { return Join(Repositories(call), ";").c_str(); }

namespace {

bool IsPath(const Tarvo::StringBase& path) {
  try {
    Tarvo::KelLibrary_Utils::GetPathVector(path);
    return true;
  } catch (const Tarvo::AppException&) {
    return false;
  }
}

bool IsEmpty(const Tarvo::KelLibrary& library) {
  Tarvo::StringList keys;
  library.ListAllIPKeys(keys);
  return keys.empty();
}

using Verb = Status (*)(const Tarvo::KelLibrary&, const Call&);
const std::map<std::string, Verb> kVerbs = {
    {"list", List}, {"which", Which}, {"show", Show}, {"sources", Sources}, {"netlists", Netlists}};

// Answers from whatever could be read: what could not has its message, and shows in the status,
// unless it is another core than those that are asked for.
Status Run(const Call& call) {
  Messages::Install(call);
  Tarvo::KelLibrary library;
  const Tarvo::StringBase path = RepositoryPath(call);
  if (call.verb == "check" && IsPath(path)) return Check(library, call);
  if (!library.SetRepositoryPath(path)) {
    SuggestRepositories(call);
    if (!IsPath(path) || IsEmpty(library)) return StatusUnreadable;
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
