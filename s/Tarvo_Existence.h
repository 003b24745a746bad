#ifndef TARVO_EXISTENCE_H
#define TARVO_EXISTENCE_H

#include <boost/filesystem.hpp>

#include "Port_File.h"
#include "Port_FileName.h"

namespace Tarvo {

using Port::Existence;

inline Existence LookFor(const Port::FileName& name) { return Port::File::LookFor(name.GetName()); }

// Whether something of that name is known to exist.
inline bool Exists(const Port::FileName& name) { return LookFor(name) == Existence::Yes; }

// Whether it is not known to be missing: reading it then tells what is wrong.
inline bool MayExist(const Port::FileName& name) { return LookFor(name) != Existence::No; }

// Whether it is known to be a plain file, or a link to one.
inline bool IsFile(const Port::FileName& name) {
  boost::system::error_code error;
  return boost::filesystem::is_regular_file(name.GetName().GetText(), error);
}

// What a look at the disk tells of a directory. A link that leads back to itself is none.
inline Existence LookForDirectory(const Port::FileName& name) {
  namespace errc = boost::system::errc;
  boost::system::error_code error;
  const auto status = boost::filesystem::status(name.GetName().GetText(), error);
  if (boost::filesystem::is_directory(status)) return Existence::Yes;
  const bool isKnown = status.type() != boost::filesystem::status_error ||
                       error == errc::too_many_symbolic_link_levels ||
                       error == errc::filename_too_long;
  return isKnown ? Existence::No : Existence::Unknown;
}

// Whether it is known to be a directory, or a link to one.
inline bool IsDirectory(const Port::FileName& name) {
  return LookForDirectory(name) == Existence::Yes;
}

}  // namespace Tarvo

#endif
