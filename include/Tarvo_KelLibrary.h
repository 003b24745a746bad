#ifndef TARVO_KELLIBRARY_H
#define TARVO_KELLIBRARY_H

#include <memory>

#include "Tarvo_Export.h"

namespace Tarvo {

class KelIP;
class KelLibraryImpl;
class Kel_Index;

// The front door: finds the IP cores in a list of repositories and answers questions about them.
//
//     Tarvo::KelLibrary library;
//     library.SetRepositoryPath("project/ip;company/ip");
//     std::cout << library.GetLocation("abc") << '\n';
//
// A repository is a directory with a subdirectory `ipmods`, which holds one directory for each
// version of each core, named by its key (see Kel_Key). Nothing else of it is read by a walk, and
// nothing is ever written.
//
// Wherever a key is asked for, it is the text of a version, such as "abc_v1_00_a", or a bare core
// name, which stands for the newest version of that core.
//
// Failures: what goes wrong in an operation is issued as a message (see Port_MsgManData), and the
// result says so. Only the constructor and the operations that say so throw; and a text that is
// given as `const char*` becomes a string at the call, which may throw std::bad_alloc there.
//
// Lifetime: the caller owns the library. Threads: for one at a time; separate libraries may work in
// separate threads.
class TARVO_EXPORT KelLibrary {
 public:
  // An empty library. Nothing is read, neither from disk nor from the environment.
  KelLibrary();
  ~KelLibrary();
  KelLibrary(const KelLibrary&) = delete;
  KelLibrary& operator=(const KelLibrary&) = delete;

  // Reads the repositories of a path, directories split at ";". Of a version that stands in more
  // than one, the first counts.
  //
  // True if every repository was read. False, with an error, if a piece of the path is no
  // directory: then the library goes on answering from the repositories it had. False, too, if a
  // repository has no `ipmods` (a warning), if a version can't be looked at or if reading a
  // directory fails (errors): then what was found stays usable. A core description that can't be
  // read or parsed is an error too, but costs only that version its options and leaves the result
  // true. Directories whose names are no keys are passed over in silence.
  bool SetRepositoryPath(const StringBase& path);

  // Reads the same repositories again. The result is that of SetRepositoryPath; the path itself is
  // not tested again.
  bool RefreshLibrary();

  // The absolute directory of a version. Empty, with an error, for a key that is not in the
  // library; so are the other queries.
  StringBase GetLocation(const StringBase& key) const;

  // The full key of the newest version of the core that the key names, whether the version that it
  // names exists or not, and whether the newest has options or not. A base name that is itself a
  // key is looked up as that version.
  StringBase GetLatestIPKey(const StringBase& key) const;

  // The base name of a version's core, and its version as dotted text such as "1.00.a".
  StringBase GetName(const StringBase& key) const;
  StringBase GetVersion(const StringBase& key) const;

  // The value of an option of a version. True with an empty value for an option that is not there,
  // where KelIP::GetIPProperty is false. False, with an error and the value untouched, for a key
  // without options: one that is not in the library, or whose core description is missing or could
  // not be read.
  bool GetIPProperty(const StringBase& key, const StringBase& property, StringBase& value) const;

  // Replaces the list by the names of a version's options: NAME, VERSION, those of the description
  // in its order, and the defaults that it leaves out. False, with an error and an empty list, for
  // a key without options.
  bool ListIPProperties(const StringBase& key, StringList& list) const;

  // Replaces the list by the keys of all versions that have options, in the order of their
  // bytes. Always true; may throw std::bad_alloc.
  bool ListAllIPKeys(StringList& list) const;

  // Replaces the list by the names of all options that have a meaning, whatever the repositories
  // hold. Always true; may throw std::bad_alloc.
  bool ListAllIPProperties(StringList& list) const;

  // Opens a version (see KelIP). The caller owns the instance and deletes it before the library.
  // Null, with an error, for a key that is not in the library, and if the core description is
  // missing or bad. The message is fatal for an AppException of that level.
  KelIP* CreateIP(const StringBase& key) const;

  // The index that the library answers from, and the repositories as the path gave them, in their
  // order. Both change with the next walk.
  const Kel_Index& GetIndex() const;
  const StringList& GetRepositories() const;

 private:
  std::unique_ptr<KelLibraryImpl> impl;
};

}  // namespace Tarvo

#endif
