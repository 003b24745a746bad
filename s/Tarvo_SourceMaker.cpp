// The sources of one core lie in one or two directories, so what they share is worked out at the
// first of them and kept.

#include "Tarvo_SourceMaker.h"

#include <utility>

#include "Tarvo_FileKey.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_OrderPart.h"

namespace Tarvo {

using Port::FileName;

void SourceMaker::EnterLibrary(std::string_view entered) {
  // Texts are compared, so that no key is made for an entry like the one before.
  if (library && libraryText.View() == entered) return;
  const StringBase asked(entered);
  auto key = std::make_shared<const Kel_Key>(index.GetIPKey(Kel_Key(asked)));
  location = index.GetIPLocation(*key);
  libraryText = asked;
  library = std::move(key);
  // What was worked out for the library before counts no more.
  subdirectory.Empty();
  origin = nullptr;
}

void SourceMaker::EnterDirectory(const SourceLanguage& settled) {
  if (subdirectory != settled.subdirectory) {
    FileName hdl = location;
    hdl.SetBase("");
    hdl.PushPathEnd(Kel_Index::KEL_HDL_SUBDIRECTORY);
    hdl.PushPathEnd(settled.subdirectory);
    subdirectory = settled.subdirectory;
    directory = hdl.GetHead();
    fileKeyPrefix = FileKey::OfLocation(hdl);
    isLibraryOdd = fileKeyPrefix != FileKey::OfEntry(*library, {}, {});
    origin = nullptr;
  }
  // Sources of one file, library and language share what they have in common.
  if (origin && origin->language == settled.language) return;
  origin = part.Keep({library, file, settled.language, directory});
}

AnalyseOrder::Source& SourceMaker::Make(const StringBase& text, const FileName& name,
                                        const SourceLanguage& settled,
                                        const AnalyseOrder::Mark& mark) {
  EnterDirectory(settled);
  AnalyseOrder::Source& source = MakeSource(text, name, settled.missingExtension);
  source.origin = origin;
  source.mark = mark;
  source.nameAt = fileKeyPrefix.GetLength();
  return source;
}

// A name without levels is a file of the language's directory, whichever way one looks at it. One
// with levels may lead elsewhere, so both its keys are made.
AnalyseOrder::Source& SourceMaker::MakeSource(const StringBase& text, const FileName& name,
                                              const StringBase& missingExtension) {
  if (isLibraryOdd || text.View().find('/') != std::string_view::npos) {
    return MakeOddSource(text, name, missingExtension);
  }
  fileKey = fileKeyPrefix;
  FileKey::AppendName(fileKey, text, missingExtension);
  return part.MakeSource(fileKey.View());
}

AnalyseOrder::Source& SourceMaker::MakeOddSource(const StringBase& text, const FileName& name,
                                                 const StringBase& missingExtension) {
  FileName full = name;
  const StringBase levels = name.GetPath();
  full.SetHead(directory);
  if (missingExtension.GetLength() > 0) full.SetExtension(missingExtension);
  full.PushPathEnd(levels);
  AnalyseOrder::Source& source = part.MakeSource(FileKey::OfLocation(full).View());
  StringBase entryKey = FileKey::OfEntry(*library, text, missingExtension);
  // They differ for odd names alone; see AnalyseOrder.
  if (entryKey.View() != source.fileKey) {
    source.odd = part.Keep(AnalyseOrder::OddName{std::move(full), std::move(entryKey)});
  }
  return source;
}

}  // namespace Tarvo
