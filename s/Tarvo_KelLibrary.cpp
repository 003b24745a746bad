// The walk, and rows of guarded operations. The walk keeps to one rule: a version that is bad in
// any way costs nobody else an answer.

#include "Tarvo_KelLibrary.h"

#include <boost/filesystem.hpp>
#include <utility>

#include "Tarvo_Guard.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary_Utils.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_KnownProperties.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_PropertyList.h"
#include "Tarvo_Report.h"
#include "Tarvo_TellUnknown.h"
#include "Tarvo_VersionWalk.h"

namespace Tarvo {

namespace fs = boost::filesystem;

namespace {

constexpr Report::Module kModule{"s/Tarvo_KelLibrary", "1.0"};

}  // namespace

// What a library holds, and the walk that fills it.
class KelLibraryImpl {
 public:
  KelLibraryImpl();

  bool RefreshLibrary();

  Kel_Index index;
  StringList repositories;

 private:
  bool AddRepository(const StringBase& repository);
  bool AddVersion(VersionWalk::Version version);
};

KelLibraryImpl::KelLibraryImpl() { TARVO_TRACE("Constructing empty KEL Library\n"); }

// A repository without versions does not keep the later ones out; one that can't be read ends the
// walk.
bool KelLibraryImpl::RefreshLibrary() {
  const bool complete =
      Guard(NoOutput(),
            Failure(kModule, "Unable to analyse repository\n%s\n").With(ForUnknown::CutOff), [&] {
              index.ClearIP();
              bool all = true;
              for (const StringBase& repository : repositories) {
                all = AddRepository(repository) && all;
              }
              return all;
            });
  // Behind a failure too: what was found until then stays.
  TARVO_TRACE("  Detected %d valid cores (%d all versions)\n", index.GetBaseIPCount(),
              index.GetFullIPCount());
  return complete;
}

bool KelLibraryImpl::AddRepository(const StringBase& repository) {
  TARVO_TRACE("KEL Library: Analysing repository %s\n", repository);
  const fs::path versions =
      fs::path(repository.GetText()) / Kel_Index::KEL_VERSIONS_SUBDIRECTORY.GetText();
  if (!fs::is_directory(versions)) {
    Diagnosis::Add([&] { return TellNoRepository(repository); });
    kModule.Warning("Unable to add directory %s to library\n", repository);
    return false;
  }
  bool all = true;
  for (VersionWalk walk(versions); !walk.IsOver();) {
    // In this order of operands, so that a bad version keeps no other out.
    all = AddVersion(walk.Take()) && all;
  }
  return all;
}

// Passes over what is no version. A description that can't be read costs the version its options,
// and nobody else anything.
bool KelLibraryImpl::AddVersion(VersionWalk::Version version) {
  if (!version.MayBeOne()) return true;
  const Port::FileName& location = version.location;
  try {
    return index.AddIP(version.key, location, version.description, std::move(version.found));
  } catch (const AppException& exception) {
    kModule.Error("Invalid IP index entry %s at %s\n%s\n", version.key.GetKey(), location.GetName(),
                  exception.what());
    return true;
  }
}

KelLibrary::KelLibrary() : impl(std::make_unique<KelLibraryImpl>()) {}

KelLibrary::~KelLibrary() = default;

bool KelLibrary::SetRepositoryPath(const StringBase& path) {
  return Guard(
      NoOutput(),
      Failure(kModule, "Unable to set repository path to %s\n%s\n", path).With(ForUnknown::CutOff),
      [&] {
        TARVO_TRACE("KEL Library: Reading repository path %s\n", path);
        // Throws for a path with a bad piece, before anything is forgotten.
        impl->repositories = KelLibrary_Utils::GetPathVector(path);
        const bool complete = impl->RefreshLibrary();
        TARVO_TRACE("KEL Library: repository path set to %s\n", path);
        return complete;
      });
}

bool KelLibrary::RefreshLibrary() { return impl->RefreshLibrary(); }

StringBase KelLibrary::GetLocation(const StringBase& key) const {
  return GuardText(Failure(kModule, "Unable to get location for IP %s\n%s\n", key),
                   [&] { return impl->index.GetIPLocation(Kel_Key(key)).GetAbsolutePath(); });
}

StringBase KelLibrary::GetLatestIPKey(const StringBase& key) const {
  return GuardText(Failure(kModule, "Unable to get latest IP key for IP %s\n%s\n", key), [&] {
    // By the bare name, so that the key of an old version leads to the newest too.
    const Kel_Key core(Kel_Key(key).GetName());
    return impl->index.GetIPKey(core).GetKey();
  });
}

StringBase KelLibrary::GetName(const StringBase& key) const {
  return GuardText(Failure(kModule, "Unable to get name for IP %s\n%s\n", key),
                   [&] { return impl->index.GetIPKey(Kel_Key(key)).GetName(); });
}

StringBase KelLibrary::GetVersion(const StringBase& key) const {
  return GuardText(Failure(kModule, "Unable to get version for IP %s\n%s\n", key),
                   [&] { return impl->index.GetIPKey(Kel_Key(key)).GetVersion(); });
}

bool KelLibrary::GetIPProperty(const StringBase& key, const StringBase& property,
                               StringBase& value) const {
  return Guard(NoOutput(),
               Failure(kModule, "Unable to access IP %s property %s\n%s\n", key, property)
                   .With(ForUnknown::EmptyText),
               [&] {
                 value = OptionScanner::GetOptionValue(impl->index.GetIPOptions(Kel_Key(key)),
                                                       property);
               });
}

bool KelLibrary::ListIPProperties(const StringBase& key, StringList& list) const {
  return Guard(
      list,
      Failure(kModule, "Unable to access IP %s properties\n%s\n", key).With(ForUnknown::EmptyText),
      [&] { list = NamesOf(impl->index.GetIPOptions(Kel_Key(key))); });
}

bool KelLibrary::ListAllIPKeys(StringList& list) const {
  list = impl->index.GetAllIPKeys();
  return true;
}

// A question to the library like the others, though its answer needs none of it.
// NOLINTNEXTLINE(readability-convert-member-functions-to-static)
bool KelLibrary::ListAllIPProperties(StringList& list) const {
  list = NamesOf(KnownProperties::OfCores());
  return true;
}

KelIP* KelLibrary::CreateIP(const StringBase& key) const {
  std::unique_ptr<KelIP> instance;
  Guard(NoOutput(),
        Failure(kModule, "Unable to create IP %s\n%s\n", key).With(Severity::ErrorOrFatal),
        [&] { instance = std::make_unique<KelIP>(impl->index, key); });
  return instance.release();
}

const Kel_Index& KelLibrary::GetIndex() const { return impl->index; }

const StringList& KelLibrary::GetRepositories() const { return impl->repositories; }

}  // namespace Tarvo
