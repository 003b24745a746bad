#ifndef KEL_JSON_H
#define KEL_JSON_H

#include <iostream>
#include <nlohmann/json.hpp>

#include "Tarvo_Export.h"

// Members keep the order in which they were added. Texts are bytes until they are written.
using Json = nlohmann::ordered_json;

Json Texts(const Tarvo::StringList& list);

// Writes a document. It is UTF-8 whatever bytes a file held; each that is none becomes U+FFFD.
void WriteDocument(std::ostream& output, const Json& document);

// Writes a document of the command's own: these members behind the number of the format that they
// follow.
void WriteJson(const Json& members, std::ostream& output = std::cout);

#endif
