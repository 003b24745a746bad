#ifndef KEL_DESCRIBE_H
#define KEL_DESCRIBE_H

#include <string>
#include <vector>

#include "Call.h"
#include "Json.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

// The names of the sections that a description of a core has.
std::vector<std::string> SectionNames();

// What a core is: its key, and a member for each section that the call names, or for all of them,
// in the order of the core description. Of namesakes the first alone counts, for records,
// properties and options alike.
//
//     place        name, version, location, the repository that it comes from, the directories of
//                  other repositories that it hides, and the keys of the core's other versions
//     options      an object of names and values
//     parameters   name, value, default_value, generic (or not), properties
//     ports        name, direction, vector, default, interfaces, properties
//     interfaces   name, kind ("bus" or "io"), parameters and ports that belong to it, properties
Json Describe(const Tarvo::KelLibrary& library, const Call& call, const Tarvo::KelIP& ip);

#endif
