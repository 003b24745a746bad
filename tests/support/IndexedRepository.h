#ifndef INDEXEDREPOSITORY_H
#define INDEXEDREPOSITORY_H

#include <string>

#include "Port_FileName.h"
#include "RepositoryBuilder.h"
#include "Tarvo_Kel_Index.h"

// A repository with the index of it, for tests of what stands on an index alone.
struct IndexedRepository {
  // Adds a core that stands in the repository, with the options that it has by now.
  void Add(const std::string& key) {
    Port::FileName location;
    location.SetHead(repo.Core(key).Location().c_str());
    index.AddIP(Tarvo::Kel_Key(Tarvo::StringBase(key.c_str())), location);
  }

  // Paths below `ipmods`, with blanks between.
  std::string Shorten(const Tarvo::StringList& paths) const {
    std::string text;
    for (const Tarvo::StringBase& path : paths) {
      text += (text.empty() ? "" : " ") + std::string(path).substr((repo / "ipmods/").size());
    }
    return text;
  }

  RepositoryBuilder repo;
  Tarvo::Kel_Index index;
};

#endif
