// An answer is made once, as a document; rows for people and scripts are read off it. So both can't
// differ.

#include "Answer.h"

#include <unistd.h>

#include <algorithm>
#include <utility>

#include "Text.h"

namespace {

std::string Field(const Json& value) {
  return value.is_array() ? Join(value.get<std::vector<std::string>>(), ",")
                          : value.get<std::string>();
}

std::string Field(const Json& record, const std::string& name) {
  // DESC is a property like any other, but the one that tables show.
  const bool isProperty = name == "description" && record.contains("properties");
  if (isProperty) return record["properties"].value("DESC", std::string());
  const Json& value = record[name];
  if (value.is_boolean()) return value.get<bool>() ? name : "";
  return Field(value);
}

}  // namespace

void Table::Add(const Row& fields) {
  Row row;
  for (const std::string& field : fields) row.push_back(Printable(field));
  rows.push_back(std::move(row));
}

std::vector<std::size_t> Table::Widths() const {
  std::vector<std::size_t> widths;
  for (const Row& row : rows) {
    widths.resize(std::max(widths.size(), row.size()));
    for (std::size_t i = 0; i < row.size(); ++i) {
      widths[i] = std::max(widths[i], CountCells(row[i]));
    }
  }
  return widths;
}

// The last field of a row needs nothing behind it.
void Table::Write(std::ostream& output) const {
  // Only a terminal wants columns: scripts cut at tabs, and need not know all rows before the
  // first.
  const bool aligned = ::isatty(STDOUT_FILENO) != 0;
  const std::vector<std::size_t> widths = aligned ? Widths() : std::vector<std::size_t>();
  for (const Row& row : rows) {
    for (std::size_t i = 0; i + 1 < row.size(); ++i) {
      output << row[i] << (aligned ? std::string(widths[i] + 2 - CountCells(row[i]), ' ') : "\t");
    }
    output << row.back() << '\n';
  }
}

Json Texts(const Tarvo::StringList& list) {
  Json texts = Json::array();
  for (const Tarvo::StringBase& text : list) texts.push_back(Text(text));
  return texts;
}

void WriteDocument(std::ostream& output, const Json& document) {
  constexpr int indent = 2;
  output << document.dump(indent, ' ', false, Json::error_handler_t::replace) << '\n';
}

void WriteJson(const Json& members, std::ostream& output) {
  // Raised when a member goes or changes its meaning, not when one comes.
  constexpr int formatVersion = 1;
  Json document = {{"format_version", formatVersion}};
  document.update(members);
  WriteDocument(output, document);
}

Table TableOf(const Json& records, const std::vector<std::string>& columns) {
  Table table;
  for (const auto& [name, record] : records.items()) {
    Table::Row fields;
    if (records.is_object()) fields = {name, Field(record)};
    if (records.is_array()) {
      for (const std::string& column : columns) fields.push_back(Field(record, column));
    }
    table.Add(fields);
  }
  return table;
}

void WritePaths(const Json& records) {
  for (const Json& record : records) {
    std::cout << record[record.contains("path") ? "path" : "location"].get<std::string>() << '\0';
  }
}

void WriteAnswer(const Request& request, const Json& members, const Table& table) {
  if (request.Has("--json")) {
    WriteJson(members);
  } else if (request.Has("--null")) {
    WritePaths(members.back());
  } else {
    table.Write();
  }
}
