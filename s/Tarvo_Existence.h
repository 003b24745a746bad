#ifndef TARVO_EXISTENCE_H
#define TARVO_EXISTENCE_H

#include <boost/filesystem.hpp>

#include "Port_FileName.h"

namespace Tarvo {

// Whether something of that name exists. What can't be asked for, as behind a directory without
// permission, counts as missing.
inline bool Exists(const Port::FileName& name) {
  boost::system::error_code error;
  return boost::filesystem::exists(name.GetName().GetText(), error);
}

// The same, but what can't be asked for may well be there: reading it then tells what is wrong. A
// name that is too long for a file is known to be missing.
inline bool MayExist(const Port::FileName& file) {
  boost::system::error_code error;
  const auto status = boost::filesystem::status(file.GetName().GetText(), error);
  return status.type() != boost::filesystem::file_not_found &&
         error != boost::system::errc::filename_too_long;
}

}  // namespace Tarvo

#endif
