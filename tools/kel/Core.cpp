#include <fnmatch.h>

#include "Messages.h"
#include "Nearby.h"
#include "Tarvo_Kel_Key.h"
#include "Text.h"
#include "Verbs.h"

using Tarvo::KelIP;
using Tarvo::StringBase;
using Tarvo::StringList;

bool MatchesAny(const Tarvo::Kel_Key& key, const std::vector<std::string>& globs) {
  for (const std::string& glob : globs) {
    for (const StringBase* text : {&key.GetKey(), &key.GetName()}) {
      if (::fnmatch(glob.c_str(), text->GetText(), 0) == 0) return true;
    }
  }
  return globs.empty();
}

std::unique_ptr<KelIP> OpenCore(const Tarvo::KelLibrary& library, const std::string& key) {
  std::unique_ptr<KelIP> ip(library.CreateIP(key.c_str()));
  if (!ip) SuggestKeys(library, key);
  return ip;
}

bool AskForFiles(const KelIP& ip, bool (KelIP::*question)(StringList&) const, const char* what,
                 StringList& paths) {
  const int errors = Messages::ErrorCount();
  if ((ip.*question)(paths)) return true;
  if (Messages::ErrorCount() != errors) return false;
  StringBase style;
  ip.GetIPProperty(KelIP::KEL_STYLE_OPTION_NAME, style);
  Messages::Note(Text(ip.GetKey()) + " has no " + what + ", its STYLE is '" + Text(style) + "'");
  return true;
}
