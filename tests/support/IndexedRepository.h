#ifndef INDEXEDREPOSITORY_H
#define INDEXEDREPOSITORY_H

#include <string>

#include "Port_FileName.h"
#include "RepositoryBuilder.h"
#include "Tarvo_Kel_Index.h"

// The names with commas between.
inline std::string Join(const Tarvo::StringList& names) {
  std::string text;
  for (const Tarvo::StringBase& name : names) {
    text += (text.empty() ? "" : ", ") + std::string(name.View());
  }
  return text;
}

// A repository with the index of it, for tests of what stands on an index alone.
struct IndexedRepository {
  // Adds a core that stands in the repository, with the options that it has by now.
  bool Add(const std::string& key) {
    Port::FileName location;
    location.SetHead(repo.Core(key).Location().c_str());
    return index.AddIP(Tarvo::Kel_Key(Tarvo::StringBase(key.c_str())), location);
  }

  // The text without the path to `ipmods`, wherever that stands in it.
  std::string Shorten(std::string text) const {
    const std::string path = repo / "ipmods/";
    for (std::size_t at; (at = text.find(path)) != std::string::npos;) text.erase(at, path.size());
    return text;
  }
  std::string Shorten(const Tarvo::StringList& paths) const { return Shorten(Join(paths)); }

  RepositoryBuilder repo;
  Tarvo::Kel_Index index;
};

#endif
