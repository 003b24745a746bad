#include "Json.h"
#include "Messages.h"
#include "NetlistTable.h"
#include "Table.h"
#include "Text.h"
#include "Verbs.h"

namespace {

using Tarvo::KelIP;

// False, with a warning, for a parameter that the core does not have.
bool SetParameters(KelIP& ip, const std::vector<std::string>& settings) {
  for (const std::string& setting : settings) {
    const std::size_t equals = setting.find('=');
    const std::string name = setting.substr(0, equals);
    const std::string value = setting.substr(equals + 1);
    if (!ip.SetParameterProperty(name.c_str(), "VALUE", value.c_str())) return false;
  }
  return true;
}

void WriteTable(const KelIP& ip, const NetlistTable& netlists, bool asJson) {
  Table table;
  Json rows = Json::array();
  if (!netlists.rows.empty()) {
    Table::Row head = {"#"};
    head.insert(head.end(), netlists.parameters.begin(), netlists.parameters.end());
    head.emplace_back("netlist");
    table.Add(head);
  }
  for (const NetlistTable::Row& row : netlists.rows) {
    rows.push_back({{"values", row.values}, {"netlists", row.netlists}, {"applies", row.applies}});
    for (const std::string& netlist : row.netlists) {
      Table::Row fields = {row.applies ? "*" : ""};
      fields.insert(fields.end(), row.values.begin(), row.values.end());
      fields.push_back(netlist);
      table.Add(fields);
    }
  }
  if (asJson) {
    WriteJson({{"key", Text(ip.GetKey())}, {"parameters", netlists.parameters}, {"rows", rows}});
  } else {
    table.Write();
  }
}

void WriteList(const KelIP& ip, const Tarvo::StringList& paths, bool asJson) {
  Table table;
  Json netlists = Json::array();
  for (const Tarvo::StringBase& path : paths) {
    table.Add({Text(path)});
    Tarvo::StringBase library;
    ip.GetNetlistProperty(path, KelIP::KEL_NETLIST_LIBRARY_PROPERTY, library);
    netlists.push_back({{"path", Text(path)}, {"library", Text(library)}});
  }
  if (asJson) {
    WriteJson({{"key", Text(ip.GetKey())}, {"netlists", netlists}});
  } else {
    table.Write();
  }
}

}  // namespace

// Netlists for other values than those that were asked for would be a wrong answer, so there are
// none if a parameter is unknown.
Status Netlists(const Tarvo::KelLibrary& library, const Call& call) {
  const std::unique_ptr<KelIP> ip = OpenCore(library, call);
  if (!ip || !SetParameters(*ip, call.settings)) return StatusFindings;
  Tarvo::StringList paths;
  if (!AskForFiles(*ip, &KelIP::ListNetlists, "netlists", paths)) return StatusFindings;
  if (call.wholeTable) {
    WriteTable(*ip, ReadNetlistTable(*ip), call.asJson);
  } else {
    WriteList(*ip, paths, call.asJson);
    Tarvo::StringList libraries;
    const bool hasTable = ip->ListNetlistLibraries(libraries);
    if (paths.empty() && hasTable) {
      Messages::Note("no netlist applies at these values; --table shows which would");
    }
  }
  return StatusClean;
}
