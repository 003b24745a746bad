#ifndef TARVO_SOURCEMAKER_H
#define TARVO_SOURCEMAKER_H

#include <memory>
#include <string_view>

#include "Port_FileName.h"
#include "Tarvo_AnalyseOrder.h"
#include "Tarvo_LDXParser_Hdl.h"

namespace Tarvo {

class Kel_Index;
class OrderPart;

// Makes the sources of a file's entries, one after another. An entry mostly shares library and
// language with the one before, so both are kept from one to the next.
class SourceMaker {
 public:
  SourceMaker(const Kel_Index& theIndex, std::shared_ptr<const StringBase> theFile,
              OrderPart& thePart)
      : index(theIndex), file(std::move(theFile)), part(thePart) {}

  // Goes to the library of an entry. Throws AppException for one that is not in the index; then
  // that of the entry before stays.
  void EnterLibrary(std::string_view entered);

  // The source of that name, given as text too, in the library that was entered last. The part
  // holds it.
  AnalyseOrder::Source& Make(const StringBase& text, const Port::FileName& name,
                             const SourceLanguage& settled, const AnalyseOrder::Mark& mark);

 private:
  void EnterDirectory(const SourceLanguage& settled);
  AnalyseOrder::Source& MakeSource(const StringBase& text, const Port::FileName& name,
                                   const StringBase& missingExtension);
  AnalyseOrder::Source& MakeOddSource(const StringBase& text, const Port::FileName& name,
                                      const StringBase& missingExtension);

  const Kel_Index& index;
  std::shared_ptr<const StringBase> file;
  OrderPart& part;
  StringBase libraryText;  // as its entry writes it
  std::shared_ptr<const Kel_Key> library;
  Port::FileName location;
  StringBase subdirectory;  // of the language
  StringBase directory;
  StringBase fileKeyPrefix;
  StringBase fileKey;         // kept for its memory
  bool isLibraryOdd = false;  // whether its directory is not named as its key
  const AnalyseOrder::Origin* origin = nullptr;
};

}  // namespace Tarvo

#endif
