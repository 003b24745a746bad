// Cores are checked one after another, each within a collector of its own, so that one core's
// faults say nothing of another. What needs all cores, versions that clash and files that nobody
// lists, comes last.

#include "Tarvo_KelChecker.h"

#include <algorithm>
#include <boost/filesystem.hpp>
#include <iterator>
#include <new>
#include <set>
#include <tuple>
#include <utility>

#include "Tarvo_AppException.h"
#include "Tarvo_DescriptionChecker.h"
#include "Tarvo_Diagnosis.h"
#include "Tarvo_Existence.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_OrderChecker.h"
#include "Tarvo_TableChecker.h"
#include "Tarvo_TellUnknown.h"

namespace Tarvo {

using Diagnosis::Say;
using Port::FileName;

namespace {

namespace fs = boost::filesystem;

// By place, so that findings come in the order in which a reader of the files meets them.
auto Rank(const KelDiagnostic& diagnostic) {
  const KelPlace& place = diagnostic.place;
  return std::tie(place.file, place.line, place.column, diagnostic.code, diagnostic.text);
}

bool IsError(const KelDiagnostic& diagnostic) {
  return diagnostic.severity == KelDiagnostic::Error;
}

FileName DirectoryOf(const fs::path& path) {
  FileName directory;
  directory.SetHead(path.c_str());
  return directory;
}

void TellFile(const KelDiagnosticCode& code, const StringBase& file, const StringBase& text) {
  Diagnosis::Add([&] { return Diagnosis::Of(code, file, text); });
}

// Gives `visit` each entry of a directory. One that is not there has none; one that can't be read
// is told.
template <class Visit>
void ForEachEntry(const fs::path& directory, const Visit& visit) {
  boost::system::error_code error;
  fs::directory_iterator entry(directory, error);
  for (; !error && entry != fs::directory_iterator(); entry.increment(error)) visit(*entry);
  if (!error || error == boost::system::errc::no_such_file_or_directory) return;
  TellFile(Codes::kUnreadable, directory.c_str(),
           Say({"the directory can't be read: ", error.message()}));
}

// One call of a checker.
class CheckRun {
 public:
  explicit CheckRun(const KelLibrary& theLibrary)
      : library(theLibrary), index(library.GetIndex()), orders(index) {}

  void CheckCores(const StringList& keys, const KelChecker::Progress& progress);
  void CheckRepositories();
  void FindUnlisted(const StringList& keys);
  std::vector<KelDiagnostic> Finish();

 private:
  void CheckCore(const StringBase& text);
  static DescribedCore CheckDescriptionOf(const FileName& file);
  void CheckNetlists(const FileName& file, const Kel_Key& key, const DescribedCore& core);
  static void CheckRepository(const fs::path& versions);
  void FindUnlistedIn(const fs::path& directory, const std::set<std::string>& extensions);

  // Does the work, and gathers what is told meanwhile. Only then are messages left out: a caller's
  // function for the progress may ask the library as ever. True without errors.
  template <class Work>
  bool Collect(const Work& work);

  const KelLibrary& library;
  const Kel_Index& index;
  OrderChecker orders;
  std::vector<KelDiagnostic> found;
  std::set<StringBase> faulty;  // keys of cores with errors
};

template <class Work>
bool CheckRun::Collect(const Work& work) {
  DiagnosticCollector collector(DiagnosticCollector::InsteadOfMessages);
  work();
  // A check that lost something must not pass for a clean one.
  if (collector.isIncomplete) throw std::bad_alloc();
  const bool isGood = std::none_of(collector.found.begin(), collector.found.end(), IsError);
  std::move(collector.found.begin(), collector.found.end(), std::back_inserter(found));
  return isGood;
}

void CheckRun::CheckCores(const StringList& keys, const KelChecker::Progress& progress) {
  std::size_t done = 0;
  for (const StringBase& key : keys) {
    if (!Collect([&] { CheckCore(key); })) faulty.insert(key);
    if (progress) progress(++done, keys.size());
  }
  // Behind all cores, when all ways between them are known.
  Collect([&] { orders.CheckVersions(); });
}

// Files that the style calls for must be there. Where the style is not known, those that are there
// are checked.
void CheckRun::CheckCore(const StringBase& text) {
  Kel_Key key;
  FileName location;
  try {
    key = index.GetIPKey(Kel_Key(text));
    location = index.GetIPLocation(key);
  } catch (const AppException&) {
    // No file is to blame for a key that a caller made up.
    return TellFile(Codes::kUnknownLibrary, "", Say({"there is no core '", text.View(), "'"}));
  }
  const auto file = [&](const StringBase& extension) {
    return Kel_Index::GetDataFile(location, key, extension);
  };
  const DescribedCore core = CheckDescriptionOf(file(Kel_Index::KEL_QVR_EXTENSION));
  const auto check = [&](const KelDiagnosticCode& missing, const FileName& name, bool isNeeded,
                         const auto& checkFile) {
    if (core.isStyleKnown && !isNeeded) return;
    if (MayExist(name)) return checkFile(name);
    if (core.isStyleKnown) TellFile(missing, name.GetName(), "the file does not exist");
  };
  check(Codes::kMissingOrder, file(Kel_Index::KEL_LDX_EXTENSION), core.hasSources,
        [&](const FileName& name) { orders.Check(name, key, core.language); });
  check(Codes::kMissingTable, file(Kel_Index::KEL_TEW_EXTENSION), core.hasNetlists,
        [&](const FileName& name) { CheckNetlists(name, key, core); });
}

DescribedCore CheckRun::CheckDescriptionOf(const FileName& file) {
  DescribedCore unknown;
  unknown.isStyleKnown = false;
  if (!MayExist(file)) {
    TellFile(Codes::kMissingDescription, file.GetName(), "the file does not exist");
    return unknown;
  }
  try {
    return CheckDescription(file);
  } catch (const AppException&) {  // told as it could not be read
    return unknown;
  }
}

void CheckRun::CheckNetlists(const FileName& file, const Kel_Key& key, const DescribedCore& core) {
  try {
    for (const ListedNetlist& netlist : CheckTable(file, index, key, core)) {
      if (orders.IsThere(netlist.location)) continue;
      Diagnosis::Add([&] {
        return Diagnosis::AtPlace(
            Codes::kMissingNetlist, netlist.place,
            Say({"netlist does not exist: ",
                 ShortName(index, netlist.library, netlist.location).View()}));
      });
    }
  } catch (const AppException&) {  // told as it could not be read
    return;
  }
}

void CheckRun::CheckRepositories() {
  for (const StringBase& repository : library.GetRepositories()) {
    const fs::path versions =
        fs::path(repository.GetText()) / Kel_Index::KEL_VERSIONS_SUBDIRECTORY.GetText();
    boost::system::error_code error;
    const bool isThere = fs::is_directory(versions, error);
    Collect([&] {
      if (isThere) return CheckRepository(versions);
      Diagnosis::Add([&] { return TellNoRepository(repository); });
    });
  }
}

void CheckRun::CheckRepository(const fs::path& versions) {
  ForEachEntry(versions, [&](const fs::directory_entry& entry) {
    const Kel_Key key(StringBase(entry.path().filename().c_str()));
    if (key.IsValid()) return;
    // A stray directory is nobody's fault. One with data was meant for a version.
    const Existence data =
        LookForDirectory(DirectoryOf(entry.path() / Kel_Index::KEL_DATA_SUBDIRECTORY.GetText()));
    if (data == Existence::Yes) {
      TellFile(Codes::kNotAKey, entry.path().c_str(),
               "this directory is ignored: its name is not a key such as abc_v1_00_a");
    } else if (data == Existence::Unknown) {
      TellFile(Codes::kUnreadable, entry.path().c_str(), "the directory can't be read");
    }
  });
}

// What a core with errors has, it may be meant to list.
void CheckRun::FindUnlisted(const StringList& keys) {
  for (const StringBase& text : keys) {
    if (faulty.contains(text)) continue;
    const fs::path location = index.GetIPLocation(Kel_Key(text)).GetName().GetText();
    const fs::path hdl = location / Kel_Index::KEL_HDL_SUBDIRECTORY.GetText();
    Collect([&] {
      FindUnlistedIn(hdl / Kel_Index::KEL_VHDL_SUBDIRECTORY.GetText(), {".vhd", ".vhdl"});
      FindUnlistedIn(hdl / Kel_Index::KEL_VERILOG_SUBDIRECTORY.GetText(), {".v", ".sv"});
      // Netlists have many extensions, so any file counts there.
      FindUnlistedIn(location / Kel_Index::KEL_NETLIST_SUBDIRECTORY.GetText(), {});
    });
  }
}

// Without extensions, any file counts. Links to directories are not followed.
void CheckRun::FindUnlistedIn(const fs::path& directory, const std::set<std::string>& extensions) {
  // Compilers find include files by themselves, so orders don't list them.
  if (orders.IsIncludeDirectory(DirectoryOf(directory))) return;
  ForEachEntry(directory, [&](const fs::directory_entry& entry) {
    boost::system::error_code error;
    const fs::path& path = entry.path();
    const fs::file_type type = entry.symlink_status(error).type();
    if (type == fs::directory_file) return FindUnlistedIn(path, extensions);
    if (type == fs::status_error) {
      return TellFile(Codes::kUnreadable, path.c_str(),
                      Say({"the file can't be read: ", error.message()}));
    }
    if (!extensions.empty() && !extensions.contains(path.extension().string())) return;
    if (orders.IsListed(FileName(path.c_str()))) return;
    TellFile(Codes::kUnlistedFile, path.c_str(), "nothing lists this file");
  });
}

std::vector<KelDiagnostic> CheckRun::Finish() {
  std::stable_sort(found.begin(), found.end(),
                   [](const auto& left, const auto& right) { return Rank(left) < Rank(right); });
  // Both purposes of an order may tell the same.
  const auto last =
      std::unique(found.begin(), found.end(),
                  [](const auto& left, const auto& right) { return Rank(left) == Rank(right); });
  found.erase(last, found.end());
  return std::move(found);
}

}  // namespace

KelChecker::KelChecker(const KelLibrary& theLibrary) : library(theLibrary) {}

std::vector<KelDiagnostic> KelChecker::CheckCore(const StringBase& key) const {
  return CheckCores({key});
}

std::vector<KelDiagnostic> KelChecker::CheckCores(const StringList& keys,
                                                  const Progress& progress) const {
  CheckRun run(library);
  run.CheckCores(keys, progress);
  return run.Finish();
}

std::vector<KelDiagnostic> KelChecker::CheckLibrary(const Progress& progress) const {
  const StringList keys = library.GetIndex().GetAllVersionKeys();
  CheckRun run(library);
  run.CheckRepositories();
  run.CheckCores(keys, progress);
  run.FindUnlisted(keys);
  return run.Finish();
}

std::vector<KelDiagnosticCode> KelChecker::ListCodes() {
  std::vector<KelDiagnosticCode> codes;
  for (const KelDiagnosticCode* const code : Codes::kAll) codes.push_back(*code);
  return codes;
}

}  // namespace Tarvo
