// The rows of the verbs are turned into a description for the parser of command lines, and what
// that one read into a Request. Only here is the parser known.

#include "Arguments.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <iostream>
#include <utility>

#include "Suggestions.h"
#include "Tarvo_Version.h"
#include "Text.h"

namespace {

const char* const kFooter =
    "Exit status: 0 success, 1 an error or warning was found or a key is unknown, 2 usage error,\n"
    "3 no repository can be read. 'kel help VERB' shows an example, and 'kel help diagnostics'\n"
    "what check may report.\n";

Choices Colors() { return {{"auto"}, {"always"}, {"never"}}; }

// Arguments with choices are topics of help, which have errors of their own.
bool IsClosed(const Word& word) {
  return word.choices != nullptr && word.fault == nullptr && word.IsOption();
}

std::string FaultOf(const Word& word, const std::string& value) {
  if (word.fault != nullptr) return word.fault(value);
  if (!IsClosed(word)) return "";
  const std::vector<std::string> names = NamesOf(word.choices());
  const bool isOne = std::find(names.begin(), names.end(), value) != names.end();
  return isOne ? "" : value + " not in {" + Join(names, ",") + "}";
}

std::string NamesFor(const Word& word) {
  return word.letter.empty() ? word.name : word.letter + "," + word.name;
}

// What the help says of an option with choices: they stand beside the name of the value, or have a
// line each if they have a help.
void DescribeChoices(const Choices& choices, std::string& value, std::string& help) {
  if (choices.front().help.empty()) value += ":{" + Join(NamesOf(choices), ",") + "}";
  for (const auto& [name, meaning] : choices) {
    if (!meaning.empty()) help.append("\n  ").append(name).append(": ").append(meaning);
  }
}

void AddValued(CLI::App& app, const Word& word) {
  std::string value = word.value;
  std::string help = word.help;
  if (IsClosed(word)) DescribeChoices(word.choices(), value, help);
  CLI::Option* const option = app.add_option(NamesFor(word), std::as_const(help));
  option->type_name(value)->required(word.isRequired)->default_str(word.byDefault);
  if (word.isRepeated) option->expected(1, CLI::detail::expected_max_vector_size);
  // Without this, an option that may be repeated would take all words behind it.
  option->allow_extra_args(word.isRepeated && !word.IsOption());
  option->check([&word](const std::string& given) { return FaultOf(word, given); });
}

void AddWord(CLI::App& app, const Word& word) {
  if (word.name == "--help") {
    app.set_help_flag(NamesFor(word), word.help);
  } else if (word.name == "--version") {
    app.set_version_flag(word.name, std::string("kel ") + Tarvo::GetLibraryVersion(), word.help);
  } else if (word.IsFlag()) {
    app.add_flag(NamesFor(word), word.help);
  } else {
    AddValued(app, word);
  }
}

void AddVerb(CLI::App& app, const Verb& verb) {
  CLI::App* const added = app.add_subcommand(verb.name, verb.help);
  added->group("Verbs");
  const std::string more =
      "Every verb takes -L, --json, --trace, --quiet and --color too; see "
      "'kel help'.\nExample: kel -L examples/repository ";
  added->footer((verb.reads == Verb::Nothing ? "Example: kel " : more) + verb.example + "\n");
  for (const Word& word : verb.words) AddWord(*added, word);
}

void DescribeCommand(CLI::App& app) {
  app.name("kel");
  app.description("Answers questions about repositories of IP cores.");
  app.get_formatter()->label("SUBCOMMAND", "VERB");
  for (const Word& word : CommonOptions()) AddWord(app, word);
  app.require_subcommand(0, 1);
  app.fallthrough();
  app.allow_extras();
  app.footer(kFooter);
  for (const Verb& verb : Verbs()) AddVerb(app, verb);
}

std::string NoVerb(const std::string& word) {
  const std::vector<std::string> names = NamesOf(ChoicesOf(Verbs()));
  const std::string question = DidYouMean(names, word);
  return "unknown verb '" + word + "'" +
         (question.empty() ? "; the verbs are " + Join(names) : question);
}

// Words that ask for different answers, or an empty text.
std::string Contradiction(const Request& request) {
  std::vector<std::string> forms;
  for (const char* const form : {"--json", "--null", "--table"}) {
    if (request.Has(form)) forms.emplace_back(form);
  }
  const std::string format = request.Value("--format");
  const std::string own = request.Has("--json") ? "json" : "list";
  const bool hasFormat = !forms.empty() && !format.empty() && format != own;
  if (hasFormat) forms.push_back("--format " + format);
  // A table may be a document.
  const bool isOne = forms.size() < 2 || (!request.Has("--null") && request.Has("--table"));
  return isOne ? "" : forms[0] + " and " + forms[1] + " can't be used together";
}

// What is wrong with a command line that parsed, or an empty text.
std::string Fault(const CLI::App& app, const Request& request) {
  const std::vector<std::string> extras = app.remaining(true);
  const Verb* const verb = FindVerb(request.verb);
  if (verb == nullptr && !extras.empty() && !extras.front().starts_with('-')) {
    return NoVerb(extras.front());
  }
  // Behind a verb, or an option that nobody knows.
  if (!extras.empty()) return "unexpected argument '" + extras.front() + "'";
  if (verb == nullptr) return "a verb is required: " + Join(NamesOf(ChoicesOf(Verbs())));
  std::string contradiction = Contradiction(request);
  if (!contradiction.empty()) return contradiction;
  if (verb->reads == Verb::Nothing) return "";
  if (!request.Has("--library")) return "-L DIR is required; it names a repository";
  const auto& paths = request.Values("--library");
  const auto isEmpty = [](const auto& path) { return path.find_first_not_of(';') == path.npos; };
  return std::any_of(paths.begin(), paths.end(), isEmpty) ? "-L needs the name of a directory" : "";
}

// The parser would take a word in brackets for a list, and a pattern may be one. A mark behind it
// keeps it a word.
constexpr char kMark = '\x01';

void Parse(CLI::App& app, std::vector<std::string> words) {
  for (std::string& word : words) {
    if (word.starts_with('[') && word.ends_with(']')) word += kMark;
  }
  std::reverse(words.begin(), words.end());  // as the parser wants them
  app.parse(words);
}

// What was given for a word. JSON may be asked for by --json or as a format.
std::vector<std::string> Given(const CLI::App& app, const Word& word, const Request& request) {
  std::vector<std::string> values = app.get_option(word.name)->results();
  for (std::string& value : values) {
    if (value.ends_with(kMark)) value.pop_back();
  }
  if (!values.empty() || word.byDefault.empty()) return values;
  return {word.name == "--format" && request.Has("--json") ? "json" : word.byDefault};
}

// The verb is known also if the words are wrong behind it.
Request MakeRequest(const CLI::App& app) {
  // Each word of each verb has its place, so that common code may ask for it.
  Request request;
  for (const Verb& verb : Verbs()) {
    for (const Word& word : verb.words) request.given[word.name];
  }
  for (const Word& word : CommonOptions()) request.given[word.name] = Given(app, word, request);
  const std::vector<CLI::App*> named = app.get_subcommands();
  if (named.empty()) return request;
  request.verb = named.front()->get_name();
  for (const Word& word : FindVerb(request.verb)->words) {
    request.given[word.name] = Given(*named.front(), word, request);
  }
  return request;
}

}  // namespace

const std::vector<Word>& CommonOptions() {
  static const std::vector<Word> options = {
      {.letter = "-h",
       .name = "--help",
       .help = "Show the help of the command, or of the verb before it"},
      {.name = "--version", .help = "Show the version"},
      {.letter = "-L",
       .name = "--library",
       .value = "DIR",
       .help = "A repository, or several with ';' between; may be repeated, the first wins",
       .isRepeated = true},
      {.name = "--json", .help = "Write a JSON document"},
      {.name = "--trace", .help = "Show on standard error what is read"},
      {.name = "--quiet", .help = "Leave out messages and notes; see the exit status"},
      {.name = "--color",
       .value = "WHEN",
       .help = "Whether messages are coloured",
       .byDefault = "auto",
       .choices = Colors}};
  return options;
}

std::optional<Request> ReadRequest(const std::vector<std::string>& words, Status& status) {
  CLI::App app;
  DescribeCommand(app);
  try {
    Parse(app, words);
    Request request = MakeRequest(app);
    const std::string fault = Fault(app, request);
    if (fault.empty()) return request;
    status = Refuse(fault, request.verb);
  } catch (const CLI::Success& help) {
    app.exit(help);
    status = StatusClean;
  } catch (const CLI::ParseError& error) {
    status = Refuse(error.what(), MakeRequest(app).verb);
  }
  return std::nullopt;
}

Request GuessRequest(const std::vector<std::string>& words) {
  CLI::App app;
  DescribeCommand(app);
  try {
    Parse(app, words);
  } catch (const CLI::Error&) {  // what was read until then will do
  }
  return MakeRequest(app);
}

// The application's own operation would give the help of the verb `help`.
std::string HelpText(const std::string& verb) {
  CLI::App app;
  DescribeCommand(app);
  const bool isVerb = FindVerb(verb) != nullptr;
  return app.get_formatter()->make_help(isVerb ? app.get_subcommand(verb) : &app,
                                        isVerb ? "kel " + verb : "kel", CLI::AppFormatMode::Normal);
}

Status Refuse(const std::string& fault, const std::string& verb) {
  const std::string help = verb.empty() ? "kel --help" : "kel help " + verb;
  std::cerr << "kel: error: " << fault << "\nRun '" << help << "' for more information.\n";
  return StatusUsage;
}
