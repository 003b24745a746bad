// The command `kel`: questions to repositories of IP cores, from a shell.

#include <CLI/CLI.hpp>
#include <exception>
#include <iostream>
#include <string>
#include <vector>

#include "Messages.h"
#include "Status.h"
#include "Tarvo_KelLibrary.h"
#include "Which.h"

namespace {

// What the words of the call say.
struct Call {
  std::vector<std::string> libraries;
  std::vector<std::string> keys;
};

void DescribeCall(CLI::App& app, Call& call) {
  app.name("kel");
  app.description("Answers questions about repositories of IP cores.");
  app.set_version_flag("--version", "kel " KEL_VERSION_TEXT);
  app.add_option("-L,--library", call.libraries,
                 "A repository, or several with ';' between; may be repeated, the first wins")
      ->type_name("DIR")
      ->allow_extra_args(false)
      ->required();
  app.require_subcommand(1);
  app.fallthrough();

  CLI::App* const which = app.add_subcommand(
      "which", "Writes key, name, version and location of each core, with a tab between");
  which
      ->add_option("KEY", call.keys,
                   "A key such as abc_v1_00_a, or a core's bare name for its newest version")
      ->required();
}

std::string Join(const std::vector<std::string>& pieces, const char* separator) {
  std::string joined;
  for (const std::string& piece : pieces) joined += (joined.empty() ? "" : separator) + piece;
  return joined;
}

// A repository without cores is only a warning: the others still answer.
Status Run(const Call& call) {
  Messages::Install();
  Tarvo::KelLibrary library;
  if (!library.SetRepositoryPath(Join(call.libraries, ";").c_str()) && Messages::ErrorCount() > 0) {
    return StatusUnreadable;
  }
  const Status status = Which(library, call.keys);
  std::cout.flush();
  if (!std::cout) std::cerr << "kel: error: Unable to write to standard output\n";
  return std::cout && Messages::ErrorCount() == 0 ? status : StatusFindings;
}

}  // namespace

int main(int argc, char** argv) try {
  CLI::App app;
  Call call;
  DescribeCall(app, call);
  try {
    app.parse(argc, argv);
  } catch (const CLI::ParseError& error) {
    return app.exit(error) == 0 ? StatusClean : StatusUsage;
  }
  return Run(call);
} catch (const std::exception& exception) {
  std::cerr << "kel: error: " << exception.what() << '\n';
  return StatusFindings;
}
