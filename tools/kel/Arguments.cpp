#include "Arguments.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <iostream>

#include "Codes.h"
#include "Describe.h"
#include "Formats.h"
#include "Nearby.h"
#include "Tarvo_Version.h"
#include "Text.h"

namespace {

const char* const kKeyHelp =
    "A key such as abc_v1_00_a, or a core's bare name for its newest version";
const char* const kGlobHelp = "A key or name, in which * ? [...] stand for any text";

const char* const kFooter =
    "Exit status: 0 success, 1 an error or warning was found or a key is unknown, 2 usage error,\n"
    "3 no repository can be read. 'kel help VERB' shows an example, and 'kel help diagnostics'\n"
    "what check may report.\n";

const std::vector<std::string> kVerbNames = {"list",     "which", "show", "sources",
                                             "netlists", "check", "help"};

// A verb, with an example of its use.
CLI::App* AddVerb(CLI::App& app, Call& call, const char* name, const char* help,
                  const char* example) {
  CLI::App* const verb = app.add_subcommand(name, help);
  verb->group("Verbs");
  verb->footer(std::string("Every verb takes -L, --json, --trace, --quiet and --color too; see "
                           "'kel help'.\nExample: kel -L examples/repository ") +
               example + "\n");
  verb->callback([&call, name] { call.verb = name; });
  return verb;
}

void AddKey(CLI::App* verb, Call& call) { verb->add_option("KEY", call.key, kKeyHelp)->required(); }

void AddRelativeTo(CLI::App* verb, Call& call) {
  verb->add_option("--relative-to", call.relativeTo, "Write paths relative to this directory")
      ->type_name("DIR");
}

void DescribeList(CLI::App& app, Call& call) {
  CLI::App* const list =
      AddVerb(app, call, "list",
              "Lists the newest version of each core: key, style, language, location, description",
              "list 'pulse*' --all");
  list->add_option("GLOB", call.key, kGlobHelp);
  list->add_flag("--all", call.allVersions, "List every version");
}

void DescribeWhich(CLI::App& app, Call& call) {
  CLI::App* const which =
      AddVerb(app, call, "which", "Tells key, name, version and location of each core",
              "which word_fifo pulse_counter_v1_00_a");
  which->add_option("KEY", call.keys, kKeyHelp)->required();
}

void DescribeShow(CLI::App& app, Call& call) {
  CLI::App* const show = AddVerb(
      app, call, "show", "Shows all about a core: place, options, parameters, ports, interfaces",
      "show event_station --section ports");
  AddKey(show, call);
  show->add_option("--section", call.sections, "Show this section only; may be repeated")
      ->check(CLI::IsMember(SectionNames()))
      ->allow_extra_args(false);
}

void DescribeSources(CLI::App& app, Call& call) {
  CLI::App* const sources =
      AddVerb(app, call, "sources", "Lists the HDL sources of a core in analyse order",
              "sources event_station --for simulation --format ghdl");
  AddKey(sources, call);
  sources->add_option("--for", call.purpose, "What the sources are for")
      ->check(CLI::IsMember({"synthesis", "simulation"}))
      ->required();
  sources
      ->add_option("--format", call.format,
                   "Output format: list (a path on a line), json, f (file list for Verilog\n"
                   "tools), ghdl (script for GHDL), edam (for flow generators), vhdl_ls (for the\n"
                   "VHDL language server) or tcl")
      ->check(CLI::IsMember(FormatNames()))
      ->default_str("list");
  AddRelativeTo(sources, call);
}

std::string CheckSetting(const std::string& setting) {
  const std::size_t equals = setting.find('=');
  const bool good = equals != std::string::npos && equals > 0;
  return good ? std::string() : "'" + setting + "' is not NAME=VALUE";
}

void DescribeNetlists(CLI::App& app, Call& call) {
  CLI::App* const netlists =
      AddVerb(app, call, "netlists", "Lists the netlists of a core that apply",
              "netlists crc_unit --set WIDTH=16 --set MODE=FAST");
  AddKey(netlists, call);
  netlists->add_option("--set", call.settings, "Sets a parameter first; may be repeated")
      ->type_name("NAME=VALUE")
      ->check(CheckSetting)
      ->allow_extra_args(false);
  netlists->add_flag("--table", call.wholeTable,
                     "List all of them with their values; * marks those that apply");
}

std::string CheckWarning(const std::string& choice) {
  std::vector<std::string> choices = {"error"};
  for (const auto& code : Codes()) choices.push_back(std::string("no-") + code.code);
  if (std::find(choices.begin(), choices.end(), choice) != choices.end()) return "";
  return "'" + choice + "' is neither error nor no-CODE" + DidYouMean(choices, choice);
}

void DescribeCheck(CLI::App& app, Call& call) {
  CLI::App* const check =
      AddVerb(app, call, "check", "Lists what is wrong with the cores, at its file and line",
              "check 'pulse*' -W error");
  check->add_option("GLOB", call.keys, kGlobHelp);
  check
      ->add_option("--format", call.format,
                   "Output format: text, json or sarif (for code hosts and editors)")
      ->check(CLI::IsMember({"text", "json", "sarif"}))
      ->default_str("text");
  check->add_flag("--excerpts", call.withExcerpts,
                  "Show lines, help and related places, as on a terminal");
  check
      ->add_option("-W", call.warnings,
                   "error: warnings count as errors; no-CODE: leave out this code; may be repeated")
      ->type_name("CHOICE")
      ->check(CheckWarning)
      ->allow_extra_args(false);
  AddRelativeTo(check, call);
}

void DescribeHelp(CLI::App& app, Call& call) {
  CLI::App* const help =
      AddVerb(app, call, "help", "Shows this help, that of a verb, or what a diagnostic means", "");
  help->footer("Examples: kel help list, kel help list-ends\n");
  help->add_option("TOPIC", call.key,
                   "A verb, a code of a diagnostic, or diagnostics for all codes");
}

void DescribeCall(CLI::App& app, Call& call) {
  app.name("kel");
  app.description("Answers questions about repositories of IP cores.");
  app.get_formatter()->label("SUBCOMMAND", "VERB");
  app.set_version_flag("--version", std::string("kel ") + Tarvo::GetLibraryVersion());
  app.add_option("-L,--library", call.libraries,
                 "A repository, or several with ';' between; may be repeated, the first wins")
      ->type_name("DIR")
      ->allow_extra_args(false);
  app.add_flag("--json", call.asJson, "Write a JSON document");
  app.add_flag("--trace", call.withTraces, "Show on standard error what is read");
  app.add_flag("--quiet", call.quiet, "Leave out messages and notes; see the exit status");
  app.add_option("--color", call.color, "Whether messages are coloured")
      ->check(CLI::IsMember({"auto", "always", "never"}))
      ->default_str("auto");
  app.require_subcommand(0, 1);
  app.fallthrough();
  app.allow_extras();
  app.footer(kFooter);
  for (const auto describe : {DescribeList, DescribeWhich, DescribeShow, DescribeSources,
                              DescribeNetlists, DescribeCheck, DescribeHelp}) {
    describe(app, call);
  }
}

std::string NoVerb(const std::string& word) {
  const std::string question = DidYouMean(kVerbNames, word);
  return "unknown verb '" + word + "'" +
         (question.empty() ? "; the verbs are " + Join(kVerbNames) : question);
}

// What is wrong with a call that parsed, or an empty text.
std::string Fault(const CLI::App& app, const Call& call) {
  const std::vector<std::string> extras = app.remaining(true);
  if (call.verb.empty() && !extras.empty() && extras.front().front() != '-') {
    return NoVerb(extras.front());
  }
  if (!extras.empty()) return "unexpected argument '" + extras.front() + "'";
  if (call.verb.empty()) return "a verb is required: " + Join(kVerbNames);
  if (call.asJson && !call.format.empty() && call.format != "json") {
    return "--json and --format " + call.format + " can't be used together";
  }
  if (call.libraries.empty()) return "-L DIR is required; it names a repository";
  const bool empty = std::any_of(
      call.libraries.begin(), call.libraries.end(),
      [](const std::string& path) { return path.find_first_not_of(';') == std::string::npos; });
  return empty ? "-L needs the name of a directory" : "";
}

Status Refuse(const std::string& fault, const std::string& verb) {
  const std::string help = verb.empty() ? "kel --help" : "kel help " + verb;
  std::cerr << "kel: error: " << fault << "\nRun '" << help << "' for more information.\n";
  return StatusUsage;
}

// The verb that the words name, also if they are wrong behind it.
std::string VerbOf(const CLI::App& app) {
  const std::vector<CLI::App*> verbs = app.get_subcommands();
  return verbs.empty() ? "" : verbs.front()->get_name();
}

// The parser would take a word in brackets for a list, and a pattern may be one. A mark behind it
// keeps it a word.
constexpr char kMark = '\x01';

// The words from the last to the first, as the parser wants them.
std::vector<std::string> MarkWords(int argc, char** argv) {
  std::vector<std::string> words(argv + std::min(argc, 1), argv + argc);
  for (std::string& word : words) {
    if (!word.empty() && word.front() == '[' && word.back() == ']') word += kMark;
  }
  std::reverse(words.begin(), words.end());
  return words;
}

void Unmark(std::string& word) {
  if (!word.empty() && word.back() == kMark) word.pop_back();
}

void Unmark(Call& call) {
  for (std::string* const word : {&call.key, &call.relativeTo}) Unmark(*word);
  for (auto* const words : {&call.keys, &call.libraries, &call.settings}) {
    for (std::string& word : *words) Unmark(word);
  }
}

std::string NoTopic(const std::string& word) {
  std::vector<std::string> topics = kVerbNames;
  topics.emplace_back("diagnostics");
  for (const auto& code : Codes()) topics.emplace_back(code.code);
  return "no help for '" + word + "'" + DidYouMean(topics, word);
}

Status ShowHelp(const CLI::App& app, const std::string& verb) {
  if (ShowCodes(verb)) return StatusClean;
  try {
    const CLI::App* const shown = verb.empty() ? &app : app.get_subcommand(verb);
    // The application's own operation would give the help of the verb `help`.
    std::cout << app.get_formatter()->make_help(shown, verb.empty() ? "kel" : "kel " + verb,
                                                CLI::AppFormatMode::Normal);
    return StatusClean;
  } catch (const CLI::OptionNotFound&) {
    return Refuse(NoTopic(verb), "");
  }
}

}  // namespace

std::optional<Call> ReadCall(int argc, char** argv, Status& status) {
  CLI::App app;
  Call call;
  DescribeCall(app, call);
  try {
    app.parse(MarkWords(argc, argv));
    Unmark(call);
  } catch (const CLI::Success& help) {
    app.exit(help);
    status = StatusClean;
    return std::nullopt;
  } catch (const CLI::ParseError& error) {
    status = Refuse(error.what(), VerbOf(app));
    return std::nullopt;
  }
  if (call.verb == "help") {
    status = ShowHelp(app, call.key);
    return std::nullopt;
  }
  const std::string fault = Fault(app, call);
  if (fault.empty()) return call;
  status = Refuse(fault, call.verb);
  return std::nullopt;
}
