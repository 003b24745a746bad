#include <fnmatch.h>

#include <filesystem>

#include "Messages.h"
#include "Nearby.h"
#include "Tarvo_Kel_Key.h"
#include "Text.h"
#include "Verbs.h"

namespace fs = std::filesystem;
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

std::unique_ptr<KelIP> OpenCore(const Tarvo::KelLibrary& library, const Call& call) {
  std::unique_ptr<KelIP> ip(library.CreateIP(call.key.c_str()));
  if (!ip) SuggestKeys(call, call.key);
  return ip;
}

std::vector<VersionDirectory> VersionDirectories(const Call& call) {
  std::vector<VersionDirectory> directories;
  for (const std::string& repository : Repositories(call)) {
    std::error_code error;
    const fs::path versions = fs::absolute(repository) / "ipmods";
    for (fs::directory_iterator entry(versions, error), end; !error && entry != end;
         entry.increment(error)) {
      const Tarvo::Kel_Key key(StringBase(entry->path().filename().c_str()));
      std::error_code ignored;
      if (key.IsValid() && entry->is_directory(ignored)) {
        directories.push_back({key, entry->path()});
      }
    }
  }
  return directories;
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
