#include <gtest/gtest.h>

#include <string>

#include "Tarvo_LDXParser_Hdl.h"

namespace {

using namespace Tarvo;

// What becomes of a file entry: its language, place and missing extension, or the verdict.
std::string Place(const char* core, const char* language, const char* file) {
  const SourceLanguage placement = SettleLanguage(core, language, Port::FileName(file));
  std::string text = placement.assumed ? "assumed " : "";
  switch (placement.verdict) {
    case SourceLanguage::Settled:
      text += std::string(placement.language) + " " + placement.subdirectory.GetText();
      return text + (placement.missingExtension.GetLength() ? " ." : "") +
             placement.missingExtension.GetText();
    case SourceLanguage::UnknownLanguage:
      return text + "unknown";
    case SourceLanguage::LanguageOnBoth:
      return text + "on both";
    case SourceLanguage::AgainstExtension:
      return text + "against " + placement.language.GetText();
    case SourceLanguage::NeitherLanguageNorExtension:
      return text + "neither";
  }
  return "";
}

TEST(Hdl, SettlesLanguageAndPlace) {
  const char* const rows[][4] = {{"VHDL", "", "a.vhd", "VHDL vhdl"},
                                 {"VHDL", "", "sub/a", "VHDL vhdl .vhd"},
                                 {"vhdl", "", "a", "vhdl vhdl .vhd"},
                                 {"VHDL", "", "a.v", "against VHDL"},
                                 {"vhdl", "", "a.v", "against vhdl"},
                                 {"VHDL", "Verilog", "a.v", "Verilog verilog"},
                                 {"VHDL", "VERILOG", "a", "VERILOG verilog .v"},
                                 {"VHDL", "", "a.V", "VHDL vhdl"},
                                 {"Verilog", "", "a.v", "Verilog verilog"},
                                 {"VERILOG", "", "a.vh", "VERILOG verilog"},
                                 {"Verilog", "", "a.vhd", "against Verilog"},
                                 {"Verilog", "VHDL", "a.vhd", "VHDL vhdl"},
                                 {"Verilog", "VHDL", "a.v", "against VHDL"},
                                 {"Verilog", "", "", "Verilog verilog .v"},
                                 {"BOTH", "", "a.vhd", "VHDL vhdl"},
                                 {"both", "", "a.v", "Verilog verilog"},
                                 {"BOTH", "", "a", "neither"},
                                 {"BOTH", "", "a.vh", "neither"},
                                 {"Both", "VHDL", "a.vhd", "on both"},
                                 {"BOTH", "abc", "a.vhd", "unknown"},
                                 {"MIXED", "", "a.vhd", "assumed VHDL vhdl"},
                                 {"mixed", "", "a.v", "assumed against VHDL"},
                                 {"MIXED", "Verilog", "a.v", "Verilog verilog"},
                                 {"VHDL", "abc", "a.vhd", "unknown"},
                                 {"", "", "a.vhd", "VHDL vhdl"},
                                 {"", "", "a", "neither"},
                                 {"Other", "verilog", "a.vhd", "against verilog"},
                                 {"Other", "VHDL", "a", "VHDL vhdl .vhd"}};
  for (const auto& [core, language, file, expected] : rows) {
    EXPECT_EQ(Place(core, language, file), expected) << core << " " << language << " " << file;
  }
}

}  // namespace
