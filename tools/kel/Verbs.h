#ifndef KEL_VERBS_H
#define KEL_VERBS_H

#include <memory>
#include <string>
#include <vector>

#include "Call.h"
#include "Json.h"
#include "Messages.h"
#include "Status.h"
#include "Table.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Key.h"

// What the command does, one function for each verb. Each writes its answer to standard output, as
// a document if the call asks for JSON, and leaves what the library does not know to the messages.

// The newest version of each core, or each version, whose description could be read: key, style,
// language, location and description.
Status List(const Tarvo::KelLibrary& library, const Call& call);

// For each key or bare name: the key it stands for, name, version and location.
Status Which(const Tarvo::KelLibrary& library, const Call& call);

// What a core is: its place, options, parameters, ports and interfaces.
Status Show(const Tarvo::KelLibrary& library, const Call& call);

// The sources of a core, in the order in which they are to be analysed.
Status Sources(const Tarvo::KelLibrary& library, const Call& call);

// The netlists of a core that apply to the values that the call sets.
Status Netlists(const Tarvo::KelLibrary& library, const Call& call);

// What is wrong with the cores, or meant otherwise. Sets the repository path itself.
Status Check(Tarvo::KelLibrary& library, const Call& call);

// What the verbs share.

// Whether the key or its base name fits one of the patterns; true for none.
bool MatchesAny(const Tarvo::Kel_Key& key, const std::vector<std::string>& globs);

// Opens the core of a call, or suggests other keys.
std::unique_ptr<Tarvo::KelIP> OpenCore(const Tarvo::KelLibrary& library, const Call& call);

// Asks for a core's sources or netlists. A core whose style has none gives an empty answer and a
// note that says so. False for a failure.
bool HasNoneByStyle(const Tarvo::KelIP& ip, const char* what, int errors);
template <class Answer>
bool Ask(const Tarvo::KelIP& ip, bool (Tarvo::KelIP::*question)(Answer&) const, const char* what,
         Answer& answer) {
  const int errors = Messages::ErrorCount();
  return (ip.*question)(answer) || HasNoneByStyle(ip, what, errors);
}

// The repositories of a call, in their order.
std::vector<std::string> Repositories(const Call& call);

// Writes an answer, as rows or as a document.
void WriteAnswer(const Table& table, const Json& members, bool asJson);

#endif
