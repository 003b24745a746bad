#ifndef KEL_VERBS_H
#define KEL_VERBS_H

#include <string>
#include <vector>

#include "Status.h"
#include "Tarvo_KelLibrary.h"

// What the command does, one function for each verb. Each writes its answer to standard output and
// leaves what the library does not know to the messages.

// A line for each key or bare name: the key it resolves to, name, version and location.
Status Which(const Tarvo::KelLibrary& library, const std::vector<std::string>& keys);

// A line for the newest version of each core, or for each version, whose description could be read:
// key, style, language, location and description.
Status List(const Tarvo::KelLibrary& library, bool allVersions);

// What a core is: its options, parameters, ports and interfaces, or some of these sections, as
// tables or as a JSON document.
Status Show(const Tarvo::KelLibrary& library, const std::string& key,
            const std::vector<std::string>& sections, bool asJson);

// The sources of a core, a path on each line, in the order in which they are to be analysed.
Status Sources(const Tarvo::KelLibrary& library, const std::string& key, bool forSimulation);

// The netlists of a core that apply, a path on each line, with parameters set as each NAME=VALUE
// says.
Status Netlists(const Tarvo::KelLibrary& library, const std::string& key,
                const std::vector<std::string>& settings);

#endif
