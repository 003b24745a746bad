#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "Outcome.h"
#include "Tarvo_Kel_Index.h"

namespace {

using namespace Tarvo;
using Port::FileName;
using testing::ElementsAre;

Kel_Key Key(const std::string& text) { return Kel_Key(StringBase(text.c_str())); }

FileName Directory(const std::string& path) {
  FileName location;
  location.SetHead(path.c_str());
  return location;
}

class Index : public testing::Test, protected IndexedRepository {
 protected:
  std::string At(const std::string& key) const { return repo / "ipmods/" + key; }

  // The key that is found for a key and its directory below `ipmods`, or the two exceptions.
  std::string Look(const std::string& key) const {
    const std::string found = Outcome([&] { return index.GetIPKey(Key(key)).GetKey(); });
    return Shorten(found + " " + Outcome([&] { return index.GetIPLocation(Key(key)).GetName(); }));
  }

  MessageRecorder recorder{MessageRecorder::MessagesAndTraces};
};

TEST_F(Index, FindsVersionsAndTheNewest) {
  for (const char* key : {"abc_v1_00_a", "abc_v2_00_a", "Abc_v9_00_a"}) EXPECT_TRUE(Add(key));
  const char* const rows[][2] = {{"abc_v1_00_a", "abc_v1_00_a abc_v1_00_a"},
                                 {"abc_V1_00_A", "abc_v1_00_a abc_v1_00_a"},
                                 {"abc", "abc_v2_00_a abc_v2_00_a"},
                                 {"Abc", "Abc_v9_00_a Abc_v9_00_a"}};
  for (const auto& [key, found] : rows) EXPECT_EQ(Look(key), found);
  for (const std::string key : {"abc_v3_00_a", "abc_v01_00_a", "xyz", ""}) {
    EXPECT_EQ(Look(key), "not found: Cannot find IP key for " + key +
                             "\n not found: Cannot find IP index entry for " + key + "\n");
  }
  EXPECT_EQ(index.GetBaseIPCount(), 0U);  // none has options
  EXPECT_EQ(index.GetFullIPCount(), 0U);
}

TEST_F(Index, AnswersTheSameInAnyOrderOfAdding) {
  std::vector<std::string> keys = {"abc_v1_00_a",  "abc_v1_00_b", "abc_v1_01_a",
                                   "abc_v10_00_a", "abc_v9_00_a", "xyz_v1_00_a"};
  std::sort(keys.begin(), keys.end());
  do {
    index.ClearIP();
    for (const std::string& key : keys) ASSERT_TRUE(Add(key));
    ASSERT_EQ(Look("abc"), "abc_v10_00_a abc_v10_00_a");
    for (const std::string& key : keys) ASSERT_EQ(Look(key), key + " " + key);
  } while (std::next_permutation(keys.begin(), keys.end()));
}

// Of equal versions, the one added later stands in front, and each is found by its own text.
TEST_F(Index, KeepsEqualVersionsApart) {
  for (const char* key : {"abc_v1_00_a", "abc_v01_00_a", "abc_v001_00_a"}) EXPECT_TRUE(Add(key));
  EXPECT_EQ(Look("abc"), "abc_v001_00_a abc_v001_00_a");
  EXPECT_EQ(Look("abc_v01_00_a"), "abc_v01_00_a abc_v01_00_a");
}

TEST_F(Index, KnowsWhatTheFirstLocationHides) {
  for (const char* key : {"abc_v1_00_a", "abc_v2_00_a", "xyz_v1_00_a"}) EXPECT_TRUE(Add(key));
  EXPECT_TRUE(index.AddIP(Key("abc_v2_00_a"), Directory(repo.Path())));
  EXPECT_TRUE(index.AddIP(Key("abc_v2_00_a"), Directory("/")));
  EXPECT_EQ(Look("abc_v2_00_a"), "abc_v2_00_a abc_v2_00_a");
  const auto hidden = index.GetHiddenLocations(Key("abc"));
  ASSERT_EQ(hidden.size(), 2U);
  EXPECT_EQ(hidden[0].GetName(), repo.Path().c_str());
  EXPECT_EQ(hidden[1].GetName(), "/");
  EXPECT_TRUE(index.GetHiddenLocations(Key("abc_v1_00_a")).empty());
  EXPECT_TRUE(index.GetHiddenLocations(Key("nope")).empty());
  EXPECT_EQ(Join(index.GetAllVersionKeys()), "abc_v1_00_a, abc_v2_00_a, xyz_v1_00_a");
  index.ClearIP();
  EXPECT_TRUE(Add("abc_v2_00_a"));
  EXPECT_TRUE(index.GetHiddenLocations(Key("abc")).empty());
  EXPECT_EQ(Join(index.GetAllVersionKeys()), "abc_v2_00_a");
}

TEST_F(Index, TellsWhatItAddsAndRefuses) {
  repo.File("plain", "");
  EXPECT_TRUE(Add("abc_v1_00_a"));
  EXPECT_TRUE(index.AddIP(Key("abc_V1_00_A"), Directory(repo / "plain")));
  EXPECT_FALSE(index.AddIP(Key("xyz"), Directory(repo.Path())));
  EXPECT_FALSE(index.AddIP(Key("xyz_V1_00_A"), Directory("/nowhere/at/all")));
  EXPECT_EQ(Look("xyz").substr(0, 10), "not found:");
  const std::string own = At("abc_v1_00_a"), invalid = "error s/Tarvo_Kel_Index: Invalid ";
  EXPECT_THAT(recorder.Take(),
              ElementsAre("trace: Unable to define options for IP abc_v1_00_a at " + own + "\n",
                          "trace: Library IP abc_v1_00_a found at " + own + "\n",
                          "trace: Duplicate IP index entry abc_v1_00_a at " + repo / "plain" +
                              "\nPrecedence given to " + own + "\n",
                          "trace: Library IP abc_v1_00_a found at " + repo / "plain" + "\n",
                          invalid + "IP index entry xyz at " + repo.Path() + "\n",
                          invalid + "IP index entry xyz_v1_00_a at /nowhere/at/all\n"));
}

TEST(Layout, NamesTheDataFiles) {
  const FileName file = Kel_Index::GetDataFile(Directory("/r/ipmods/a.b_v1_00_a"),
                                               Key("a.b_v1_00_a"), Kel_Index::KEL_TEW_EXTENSION);
  EXPECT_EQ(file.GetName(), "/r/ipmods/a.b_v1_00_a/data/a.b_v2_1_0.tew");
  EXPECT_EQ(
      Join({Kel_Index::KEL_VERSION, Kel_Index::KEL_QVR_EXTENSION, Kel_Index::KEL_LDX_EXTENSION,
            Kel_Index::KEL_TEW_EXTENSION, Kel_Index::KEL_DATA_SUBDIRECTORY,
            Kel_Index::KEL_NETLIST_SUBDIRECTORY, Kel_Index::KEL_HDL_SUBDIRECTORY,
            Kel_Index::KEL_VHDL_SUBDIRECTORY, Kel_Index::KEL_VERILOG_SUBDIRECTORY}),
      "_v2_1_0, qvr, ldx, tew, data, netlist, hdl, vhdl, verilog");
}

}  // namespace
