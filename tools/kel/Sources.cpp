#include <iostream>
#include <memory>

#include "Messages.h"
#include "Table.h"
#include "Tarvo_KelIP.h"
#include "Text.h"
#include "Verbs.h"

namespace {

using Tarvo::KelIP;
using Tarvo::StringBase;
using Tarvo::StringList;

using Question = bool (KelIP::*)(StringList&) const;

// A core whose style has no such files gives an empty list, which is worth a word. Any other
// failure has its message.
void WriteList(const KelIP& ip, Question question, const char* what) {
  const int errors = Messages::ErrorCount();
  StringList paths;
  Table table;
  if ((ip.*question)(paths)) {
    for (const StringBase& path : paths) table.Add({Text(path)});
  } else if (Messages::ErrorCount() == errors) {
    StringBase style;
    ip.GetIPProperty(KelIP::KEL_STYLE_OPTION_NAME, style);
    std::cerr << "kel: note: " << ip.GetKey() << " has no " << what << ", its "
              << KelIP::KEL_STYLE_OPTION_NAME << " is '" << style << "'\n";
  }
  table.Write();
}

}  // namespace

Status Sources(const Tarvo::KelLibrary& library, const std::string& key, bool forSimulation) {
  const std::unique_ptr<KelIP> ip(library.CreateIP(key.c_str()));
  if (!ip) return StatusFindings;
  WriteList(*ip, forSimulation ? &KelIP::ListSimulationSources : &KelIP::ListSynthesisSources,
            "sources");
  return StatusClean;
}

// Netlists for other values than those that were asked for would be a wrong answer, so there are
// none if a parameter is unknown.
Status Netlists(const Tarvo::KelLibrary& library, const std::string& key,
                const std::vector<std::string>& settings) {
  const std::unique_ptr<KelIP> ip(library.CreateIP(key.c_str()));
  if (!ip) return StatusFindings;
  for (const std::string& setting : settings) {
    const std::size_t equals = setting.find('=');
    const std::string name = setting.substr(0, equals);
    const std::string value = setting.substr(equals + 1);
    if (!ip->SetParameterProperty(name.c_str(), "VALUE", value.c_str())) return StatusFindings;
  }
  WriteList(*ip, &KelIP::ListNetlists, "netlists");
  return StatusClean;
}
