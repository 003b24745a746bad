#ifndef TARVO_LDXPARSER_HDL_H
#define TARVO_LDXPARSER_HDL_H

#include "Port_FileName.h"
#include "Tarvo_Export.h"

namespace Tarvo {

// The option of a core description that states the core's language.
inline constexpr char kLanguageOption[] = "HDL";

// The language of a core that states none, and of a source of a mixed core that gives none.
const StringBase& DefaultLanguage();

// What the language of a core, and the language and name that a file entry gives, say about the
// file: its language, and the directory of that language.
struct SourceLanguage {
  enum Verdict {
    Settled,
    UnknownLanguage,   // the entry's language is none
    LanguageOnBoth,    // the entry gives one although extensions alone decide in this core
    AgainstExtension,  // the file's extension is that of the other language
    NeitherLanguageNorExtension
  };

  Verdict verdict = Settled;
  // The core is a mixed one and the entry gives no language, so that the default was taken.
  bool assumed = false;
  // As the entry or the core writes it.
  StringBase language;
  // The language's subdirectory, and the extension that the file's name lacks. For a settled file.
  StringBase subdirectory;
  StringBase missingExtension;
};

// Texts of languages are compared in either letter case, extensions exactly. The language of the
// entry may be empty. Whether the file exists is not asked.
//
//     core       without a language           with one
//     VHDL       VHDL                         that one
//     Verilog    Verilog                      that one
//     MIXED      VHDL                         that one
//     BOTH       by the file's extension      refused
//     other      by the file's extension      that one
SourceLanguage SettleLanguage(const StringBase& coreLanguage, const StringBase& language,
                              const Port::FileName& file);

// The language that a file's extension tells, or empty.
StringBase LanguageByExtension(const Port::FileName& file);

}  // namespace Tarvo

#endif
