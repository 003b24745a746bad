#include "Nearby.h"

#include <algorithm>
#include <numeric>
#include <set>
#include <vector>

#include "Messages.h"
#include "Tarvo_Kel_Key.h"
#include "Text.h"
#include "Verbs.h"

namespace {

using Tarvo::Kel_Key;
using Tarvo::StringBase;

// How many letters must be added, left out or changed to make one text of the other.
std::size_t Distance(const std::string& left, const std::string& right) {
  std::vector<std::size_t> row(right.size() + 1);
  std::iota(row.begin(), row.end(), 0U);
  for (const char letter : left) {
    std::size_t diagonal = row[0]++;
    for (std::size_t j = 0; j < right.size(); ++j) {
      const std::size_t change = diagonal + (letter == right[j] ? 0 : 1);
      diagonal = row[j + 1];
      row[j + 1] = std::min({change, row[j] + 1, diagonal + 1});
    }
  }
  return row.back();
}

// A third of the letters may be wrong, and a name that goes on behind the text is near as well.
bool IsNear(const std::string& name, const std::string& text) {
  if (text.empty()) return false;
  return name.rfind(text, 0) == 0 ||
         Distance(name, text) <= std::max<std::size_t>(1, text.size() / 3);
}

std::string Join(const std::set<std::string>& texts) {
  std::string joined;
  for (const std::string& text : texts) joined += (joined.empty() ? "" : ", ") + text;
  return joined;
}

}  // namespace

void SuggestKeys(const Call& call, const std::string& key) {
  const Kel_Key asked{StringBase(key.c_str())};
  StringBase wanted = asked.GetName();
  wanted.MakeLower();
  std::set<std::string> versions;
  std::set<std::string> names;
  for (const VersionDirectory& directory : VersionDirectories(call)) {
    StringBase name = directory.key.GetName();
    if (name == asked.GetName()) {
      if (!asked.IsValid() || directory.key == asked) return;
      versions.insert(Text(directory.key.GetKey()));
    }
    name.MakeLower();
    if (IsNear(Text(name), Text(wanted))) names.insert(Text(directory.key.GetName()));
  }
  if (!versions.empty()) {
    Messages::Note("the versions of this core are " + Join(versions));
  } else if (!names.empty()) {
    Messages::Note("a near name is " + Join(names));
  }
}
