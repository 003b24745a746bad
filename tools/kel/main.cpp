// The command `kel`: questions to repositories of IP cores, from a shell.

#include <CLI/CLI.hpp>
#include <exception>
#include <functional>
#include <iostream>
#include <string>
#include <vector>

#include "Messages.h"
#include "Status.h"
#include "Tarvo_KelLibrary.h"
#include "Verbs.h"

namespace {

// What the words of the call say.
struct Call {
  std::vector<std::string> libraries;
  std::vector<std::string> keys;
  bool allVersions = false;
  std::function<Status(const Tarvo::KelLibrary&)> verb;
};

const char* const kKeyHelp =
    "A key such as abc_v1_00_a, or a core's bare name for its newest version";

void DescribeVerbs(CLI::App& app, Call& call) {
  CLI::App* const list = app.add_subcommand(
      "list", "Lists the newest version of each core: key, style, language, location, description");
  list->add_flag("--all", call.allVersions, "List every version");
  list->callback([&call] {
    call.verb = [&call](const auto& library) { return List(library, call.allVersions); };
  });

  CLI::App* const show = app.add_subcommand("show", "Shows the options of a core");
  show->add_option("KEY", call.keys, kKeyHelp)->required()->expected(1);
  show->callback([&call] {
    call.verb = [&call](const auto& library) { return Show(library, call.keys.front()); };
  });

  CLI::App* const which =
      app.add_subcommand("which", "Tells key, name, version and location of each core");
  which->add_option("KEY", call.keys, kKeyHelp)->required();
  which->callback(
      [&call] { call.verb = [&call](const auto& library) { return Which(library, call.keys); }; });
}

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
  DescribeVerbs(app, call);
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
  const Status status = call.verb(library);
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
