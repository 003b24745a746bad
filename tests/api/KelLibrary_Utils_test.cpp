#include <gtest/gtest.h>

#include <string>

#include "IndexedRepository.h"
#include "Outcome.h"
#include "Tarvo_KelLibrary_Utils.h"

namespace {

using namespace Tarvo;

TEST(KelLibrary_Utils, SplitsInterfaceNames) {
  const char* const rows[][2] = {{"", ""},
                                 {":::", ""},
                                 {"SLAVE0", "SLAVE0"},
                                 {"SLAVE0:SLAVE1", "SLAVE0, SLAVE1"},
                                 {":B::A:A: ;\"x", "B, A, A,  ;\"x"}};
  for (const auto& [text, names] : rows) {
    EXPECT_EQ(Join(KelLibrary_Utils::GetInterfaceVector(text)), names);
  }
}

TEST(KelLibrary_Utils, SplitsAndTestsPaths) {
  RepositoryBuilder directory;
  const std::string good = directory.Path(), bad = "failure: Invalid path directory ";
  directory.File("plain", "");
  const std::string rows[][2] = {{"", ""},
                                 {";;;", ""},
                                 {good + ";;" + good + "/;", good + ", " + good + "/"},
                                 {good + "; " + good, bad + " " + good + "\n"},
                                 {good + "/plain", bad + good + "/plain\n"},
                                 {good + ";%s;/nowhere", bad + "%s\n"},
                                 {good + ":" + good, bad + good + ":" + good + "\n"},
                                 {good + '\0' + "x", bad + good + "\n"}};
  for (const auto& row : rows) {
    const auto split = [&] {
      return Join(KelLibrary_Utils::GetPathVector(StringBase(std::string_view(row[0]))));
    };
    EXPECT_EQ(Outcome(split), row[1]);
  }
}

TEST(KelLibrary_Utils, KnowsNamesOfVhdlLibraries) {
  for (const char* good : {"a", "Uart_Lib2", "v1_00_a", "bus0", "vie", "ss", "work"}) {
    EXPECT_TRUE(KelLibrary_Utils::IsHdlLibrary(good)) << good;
  }
  for (const char* bad :
       {"", "_a", "a_", "a__b", "2a", "a b", "a-b", "\xE4", "abs", "XNOR", "view", "std", "IEEE"}) {
    EXPECT_FALSE(KelLibrary_Utils::IsHdlLibrary(bad)) << bad;
  }
}

}  // namespace
