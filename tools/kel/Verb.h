#ifndef KEL_VERB_H
#define KEL_VERB_H

#include <memory>
#include <string>
#include <vector>

#include "Answer.h"
#include "Messages.h"
#include "Request.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Key.h"

// Exit statuses of the command.
enum Status {
  StatusClean = 0,
  StatusFindings = 1,   // a key was not found, or a message was an error
  StatusUsage = 2,      // usage error
  StatusUnreadable = 3  // the repository path can't be set
};

// One of the texts that may stand in a place, and what it means.
struct Choice {
  std::string name;
  std::string help = {};
};
using Choices = std::vector<Choice>;

std::vector<std::string> NamesOf(const Choices& choices);

// The rows of a table, which have a name and a help.
template <class Rows>
Choices ChoicesOf(const Rows& rows) {
  Choices choices;
  for (const auto& row : rows) choices.push_back({row.name, row.help});
  return choices;
}

// An argument or an option. The parser, the help, the completions and the manual page follow it.
struct Word {
  std::string letter = {};  // of an option that has a short name too, as "-L"
  std::string name;         // as "KEY" for an argument, or "--all"
  std::string value = {};   // what stands for an option's value; a flag has none
  std::string help;
  bool isRequired = false;
  bool isRepeated = false;
  std::string byDefault = {};
  // What may be given. An option has no other values, unless it has a way to tell a fault in one,
  // which gives an empty text if there is none.
  Choices (*choices)() = nullptr;
  std::string (*fault)(const std::string& value) = nullptr;

  bool IsOption() const { return name.front() == '-'; }
  bool IsFlag() const { return IsOption() && value.empty(); }
  // A shell completes what is named DIR, KEY or GLOB by itself.
  const std::string& ValueName() const { return IsOption() ? value : name; }
};

// Words of several verbs.
Word KeyWord();
Word GlobWord();
Word RelativeToWord();
Word SetWord(const char* help);
Word NullWord();
Word Repeated(Word word);
// What is wrong with a value that is to be NAME=VALUE, or an empty text.
std::string PairFault(const std::string& pair);

// A row of the table of verbs.
struct Verb {
  enum Reads {
    Nothing,  // needs no repository
    ItsOwn,   // reads the repositories itself
    Asked,    // what is wrong with cores that are not asked for is shown, but does not count
    All       // every error counts
  };

  std::string name;
  std::string help;
  std::vector<Word> words = {};  // an argument first, if there is one
  std::string example;           // the words behind `kel`, and behind -L if it needs a repository
  Reads reads = Asked;
  // Writes the answer to standard output, as a document if the request is for JSON, and leaves what
  // the library does not know to the messages.
  Status (*answer)(const Tarvo::KelLibrary& library, const Request& request);
};
const std::vector<Verb>& Verbs();
const Verb* FindVerb(const std::string& name);

// What the verbs share.

// The repositories of a request, in their order.
std::vector<std::string> Repositories(const Request& request);

// Whether the key or its base name fits one of the patterns; true for none.
bool MatchesAny(const Tarvo::Kel_Key& key, const std::vector<std::string>& globs);

// The versions whose options can be read: by name, and of each core the newest first.
std::vector<Tarvo::Kel_Key> SortedKeys(const Tarvo::KelLibrary& library);

// What was given for --set.
struct Setting {
  std::string name;
  std::string value;
};
std::vector<Setting> SettingsOf(const Request& request);

// Opens a core, or suggests other keys.
std::unique_ptr<Tarvo::KelIP> OpenCore(const Tarvo::KelLibrary& library, const std::string& key);

// Asks for a core's sources or netlists. A core whose style has none gives an empty answer and a
// note that says so. False for a failure.
bool HasNoneByStyle(const Tarvo::KelIP& ip, const char* what, int errors);
template <class Answer>
bool Ask(const Tarvo::KelIP& ip, bool (Tarvo::KelIP::*question)(Answer&) const, const char* what,
         Answer& answer) {
  const int errors = Messages::ErrorCount();
  return (ip.*question)(answer) || HasNoneByStyle(ip, what, errors);
}

#endif
