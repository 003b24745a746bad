#include "NetlistTable.h"

#include <algorithm>
#include <map>
#include <utility>

#include "Tarvo_AppException.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Text.h"

namespace {

using Tarvo::KelIP;
using Tarvo::StringBase;
using Tarvo::StringList;
using Values = std::vector<std::string>;

const char* const kValue = "VALUE";

struct Line {
  unsigned number;
  std::vector<std::string> fields;
};

// The lines of a file that hold something; none if it can't be read.
std::vector<Line> ReadLines(const Port::FileName& file) {
  std::vector<Line> lines;
  try {
    Tarvo::FileScanner scanner(file);
    StringBase text;
    for (unsigned number = 0; scanner.GetNextLine(text, number);) {
      if (text.GetLength() > 0) lines.push_back({number, Fields(text.View(), ",")});
    }
  } catch (const Tarvo::AppException&) {
    lines.clear();
  }
  return lines;
}

bool EndsHeader(const std::string& field) {
  return StringBase(std::string_view(field)).Compare("FILES", StringBase::CompareIgnoreCase) == 0;
}

// The names that stand in front of the word that ends a header; false if the line is none.
bool ReadHeader(const KelIP& ip, const Line& line, Values& names) {
  StringList known;
  ip.ListParameters(known);
  const auto end = std::find_if(line.fields.begin(), line.fields.end(), EndsHeader);
  names.assign(line.fields.begin(), end);
  return end != line.fields.end() &&
         std::all_of(names.begin(), names.end(), [&](const std::string& name) {
           return std::find(known.begin(), known.end(), name.c_str()) != known.end();
         });
}

Values CurrentValues(const KelIP& ip, const Values& names) {
  Values values;
  for (const std::string& name : names) {
    StringBase value;
    ip.GetParameterProperty(name.c_str(), kValue, value);
    values.push_back(Text(value));
  }
  return values;
}

void SetValues(KelIP& ip, const Values& names, const Values& values) {
  for (std::size_t i = 0; i < names.size(); ++i) {
    ip.SetParameterProperty(names[i].c_str(), kValue, values[i].c_str());
  }
}

bool EndsIn(const std::string& text, const std::string& end) {
  return text.size() >= end.size() && text.compare(text.size() - end.size(), end.size(), end) == 0;
}

// Puts those of the netlists into a row that its files name, each as NAME or LIBRARY:NAME.
void Choose(const StringList& netlists, const std::vector<std::string>& files,
            NetlistTable::Row& row) {
  for (const std::string& file : files) {
    const std::string name = "/netlist/" + file.substr(file.find(':') + 1);
    bool known = file == "," || netlists.empty();
    for (const StringBase& netlist : netlists) {
      const std::string path = Text(netlist);
      if (!EndsIn(path, name)) continue;
      known = true;
      if (std::find(row.netlists.begin(), row.netlists.end(), path) != row.netlists.end()) continue;
      row.netlists.push_back(path);
      break;
    }
    if (!known) row.ignored.push_back(file);
  }
}

}  // namespace

Port::FileName DataFile(const KelIP& ip, const StringBase& extension) {
  Port::FileName location;
  location.SetHead(ip.GetLocation());
  return Tarvo::Kel_Index::GetDataFile(location, Tarvo::Kel_Key(ip.GetKey()), extension);
}

NetlistTable ReadNetlistTable(KelIP& ip) {
  NetlistTable table;
  const std::vector<Line> lines = ReadLines(DataFile(ip, Tarvo::Kel_Index::KEL_TEW_EXTENSION));
  auto line = std::find_if(lines.begin(), lines.end(), [&](const Line& candidate) {
    return ReadHeader(ip, candidate, table.parameters);
  });
  if (line == lines.end()) return {};
  const Values current = CurrentValues(ip, table.parameters);
  std::map<Values, StringList> answers;
  const auto columns = static_cast<std::ptrdiff_t>(table.parameters.size());
  for (++line; line != lines.end(); ++line) {
    if (line->fields.size() <= table.parameters.size()) continue;
    const auto files = line->fields.begin() + columns;
    Values values(line->fields.begin(), files);
    const auto [answer, isNew] = answers.try_emplace(values);
    if (isNew) {
      SetValues(ip, table.parameters, values);
      ip.ListNetlists(answer->second);
    }
    const bool applies = values == current;
    NetlistTable::Row row = {line->number, std::move(values), {}, {}, applies};
    Choose(answer->second, {files, line->fields.end()}, row);
    table.rows.push_back(std::move(row));
  }
  SetValues(ip, table.parameters, current);
  return table;
}
