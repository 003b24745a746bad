// The verb `netlists`: parameters are set in the opened core alone, and then the library is asked
// what applies.

#include <algorithm>

#include "Text.h"
#include "Verb.h"

namespace {

using Tarvo::KelIP;
using Tarvo::KelNetlistTable;

// False, with a warning, for a parameter that the core does not have.
bool SetParameters(KelIP& ip, const std::vector<Setting>& settings) {
  return std::all_of(settings.begin(), settings.end(), [&](const Setting& setting) {
    return ip.SetParameterProperty(setting.name.c_str(), "VALUE", setting.value.c_str());
  });
}

// A line of the table: a mark, a field for each of the texts, and a last one.
Table::Row TableRow(const char* mark, const Tarvo::StringList& texts, const std::string& last) {
  Table::Row fields = {mark};
  for (const Tarvo::StringBase& text : texts) fields.push_back(Text(text));
  fields.push_back(last);
  return fields;
}

Status AnswerTable(const KelIP& ip, const Request& request) {
  KelNetlistTable netlists;
  if (!Ask(ip, &KelIP::GetNetlistTable, "netlists", netlists)) return StatusFindings;
  Table table;
  Json rows = Json::array();
  if (!netlists.rows.empty()) table.Add(TableRow("#", netlists.parameters, "netlist"));
  for (const Tarvo::KelNetlistRow& row : netlists.rows) {
    Json paths = Json::array();
    // A line for each netlist, so that scripts need not cut lists.
    for (const Tarvo::KelNetlist& netlist : row.netlists) {
      paths.push_back(Text(netlist.path));
      table.Add(TableRow(row.applies ? "*" : "", row.values, Text(netlist.path)));
    }
    rows.push_back({{"values", Texts(row.values)}, {"netlists", paths}, {"applies", row.applies}});
  }
  const Json parameters = Texts(netlists.parameters);
  WriteAnswer(request, {{"key", Text(ip.GetKey())}, {"parameters", parameters}, {"rows", rows}},
              table);
  return StatusClean;
}

Status AnswerList(const KelIP& ip, const Request& request) {
  Tarvo::StringList paths;
  if (!Ask(ip, &KelIP::ListNetlists, "netlists", paths)) return StatusFindings;
  Json netlists = Json::array();
  for (const Tarvo::StringBase& path : paths) {
    Tarvo::StringBase library;
    ip.GetNetlistProperty(path, KelIP::KEL_NETLIST_LIBRARY_PROPERTY, library);
    netlists.push_back({{"path", Text(path)}, {"library", Text(library)}});
  }
  WriteAnswer(request, {{"key", Text(ip.GetKey())}, {"netlists", netlists}},
              TableOf(netlists, {"path"}));
  // Asked again, since an empty list may also mean that the style has no netlists at all.
  Tarvo::StringList libraries;
  const bool hasTable = ip.ListNetlistLibraries(libraries);
  if (paths.empty() && hasTable) {
    Messages::Note("no netlist applies to these values; --table lists those for all values");
  }
  return StatusClean;
}

// Netlists for other values than those that were asked for would be a wrong answer, so there are
// none if a parameter is unknown.
Status Netlists(const Tarvo::KelLibrary& library, const Request& request) {
  const std::unique_ptr<KelIP> ip = OpenCore(library, request.Value("KEY"));
  if (!ip || !SetParameters(*ip, SettingsOf(request))) return StatusFindings;
  return request.Has("--table") ? AnswerTable(*ip, request) : AnswerList(*ip, request);
}

}  // namespace

Verb DescribeNetlists() {
  return {.name = "netlists",
          .help = "Lists the netlists of a core that apply",
          .words = {KeyWord(),
                    SetWord("Sets a parameter first; may be repeated"),
                    {.name = "--table",
                     .help = "List all of them with their values; * marks those that apply"},
                    NullWord()},
          .example = "netlists crc_unit --set WIDTH=16 --set MODE=FAST",
          .answer = Netlists};
}
