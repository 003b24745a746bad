#ifndef KEL_JSON_H
#define KEL_JSON_H

#include <nlohmann/json.hpp>

// Members keep the order in which they were added. Texts are bytes until they are written.
using Json = nlohmann::ordered_json;

// Writes a document to standard output: the members of an object behind the number of the format
// that they follow. It is UTF-8 whatever bytes a file held; each that is none becomes U+FFFD.
void WriteJson(const Json& members);

#endif
