// The command `kel`: questions to repositories of IP cores, from a shell.

#include <CLI/CLI.hpp>
#include <algorithm>
#include <exception>
#include <functional>
#include <iostream>
#include <string>
#include <vector>

#include "Describe.h"
#include "Messages.h"
#include "Status.h"
#include "Tarvo_AppException.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_KelLibrary_Utils.h"
#include "Verbs.h"

namespace {

// What the words of the call say.
struct Call {
  std::vector<std::string> libraries;
  std::vector<std::string> keys;
  std::vector<std::string> sections;
  std::string purpose;
  std::vector<std::string> settings;
  bool allVersions = false;
  bool asJson = false;
  std::function<Status(const Tarvo::KelLibrary&)> verb;
};

const char* const kKeyHelp =
    "A key such as abc_v1_00_a, or a core's bare name for its newest version";

void DescribeList(CLI::App& app, Call& call) {
  CLI::App* const list = app.add_subcommand(
      "list", "Lists the newest version of each core: key, style, language, location, description");
  list->add_flag("--all", call.allVersions, "List every version");
  list->callback([&call] {
    call.verb = [&call](const auto& library) { return List(library, call.allVersions); };
  });
}

void DescribeWhich(CLI::App& app, Call& call) {
  CLI::App* const which =
      app.add_subcommand("which", "Tells key, name, version and location of each core");
  which->add_option("KEY", call.keys, kKeyHelp)->required();
  which->callback(
      [&call] { call.verb = [&call](const auto& library) { return Which(library, call.keys); }; });
}

// A verb that asks one core.
CLI::App* AddCoreVerb(CLI::App& app, Call& call, const char* name, const char* help) {
  CLI::App* const verb = app.add_subcommand(name, help);
  verb->add_option("KEY", call.keys, kKeyHelp)->required()->expected(1);
  return verb;
}

void DescribeShow(CLI::App& app, Call& call) {
  CLI::App* const show =
      AddCoreVerb(app, call, "show", "Shows a core: options, parameters, ports and interfaces");
  show->add_option("--section", call.sections, "One of these alone; may be repeated")
      ->check(CLI::IsMember(kSections))
      ->allow_extra_args(false);
  show->add_flag("--json", call.asJson, "As a JSON document, with all properties");
  show->callback([&call] {
    call.verb = [&call](const auto& library) {
      return Show(library, call.keys.front(), call.sections, call.asJson);
    };
  });
}

void DescribeSources(CLI::App& app, Call& call) {
  CLI::App* const sources =
      AddCoreVerb(app, call, "sources", "Lists the HDL sources of a core in analyse order");
  sources->add_option("--for", call.purpose, "What the sources are analysed for")
      ->check(CLI::IsMember({"synthesis", "simulation"}))
      ->required();
  sources->callback([&call] {
    call.verb = [&call](const auto& library) {
      return Sources(library, call.keys.front(), call.purpose == "simulation");
    };
  });
}

std::string CheckSetting(const std::string& setting) {
  const std::size_t equals = setting.find('=');
  const bool good = equals != std::string::npos && equals > 0;
  return good ? std::string() : "'" + setting + "' is not NAME=VALUE";
}

void DescribeNetlists(CLI::App& app, Call& call) {
  CLI::App* const netlists =
      AddCoreVerb(app, call, "netlists", "Lists the netlists of a core that apply");
  netlists->add_option("--set", call.settings, "Sets a parameter first; may be repeated")
      ->type_name("NAME=VALUE")
      ->check(CheckSetting)
      ->allow_extra_args(false);
  netlists->callback([&call] {
    call.verb = [&call](const auto& library) {
      return Netlists(library, call.keys.front(), call.settings);
    };
  });
}

const char* const kFooter =
    "Exit status: 0 all well, 1 a key was not found or an error was reported,\n"
    "2 the words of the call are wrong, 3 the repository path can't be set.\n"
    "Example: kel -L project/ip -L company/ip which abc";

void DescribeCall(CLI::App& app, Call& call) {
  app.name("kel");
  app.description("Answers questions about repositories of IP cores.");
  app.set_version_flag("--version", "kel " KEL_VERSION_TEXT);
  app.add_option("-L,--library", call.libraries,
                 "A repository, or several with ';' between; may be repeated, the first wins")
      ->type_name("DIR")
      ->allow_extra_args(false);
  app.require_subcommand(0, 1);
  app.fallthrough();
  app.allow_extras();
  app.footer(kFooter);
  for (const auto describe :
       {DescribeList, DescribeWhich, DescribeShow, DescribeSources, DescribeNetlists}) {
    describe(app, call);
  }
}

// What is wrong with a call that parsed, or an empty text.
std::string Fault(const CLI::App& app, const Call& call) {
  const std::vector<std::string> extras = app.remaining(true);
  if (!extras.empty()) return "'" + extras.front() + "' is not expected here";
  if (!call.verb) return "A subcommand is required: list, which, show, sources or netlists";
  if (call.libraries.empty()) return "--library is required";
  const bool empty = std::any_of(
      call.libraries.begin(), call.libraries.end(),
      [](const std::string& path) { return path.find_first_not_of(';') == std::string::npos; });
  return empty ? "--library needs the name of a directory" : "";
}

Status RefuseCall(const std::string& fault) {
  std::cerr << "kel: error: " << fault << "\nRun kel --help for more information.\n";
  return StatusUsage;
}

std::string Join(const std::vector<std::string>& pieces, const char* separator) {
  std::string joined;
  for (const std::string& piece : pieces) joined += (joined.empty() ? "" : separator) + piece;
  return joined;
}

bool IsPath(const Tarvo::StringBase& path) {
  try {
    Tarvo::KelLibrary_Utils::GetPathVector(path);
    return true;
  } catch (const Tarvo::AppException&) {
    return false;
  }
}

// Answers from whatever could be read: what could not has its message, and shows in the status.
Status Run(const Call& call) {
  Messages::Install();
  Tarvo::KelLibrary library;
  const Tarvo::StringBase path = Join(call.libraries, ";").c_str();
  if (!library.SetRepositoryPath(path) && !IsPath(path)) return StatusUnreadable;
  const Status status = call.verb(library);
  return Messages::ErrorCount() == 0 ? status : StatusFindings;
}

Status ParseAndRun(int argc, char** argv) {
  CLI::App app;
  Call call;
  DescribeCall(app, call);
  try {
    app.parse(argc, argv);
  } catch (const CLI::Success& help) {
    app.exit(help);
    return StatusClean;
  } catch (const CLI::ParseError& error) {
    return RefuseCall(error.what());
  }
  const std::string fault = Fault(app, call);
  return fault.empty() ? Run(call) : RefuseCall(fault);
}

}  // namespace

int main(int argc, char** argv) try {
  const Status status = ParseAndRun(argc, argv);
  if (std::cout.flush()) return status;
  std::cerr << "kel: error: Unable to write to standard output\n";
  return StatusFindings;
} catch (const std::exception& exception) {
  std::cerr << "kel: error: " << exception.what() << '\n';
  return StatusFindings;
}
