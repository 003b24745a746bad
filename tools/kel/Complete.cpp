// Completion for all shells: a shell hands over the words up to the cursor and gets what may stand
// there. The rows of the verbs know it.

#include <iostream>

#include "Arguments.h"
#include "Port_MsgManData.h"
#include "Text.h"

namespace {

// Stands for all directories, which shells list better.
const char* const kDirectory = ":directory";

using Words = std::vector<const Word*>;

Words OptionsOf(const Request& request) {
  Words options;
  for (const Word& option : CommonOptions()) options.push_back(&option);
  const Verb* const verb = FindVerb(request.verb);
  if (verb == nullptr) return options;
  for (const Word& word : verb->words) {
    if (word.IsOption()) options.push_back(&word);
  }
  return options;
}

// An option at the start of a word, and what of the word stands in front of its value, as "--for="
// or "-W", if the word holds that too.
struct Opening {
  const Word* option = nullptr;
  std::string lead = {};
};

Opening FindOption(const Words& options, const std::string& text) {
  const bool isLong = text.starts_with("--");
  const std::size_t size = isLong ? text.find('=') : 2;
  const bool holdsValue = size < text.size();
  const std::string name = text.substr(0, size);
  for (const Word* const option : options) {
    const bool isIt = !name.empty() && (option->name == name || option->letter == name);
    if (!isIt || option->IsFlag()) continue;
    return {option, holdsValue ? text.substr(0, isLong ? size + 1 : size) : ""};
  }
  return {};
}

// The keys of the repositories, the first one of each core behind its bare name.
Choices Keys(const std::vector<std::string>& repositories) {
  Choices choices;
  if (repositories.empty()) return choices;
  // Bad descriptions must not write between the words of a command line.
  Port_MsgManData::setHandler([](const Port_Message&) {});
  Tarvo::KelLibrary library;
  library.SetRepositoryPath(Join(repositories, ";").c_str());
  Tarvo::StringBase last;
  for (const Tarvo::Kel_Key& key : SortedKeys(library)) {
    if (key.GetName() != last) choices.push_back({Text(key.GetName())});
    choices.push_back({Text(key.GetKey())});
    last = key.GetName();
  }
  return choices;
}

Choices ValuesOf(const Word& word, const Request& request) {
  const std::string& name = word.ValueName();
  if (name == "DIR") return {{kDirectory}};
  if (name == "KEY" || name == "GLOB") return Keys(Repositories(request));
  return word.choices == nullptr ? Choices() : word.choices();
}

Choices NamesOf(const Words& options) {
  Choices names;
  for (const Word* const option : options) {
    if (!option->letter.empty()) names.push_back({option->letter, option->help});
    names.push_back({option->name, option->help});
  }
  return names;
}

// What may stand as an argument.
Choices Arguments(const Request& request) {
  const Verb* const verb = FindVerb(request.verb);
  if (verb == nullptr) return ChoicesOf(Verbs());
  const Word* const first = verb->words.empty() ? nullptr : &verb->words.front();
  const bool isArgument = first != nullptr && !first->IsOption();
  if (!isArgument || (request.Has(first->name) && !first->isRepeated)) return {};
  return ValuesOf(*first, request);
}

void Write(const Choices& choices, const std::string& lead, const std::string& text) {
  for (const auto& [name, help] : choices) {
    if (name == kDirectory) {
      std::cout << name << '\t' << lead << '\n';
    } else if ((lead + name).starts_with(text)) {
      std::cout << Printable(lead + name) << (help.empty() ? "" : "\t") << help << '\n';
    }
  }
}

}  // namespace

// Whoever presses a key wants no message.
Status Complete(const std::vector<std::string>& words) try {
  if (words.size() < 2) return StatusClean;
  const std::string& text = words.back();
  const std::vector<std::string> before(words.begin() + 1, words.end() - 1);
  const Request request = GuessRequest(before);
  const Words options = OptionsOf(request);
  const Opening open = before.empty() ? Opening() : FindOption(options, before.back());
  const Opening own = FindOption(options, text);
  // Behind an option its value, within an option with "=" its value too, and else an option or an
  // argument.
  if (open.option != nullptr && open.lead.empty()) {
    Write(ValuesOf(*open.option, request), "", text);
  } else if (own.option != nullptr && !own.lead.empty()) {
    Write(ValuesOf(*own.option, request), own.lead, text);
  } else {
    Write(text.starts_with('-') ? NamesOf(options) : Arguments(request), "", text);
  }
  return StatusClean;
} catch (const std::exception&) {
  return StatusClean;
}
