// The command `kel`: questions to repositories of IP cores, from a shell.

#include <poll.h>
#include <unistd.h>

#include <algorithm>
#include <clocale>
#include <csignal>
#include <exception>
#include <iostream>

#include "Arguments.h"
#include "Suggestions.h"
#include "Tarvo_Kel_Index.h"
#include "Text.h"

namespace {

// Answers from whatever could be read: what could not has its message, and shows in the status.
Status Run(const Request& request) {
  const Messages::Session session(request);
  const Verb& verb = *FindVerb(request.verb);
  Tarvo::KelLibrary library;
  if (verb.reads == Verb::Nothing || verb.reads == Verb::ItsOwn) {
    return verb.answer(library, request);
  }
  if (!library.SetRepositoryPath(Join(Repositories(request), ";").c_str())) {
    SuggestRepositories(request);
    if (library.GetIndex().GetFullIPCount() == 0) return StatusUnreadable;
  }
  const int walkErrors = verb.reads == Verb::All ? 0 : Messages::ErrorCount();
  const Status status = verb.answer(library, request);
  return Messages::ErrorCount() == walkErrors ? status : StatusFindings;
}

// Whoever reads standard output may close it when he has read enough.
bool IsClosedPipe() {
  pollfd output = {STDOUT_FILENO, 0, 0};
  return ::poll(&output, 1, 0) == 1 && (output.revents & POLLERR) != 0;
}

}  // namespace

int main(int argc, char** argv) try {
  // A reader that has enough is no failure; see IsClosedPipe.
  if (std::signal(SIGPIPE, SIG_IGN) == SIG_ERR) return StatusFindings;
  static_cast<void>(std::setlocale(LC_CTYPE, "C.UTF-8"));  // for the width of characters
  const std::vector<std::string> words(argv + std::min(argc, 1), argv + argc);
  if (!words.empty() && words.front() == "__complete") return Complete(words);
  Status status = StatusClean;
  const std::optional<Request> request = ReadRequest(words, status);
  if (request) status = Run(*request);
  if (std::cout.flush() || IsClosedPipe()) return status;
  std::cerr << "kel: error: Unable to write to standard output\n";
  return StatusFindings;
} catch (const std::exception& exception) {
  std::cerr << "kel: error: " << exception.what() << '\n';
  return StatusFindings;
}
