#ifndef TARVO_FILEKEY_H
#define TARVO_FILEKEY_H

#include "Port_FileName.h"
#include "Tarvo_Export.h"
#include "Tarvo_Kel_Key.h"

// The texts by which sources are told apart (see AnalyseOrder): library, blank, and the name below
// the language's directory.
namespace Tarvo::FileKey {

// What a location says: the version's directory stands for the library, and the nearest directory
// named `vhdl` or `verilog` for the language's. The relative path alone if there is none.
StringBase OfLocation(const Port::FileName& location);

// What an entry says: the file's name as written, but for an extension that it lacks.
StringBase OfEntry(const Kel_Key& library, const StringBase& file,
                   const StringBase& missingExtension);

// Appends a name as an entry writes it: up to a NUL byte, where its name on disk ends too.
void AppendName(StringBase& fileKey, const StringBase& file, const StringBase& missingExtension);

}  // namespace Tarvo::FileKey

#endif
