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

const Language* LanguageOf(const StringBase& text) {
  for (const Language* language : {&kVerilog, &kVhdl}) {
    if (Matches(text, *language->name)) return language;
  }
  return nullptr;
}

const Language* LanguageOf(const Port::FileName& file) {
  for (const Language* language : {&kVerilog, &kVhdl}) {
    if (file.HasExtension(language->extension)) return language;
  }
  return nullptr;
}

}  // namespace

HdlPlacement PlaceSource(const StringBase& coreLanguage, const StringBase& language,
                         const Port::FileName& file) {
  HdlPlacement placement;
  placement.language = language;
  const auto refuse = [&](HdlPlacement::Verdict verdict) {
    placement.verdict = verdict;
    return placement;
  };
  if (language.GetLength() > 0) {
    if (!LanguageOf(language)) return refuse(HdlPlacement::UnknownLanguage);
    if (Matches(coreLanguage, LDXParser::LDX_HDL_BOTH)) return refuse(HdlPlacement::LanguageOnBoth);
  } else if (Matches(coreLanguage, LDXParser::LDX_HDL_MIXED)) {
    placement.assumed = true;
    placement.language = LDXParser::LDX_HDL_VHDL;
  } else if (LanguageOf(coreLanguage)) {
    placement.language = coreLanguage;
  }
  const Language* const declared = LanguageOf(placement.language);
  const Language* const shown = LanguageOf(file);
  if (declared && shown && declared != shown) return refuse(HdlPlacement::AgainstExtension);
  if (!declared && !shown) return refuse(HdlPlacement::NeitherLanguageNorExtension);
  const Language& settled = shown ? *shown : *declared;
  if (!declared) placement.language = *settled.name;
  placement.subdirectory = *settled.subdirectory;
  if (!file.HasExtension()) placement.missingExtension = settled.extension;
  return placement;
}

StringBase LanguageByExtension(const Port::FileName& file) {
  const Language* const language = LanguageOf(file);
  return language ? *language->name : StringBase();
}

}  // namespace Tarvo
