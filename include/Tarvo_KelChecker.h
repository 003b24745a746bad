#ifndef TARVO_KELCHECKER_H
#define TARVO_KELCHECKER_H

#include <cstddef>
#include <functional>
#include <vector>

#include "Tarvo_Export.h"
#include "Tarvo_KelDiagnostic.h"

namespace Tarvo {

class KelLibrary;

// Finds what is wrong with the cores of a library, and what the library accepts but is probably a
// mistake: everything in one run, each thing once and at its place.
//
//     Tarvo::KelChecker checker(library);
//     for (const auto& found : checker.CheckCore("pulse_counter"))
//       std::cout << found.place.file << ':' << found.place.line << ": " << found.text << '\n';
//
// It reads the same files by the same rules as the library does, but goes on behind a bad line. So
// it finds the further faults too, and those of the analyse order and the netlist table where
// the description is bad. It issues no messages, writes nothing, and changes no answer of the
// library or of an instance; traces come as ever. Files are read anew by each call. While one runs,
// a trace sink must not ask the library.
//
// Results stand in the order of their files, lines and columns. The codes are listed by ListCodes.
//
// Failures: what can't be looked at or read is a diagnostic. Any operation may throw
// std::bad_alloc, and GetLocation's std::filesystem::filesystem_error if a repository was given
// relative to a current directory that is gone.
//
// Lifetime: the library must outlive the checker, and not be refreshed during a call. Threads: for
// one at a time, together with the library.
class TARVO_EXPORT KelChecker {
 public:
  // Told after each core how many of how many are done. It may ask the library and its instances;
  // what it throws ends the check and passes.
  using Progress = std::function<void(std::size_t done, std::size_t total)>;

  explicit KelChecker(const KelLibrary& library);

  // Checks one version, given by its key or bare name, with what its analyse order takes in from
  // others. An unknown key is a diagnostic without a place.
  std::vector<KelDiagnostic> CheckCore(const StringBase& key) const;

  // The same for several.
  std::vector<KelDiagnostic> CheckCores(const StringList& keys,
                                        const Progress& progress = {}) const;

  // Checks every version, those without a description too, and the repositories: directories that
  // look like cores except for their names, and files that no core lists.
  std::vector<KelDiagnostic> CheckLibrary(const Progress& progress = {}) const;

  // All codes that a diagnostic may have, in the order of the alphabet.
  static std::vector<KelDiagnosticCode> ListCodes();

 private:
  const KelLibrary& library;
};

}  // namespace Tarvo

#endif
