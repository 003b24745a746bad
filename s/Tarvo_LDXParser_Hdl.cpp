// Which language a source is in. A table of two rows and a few rules, apart from files and
// messages.

#include "Tarvo_LDXParser_Hdl.h"

#include "Tarvo_Kel_Index.h"
#include "Tarvo_LDXParser.h"
#include "Tarvo_Word.h"

namespace Tarvo {

const StringBase LDXParser::LDX_HDL_VERILOG = "Verilog";
const StringBase LDXParser::LDX_HDL_VHDL = "VHDL";
const StringBase LDXParser::LDX_HDL_BOTH = "BOTH";
const StringBase LDXParser::LDX_HDL_MIXED = "MIXED";

namespace {

// What belongs to a language: a row for each.
struct Language {
  const StringBase* name;
  const char* extension;
  const StringBase* subdirectory;
};
const Language kVerilog{&LDXParser::LDX_HDL_VERILOG, "v", &Kel_Index::KEL_VERILOG_SUBDIRECTORY};
const Language kVhdl{&LDXParser::LDX_HDL_VHDL, "vhd", &Kel_Index::KEL_VHDL_SUBDIRECTORY};
const Language& kDefault = kVhdl;

const Language* LanguageOf(const StringBase& text) {
  for (const Language* language : {&kVerilog, &kVhdl}) {
    if (EqualsIgnoringCase(text, *language->name)) return language;
  }
  return nullptr;
}

// Exactly, unlike texts of languages: on disk a.VHD is another file than a.vhd.
const Language* LanguageOf(const Port::FileName& file) {
  for (const Language* language : {&kVerilog, &kVhdl}) {
    if (file.HasExtension(language->extension)) return language;
  }
  return nullptr;
}

}  // namespace

const StringBase& DefaultLanguage() { return *kDefault.name; }

SourceLanguage SettleLanguage(const StringBase& coreLanguage, const StringBase& language,
                              const Port::FileName& file) {
  SourceLanguage result;
  result.language = language;
  const auto refuse = [&](SourceLanguage::Verdict verdict) {
    result.verdict = verdict;
    return result;
  };
  if (language.GetLength() > 0) {
    if (!LanguageOf(language)) return refuse(SourceLanguage::UnknownLanguage);
    if (EqualsIgnoringCase(coreLanguage, LDXParser::LDX_HDL_BOTH))
      return refuse(SourceLanguage::LanguageOnBoth);
  } else if (EqualsIgnoringCase(coreLanguage, LDXParser::LDX_HDL_MIXED)) {
    result.assumed = true;
    result.language = *kDefault.name;
  } else if (LanguageOf(coreLanguage)) {
    result.language = coreLanguage;
  }
  const Language* const declared = LanguageOf(result.language);
  const Language* const shown = LanguageOf(file);
  // Declared is what the entry or the core says, shown what the extension does. They must agree, or
  // one of them be silent, but not both.
  if (declared && shown && declared != shown) return refuse(SourceLanguage::AgainstExtension);
  if (!declared && !shown) return refuse(SourceLanguage::NeitherLanguageNorExtension);
  // An extension that belongs to no language stays, so that the listed name is that of the file.
  const Language& settled = shown ? *shown : *declared;
  if (!declared) result.language = *settled.name;
  result.subdirectory = *settled.subdirectory;
  if (!file.HasExtension()) result.missingExtension = settled.extension;
  return result;
}

StringBase LanguageByExtension(const Port::FileName& file) {
  const Language* const language = LanguageOf(file);
  return language ? *language->name : StringBase();
}

}  // namespace Tarvo
