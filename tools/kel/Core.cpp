#include <fnmatch.h>

#include "Messages.h"
#include "Nearby.h"
#include "Tarvo_Kel_Key.h"
#include "Text.h"
#include "Verbs.h"

using Tarvo::KelIP;
using Tarvo::StringBase;

bool MatchesAny(const Tarvo::Kel_Key& key, const std::vector<std::string>& globs) {
  for (const std::string& glob : globs) {
    for (const StringBase* text : {&key.GetKey(), &key.GetName()}) {
      if (::fnmatch(glob.c_str(), text->GetText(), 0) == 0) return true;
    }
  }
  return globs.empty();
}

std::unique_ptr<KelIP> OpenCore(const Tarvo::KelLibrary& library, const Call& call) {
  std::unique_ptr<KelIP> ip(library.CreateIP(call.key.c_str()));
  if (!ip) SuggestKeys(library, call.key);
  return ip;
}

void WriteAnswer(const Table& table, const Json& members, bool asJson) {
  if (asJson) {
    WriteJson(members);
  } else {
    table.Write();
  }
}

bool HasNoneByStyle(const KelIP& ip, const char* what, int errors) {
  if (Messages::ErrorCount() != errors) return false;
  StringBase style;
  ip.GetIPProperty(KelIP::KEL_STYLE_OPTION_NAME, style);
  Messages::Note(Text(ip.GetKey()) + " has no " + what + " because its STYLE is '" + Text(style) +
                 "'");
  return true;
}
