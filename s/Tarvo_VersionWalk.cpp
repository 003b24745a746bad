// The listing runs ahead of the walk by as many versions as are read ahead: by one on a fast disk.

#include "Tarvo_VersionWalk.h"

#include <utility>

#include "Tarvo_Kel_Index.h"

namespace Tarvo {

namespace fs = boost::filesystem;

bool VersionWalk::Version::MayBeOne() const {
  if (found.GetExistence() == Port::Existence::Yes) return true;
  namespace errc = boost::system::errc;
  boost::system::error_code error;
  const fs::file_status status = entry.status(error);
  if (status.type() != fs::status_error) return fs::is_directory(status);
  return error != errc::too_many_symbolic_link_levels;
}

VersionWalk::VersionWalk(const fs::path& directory) : entries(directory) {}

bool VersionWalk::IsOver() {
  ListAhead();
  if (versions.empty() && failure) std::rethrow_exception(failure);
  return versions.empty();
}

// A look at the name costs nothing; only what may be a version is looked at on disk.
void VersionWalk::ListAhead() {
  try {
    for (; descriptions.HasRoom() && entries != fs::directory_iterator(); ++entries) {
      Kel_Key key(StringBase(entries->path().filename().c_str()));
      if (!key.IsValid()) continue;
      Port::FileName location;
      // The whole path as a directory: a name with a dot is not to be split.
      location.SetHead(entries->path().c_str());
      Port::FileName description =
          Kel_Index::GetDataFile(location, key, Kel_Index::KEL_QVR_EXTENSION);
      std::string name(description.GetName().View());
      versions.push_back(
          {std::move(key), *entries, std::move(location), std::move(description), {}});
      descriptions.Expect(std::move(name));
    }
  } catch (...) {
    failure = std::current_exception();
    entries = {};
    // Each has its description expected, or is none.
    if (versions.size() > descriptions.CountExpected()) versions.pop_back();
  }
}

VersionWalk::Version VersionWalk::Take() {
  Version version = std::move(versions.front());
  versions.pop_front();
  version.found = descriptions.Take();
  return version;
}

}  // namespace Tarvo
