#include <iostream>
#include <memory>

#include "Describe.h"
#include "Json.h"
#include "Table.h"
#include "Tarvo_KelIP.h"
#include "Verbs.h"

namespace {

// The columns of a section, which are members of its records.
struct Columns {
  const char* section;
  std::vector<const char*> names;
};
const Columns kColumns[] = {
    {"place", {"name", "value"}},
    {"options", {"name", "value"}},
    {"parameters", {"name", "value", "default_value", "generic", "description"}},
    {"ports", {"name", "direction", "vector", "interfaces", "description"}},
    {"interfaces", {"name", "kind", "parameters", "ports", "description"}}};

std::string Join(const Json& texts) {
  std::string joined;
  for (const Json& text : texts) joined += (joined.empty() ? "" : ",") + text.get<std::string>();
  return joined;
}

std::string Field(const Json& record, const std::string& name) {
  if (name == "description") return record["properties"].value("DESC", std::string());
  const Json& value = record[name];
  if (value.is_array()) return Join(value);
  if (value.is_boolean()) return value.get<bool>() ? name : "";
  return value.get<std::string>();
}

Table TableOf(const Json& section, const Columns& columns) {
  Table table;
  for (const auto& [name, record] : section.items()) {
    if (section.is_object()) {
      table.Add({name, record.is_array() ? Join(record) : record.get<std::string>()});
      continue;
    }
    Table::Row fields;
    for (const char* const column : columns.names) fields.push_back(Field(record, column));
    table.Add(fields);
  }
  return table;
}

// A heading tells the columns, and begins with a mark that no name begins with.
void WriteHeading(const Columns& columns) {
  std::cout << "# " << columns.section;
  const char* separator = ": ";
  for (const char* const name : columns.names) {
    std::cout << separator << name;
    separator = ", ";
  }
  std::cout << '\n';
}

// A section that stands alone needs no heading.
void WriteTables(const Json& core, bool withHeadings) {
  for (const Columns& columns : kColumns) {
    if (!core.contains(columns.section)) continue;
    const Table table = TableOf(core[columns.section], columns);
    if (table.IsEmpty()) continue;
    if (withHeadings) WriteHeading(columns);
    table.Write();
  }
}

}  // namespace

Status Show(const Tarvo::KelLibrary& library, const Call& call) {
  const std::unique_ptr<Tarvo::KelIP> ip = OpenCore(library, call);
  if (!ip) return StatusFindings;
  const Json core = Describe(library, call, *ip);
  if (call.asJson) {
    WriteJson(core);
  } else {
    WriteTables(core, call.sections.size() != 1);
  }
  return StatusClean;
}
