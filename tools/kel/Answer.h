#ifndef KEL_ANSWER_H
#define KEL_ANSWER_H

#include <cstddef>
#include <iostream>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "Request.h"
#include "Tarvo_Export.h"

// Rows of fields: aligned in columns if standard output is a terminal, with a tab between the
// fields into a pipe or file, where scripts read them. Control characters in them are written as
// \xNN, so that a row stays one line and no field breaks into two.
class Table {
 public:
  using Row = std::vector<std::string>;

  void Add(const Row& fields);
  void Write(std::ostream& output = std::cout) const;

 private:
  std::vector<std::size_t> Widths() const;

  std::vector<Row> rows;
};

// Members keep the order in which they were added. Texts are bytes until they are written.
using Json = nlohmann::ordered_json;

Json Texts(const Tarvo::StringList& list);

// Writes a document. It is UTF-8 whatever bytes a file held; each that is none becomes U+FFFD.
void WriteDocument(std::ostream& output, const Json& document);

// Writes a document of the command's own: these members behind the number of the format that they
// follow.
void WriteJson(const Json& members, std::ostream& output = std::cout);

// The rows of an object of names and values, or of a list of records, with these members of each.
// A description stands among a record's properties, a list has commas, and true is its name.
Table TableOf(const Json& records, const std::vector<std::string>& columns);

// Writes the path or location of each record, as it is, with a NUL behind it.
void WritePaths(const Json& records);

// Writes the members as a document if the request is for one, the paths of the last member's
// records if it is for these alone, or else the table.
void WriteAnswer(const Request& request, const Json& members, const Table& table);

#endif
