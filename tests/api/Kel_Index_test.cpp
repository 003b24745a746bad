#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <new>
#include <string>
#include <vector>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "RepositoryBuilder.h"
#include "Tarvo_AppException.h"
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

// What a lookup of the key gives: the key found and its location, or the two exceptions.
std::string Look(const Kel_Index& index, const std::string& key) {
  std::string result;
  const auto add = [&](const auto& lookup) {
    try {
      result += lookup();
    } catch (const AppException& exception) {
      result += std::to_string(exception.level) + " " + exception.what();
    }
  };
  add([&] { return std::string(index.GetIPKey(Key(key)).GetKey()) + " "; });
  add([&] { return std::string(index.GetIPLocation(Key(key)).GetName()); });
  return result;
}

class Index : public testing::Test {
 protected:
  bool Add(const std::string& key) {
    return index.AddIP(Key(key), Directory(repo.Core(key).Location()));
  }
  std::string At(const std::string& key) const { return repo / "ipmods/" + key; }

  RepositoryBuilder repo;
  Kel_Index index;
  MessageRecorder recorder{MessageRecorder::MessagesAndTraces};
};

TEST_F(Index, FindsVersionsAndTheNewest) {
  for (const char* key : {"abc_v1_00_a", "abc_v2_00_a", "Abc_v9_00_a"}) EXPECT_TRUE(Add(key));
  EXPECT_EQ(Look(index, "abc_v1_00_a"), "abc_v1_00_a " + At("abc_v1_00_a"));
  EXPECT_EQ(Look(index, "abc_V1_00_A"), "abc_v1_00_a " + At("abc_v1_00_a"));
  EXPECT_EQ(Look(index, "abc"), "abc_v2_00_a " + At("abc_v2_00_a"));
  EXPECT_EQ(Look(index, "Abc"), "Abc_v9_00_a " + At("Abc_v9_00_a"));
  for (const std::string key : {"abc_v3_00_a", "abc_v01_00_a", "xyz", ""}) {
    EXPECT_EQ(Look(index, key), "0 Cannot find IP key for " + key +
                                    "\n0 Cannot find IP index entry for " + key + "\n");
  }
  EXPECT_EQ(index.GetBaseIPCount(), 0U);
  EXPECT_EQ(index.GetFullIPCount(), 0U);
  index.ClearIP();
  EXPECT_THROW(index.GetIPKey(Key("abc")), AppException);
}

TEST_F(Index, AnswersTheSameInAnyOrderOfAdding) {
  std::vector<std::string> keys = {"abc_v1_00_a",  "abc_v1_00_b", "abc_v1_01_a",
                                   "abc_v10_00_a", "abc_v9_00_a", "xyz_v1_00_a"};
  std::sort(keys.begin(), keys.end());
  do {
    index.ClearIP();
    for (const std::string& key : keys) ASSERT_TRUE(Add(key));
    ASSERT_EQ(index.GetIPKey(Key("abc")).GetKey(), "abc_v10_00_a");
    for (const std::string& key : keys) ASSERT_EQ(Look(index, key), key + " " + At(key));
  } while (std::next_permutation(keys.begin(), keys.end()));
}

TEST_F(Index, KeepsWhatItHasWhenMemoryIsShort) {
  ASSERT_TRUE(Add("abc_v1_00_a"));
  const Kel_Key key = Key("abc_v2_00_a");
  const FileName location = Directory(repo.Core("abc_v2_00_a").Location());
  bool isShort = true;
  for (int count = 0; isShort; ++count) {
    try {
      const AllocationFault fault(count, AllocationFault::BadAlloc);
      index.AddIP(key, location);
    } catch (const std::bad_alloc&) {  // some are turned into messages
    }
    isShort = AllocationFault::Fired();
    ASSERT_EQ(Look(index, "abc_v1_00_a"), "abc_v1_00_a " + At("abc_v1_00_a")) << count;
  }
  EXPECT_EQ(Look(index, "abc"), "abc_v2_00_a " + At("abc_v2_00_a"));
}

// Of equal versions, the one added later stands in front, and each is found by its own text.
TEST_F(Index, KeepsEqualVersionsApart) {
  for (const char* key : {"abc_v1_00_a", "abc_v01_00_a", "abc_v001_00_a"}) EXPECT_TRUE(Add(key));
  EXPECT_EQ(Look(index, "abc"), "abc_v001_00_a " + At("abc_v001_00_a"));
  EXPECT_EQ(Look(index, "abc_v01_00_a"), "abc_v01_00_a " + At("abc_v01_00_a"));
  EXPECT_TRUE(index.AddIP(Key("abc_v1_00_a"), Directory(repo.Path())));
  EXPECT_EQ(Look(index, "abc_v1_00_a"), "abc_v1_00_a " + At("abc_v1_00_a"));
}

TEST_F(Index, KnowsWhatTheFirstLocationHides) {
  for (const char* key : {"abc_v1_00_a", "abc_v2_00_a", "xyz_v1_00_a"}) EXPECT_TRUE(Add(key));
  EXPECT_TRUE(index.AddIP(Key("abc_v2_00_a"), Directory(repo.Path())));
  EXPECT_TRUE(index.AddIP(Key("abc_v2_00_a"), Directory("/")));
  const auto hidden = index.GetHiddenLocations(Key("abc"));
  ASSERT_EQ(hidden.size(), 2U);
  EXPECT_EQ(hidden[0].GetName(), repo.Path().c_str());
  EXPECT_EQ(hidden[1].GetName(), "/");
  EXPECT_TRUE(index.GetHiddenLocations(Key("abc_v1_00_a")).empty());
  EXPECT_TRUE(index.GetHiddenLocations(Key("nope")).empty());
  EXPECT_THAT(index.GetAllVersionKeys(), ElementsAre("abc_v1_00_a", "abc_v2_00_a", "xyz_v1_00_a"));
  index.ClearIP();
  EXPECT_TRUE(index.GetAllVersionKeys().empty());
}

TEST_F(Index, TellsWhatItAdds) {
  EXPECT_TRUE(Add("abc_v1_00_a"));
  EXPECT_TRUE(index.AddIP(Key("abc_V1_00_A"), Directory(repo.Path())));
  EXPECT_THAT(recorder.Take(),
              ElementsAre("trace: Unable to define options for IP abc_v1_00_a at " +
                              At("abc_v1_00_a") + "\n",
                          "trace: Library IP abc_v1_00_a found at " + At("abc_v1_00_a") + "\n",
                          "trace: Duplicate IP index entry abc_v1_00_a at " + repo.Path() +
                              "\nPrecedence given to " + At("abc_v1_00_a") + "\n",
                          "trace: Library IP abc_v1_00_a found at " + repo.Path() + "\n"));
}

TEST_F(Index, RefusesWhatItCannotUse) {
  EXPECT_FALSE(index.AddIP(Key("abc"), Directory(repo.Path())));
  EXPECT_FALSE(index.AddIP(Key("abc_V1_00_A"), Directory("/nowhere/at/all")));
  EXPECT_THAT(
      recorder.Take(),
      ElementsAre("error s/Tarvo_Kel_Index: Invalid IP index entry abc at " + repo.Path() + "\n",
                  "error s/Tarvo_Kel_Index: Invalid IP index entry abc_v1_00_a at "
                  "/nowhere/at/all\n"));
  EXPECT_THROW(index.GetIPKey(Key("abc")), AppException);
  repo.File("plain", "");
  EXPECT_TRUE(index.AddIP(Key("abc_v1_00_a"), Directory(repo / "plain")));
}

TEST(Layout, NamesTheDataFiles) {
  const FileName file = Kel_Index::GetDataFile(Directory("/r/ipmods/a.b_v1_00_a"),
                                               Key("a.b_v1_00_a"), Kel_Index::KEL_TEW_EXTENSION);
  EXPECT_EQ(file.GetName(), "/r/ipmods/a.b_v1_00_a/data/a.b_v2_1_0.tew");
  std::string all;
  for (const StringBase* text :
       {&Kel_Index::KEL_VERSION, &Kel_Index::KEL_QVR_EXTENSION, &Kel_Index::KEL_LDX_EXTENSION,
        &Kel_Index::KEL_TEW_EXTENSION, &Kel_Index::KEL_DATA_SUBDIRECTORY,
        &Kel_Index::KEL_NETLIST_SUBDIRECTORY, &Kel_Index::KEL_HDL_SUBDIRECTORY,
        &Kel_Index::KEL_VHDL_SUBDIRECTORY, &Kel_Index::KEL_VERILOG_SUBDIRECTORY}) {
    all += std::string(*text) + " ";
  }
  EXPECT_EQ(all, "_v2_1_0 qvr ldx tew data netlist hdl vhdl verilog ");
}

}  // namespace
