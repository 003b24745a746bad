// The sources of one core lie in one or two directories, so what they share is worked out at the
// first of them and kept.

#include "Tarvo_SourceMaker.h"

#include <utility>

#include "Tarvo_FileKey.h"
#include "Tarvo_Kel_Index.h"

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
  origin.reset();
}

void SourceMaker::EnterDirectory(const SourceLanguage& settled) {
  // Sources of one file, library and language share what they have in common.
  if (!origin || origin->language != settled.language) {
    origin = std::make_shared<const AnalyseOrder::Origin>(
        AnalyseOrder::Origin{library, file, settled.language});
  }
  if (subdirectory == settled.subdirectory) return;
  FileName hdl = location;
  hdl.SetBase("");
  hdl.PushPathEnd(Kel_Index::KEL_HDL_SUBDIRECTORY);
  hdl.PushPathEnd(settled.subdirectory);
  subdirectory = settled.subdirectory;
  directory = hdl.GetHead();
  fileKeyPrefix = FileKey::OfLocation(hdl);
}

// A name with levels may lead to another directory of a language, so its file key is read off the
// whole location.
AnalyseOrder::Source SourceMaker::Make(const StringBase& text, const FileName& name,
                                       const SourceLanguage& settled,
                                       const AnalyseOrder::Mark& mark) {
  EnterDirectory(settled);
  AnalyseOrder::Source source{origin, name, fileKeyPrefix, {}, mark};
  const StringBase levels = name.GetPath();
  source.location.SetHead(directory);
  if (settled.missingExtension.GetLength() > 0) {
    source.location.SetExtension(settled.missingExtension);
  }
  if (levels.GetLength() > 0) {
    source.location.PushPathEnd(levels);
    source.fileKey = FileKey::OfLocation(source.location);
  } else {
    source.fileKey.Append(source.location.GetTail());
  }
  source.entryKey = FileKey::OfEntry(*library, text, settled.missingExtension);
  // They differ for odd names alone; see AnalyseOrder.
  if (source.entryKey == source.fileKey) source.entryKey.Empty();
  return source;
}

}  // namespace Tarvo
