#ifndef TARVO_TELLUNKNOWN_H
#define TARVO_TELLUNKNOWN_H

#include <string_view>

#include "Tarvo_Export.h"
#include "Tarvo_KelDiagnostic.h"

namespace Tarvo {

class FileScanner;
class Kel_Index;

// "did you mean X?", with the words that are near to a text, or empty.
StringBase DidYouMean(std::string_view text, const StringList& words);

// The word that a text is misspelt for, or empty if it is that word or is hardly meant for one.
// Short texts must fit but for letter case.
StringBase FindMisspelt(std::string_view text, const StringList& words);

// A part of the present line names a core that is not in the index. The hint names those that are
// near, or the core's versions if only the version is unknown.
KelDiagnostic TellUnknownLibrary(const FileScanner& lines, const Kel_Index& index,
                                 std::string_view library);

// A part of the present line should name one of these parameters.
KelDiagnostic TellUnknownParameter(const FileScanner& lines, std::string_view name,
                                   const StringList& parameters);

// A directory without a subdirectory for versions was given as a repository.
KelDiagnostic TellNoRepository(const StringBase& directory);

}  // namespace Tarvo

#endif
