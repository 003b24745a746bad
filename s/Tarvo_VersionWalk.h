#ifndef TARVO_VERSIONWALK_H
#define TARVO_VERSIONWALK_H

#include <boost/filesystem.hpp>
#include <deque>
#include <exception>

#include "Port_FileName.h"
#include "Port_ReadAhead.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

// The entries of a directory of versions that have the name of one, in the order of the directory,
// each with its core description, which was looked for. On a slow disk the descriptions of the next
// ones are read ahead.
class VersionWalk {
 public:
  struct Version {
    // True for a directory, and for what can't be looked at. False for all else, as a file or a
    // link that leads nowhere or back to itself. Looks only where no description was found.
    bool MayBeOne() const;

    Kel_Key key;
    boost::filesystem::directory_entry entry;
    Port::FileName location;
    Port::FileName description;
    Port::FoundFile found;
  };

  // Throws boost::filesystem::filesystem_error if the directory can't be listed.
  explicit VersionWalk(const boost::filesystem::path& directory);

  // Whether nothing is left. Throws what listing the directory throws, behind the versions that
  // were listed until then.
  bool IsOver();
  // The next one; there must be one.
  Version Take();

 private:
  void ListAhead();

  boost::filesystem::directory_iterator entries;
  std::exception_ptr failure;    // of the listing
  std::deque<Version> versions;  // expected, but not looked for yet
  Port::ReadAhead descriptions;
};

}  // namespace Tarvo

#endif
