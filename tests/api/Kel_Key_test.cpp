#include <gtest/gtest.h>

#include <limits>
#include <string>

#include "Tarvo_Kel_Key.h"

namespace {

using Tarvo::Kel_Key;
using Tarvo::StringBase;
using namespace std::string_view_literals;

// All fields in one line.
std::string Dump(const Kel_Key& key) {
  return std::string(key.IsValid() ? "valid" : "bare") + " key=" + key.GetKey().GetText() +
         " name=" + key.GetName().GetText() + " version=" + key.GetVersion().GetText() + " " +
         std::to_string(key.GetMajorVersion()) + " " + std::to_string(key.GetMinorVersion()) + " " +
         key.GetRevision().GetText();
}

std::string Bare(const std::string& text) {
  return "bare key=" + text + " name=" + text + " version= 0 0 ";
}

TEST(Kel_Key, ReadsVersions) {
  const char* const rows[][2] = {
      {"abc_v1_00_a", "key=abc_v1_00_a name=abc version=1.00.a 1 0 a"},
      {"Abc_V12_34_B", "key=Abc_v12_34_b name=Abc version=12.34.b 12 34 b"},
      {"abc_v007_05_c", "key=abc_v007_05_c name=abc version=7.05.c 7 5 c"},
      {"abc_v1_00_a_v2_00_b", "key=abc_v1_00_a_v2_00_b name=abc_v1_00_a version=2.00.b 2 0 b"},
      {"abc_v1_v2_00_b", "key=abc_v1_v2_00_b name=abc_v1 version=2.00.b 2 0 b"},
      {"a b.c_v4294967295_99_z",
       "key=a b.c_v4294967295_99_z name=a b.c version=4294967295.99.z 4294967295 99 z"},
      {"__v1_00_a", "key=__v1_00_a name=_ version=1.00.a 1 0 a"}};
  for (const auto& [text, fields] : rows) {
    EXPECT_EQ(Dump(Kel_Key(text)), std::string("valid ") + fields);
  }
}

TEST(Kel_Key, TakesAllElseAsBareName) {
  for (const char* text :
       {"", "abc", "abc_v1_0_a", "abc_v1_000_a", "abc_v1_00_ab", "abc_v1_00_1", "abc_v1_00_a ",
        "abc_v1_00_a\n", "_v1_00_a", "abcv1_00_a", "abc_v_00_a", "abc_w1_00_a", "abc_v1_00",
        "abc_v4294967296_00_a", "abc_v99999999999999999999_00_a"}) {
    EXPECT_EQ(Dump(Kel_Key(StringBase(text))), Bare(text));
  }
  EXPECT_FALSE(Kel_Key(StringBase("abc_v1_00_a\0"sv)).IsValid());
  EXPECT_EQ(Dump(Kel_Key()), Bare(""));
}

TEST(Kel_Key, ReadsAnewIntoTheSameKey) {
  Kel_Key key(StringBase("abc_v1_00_a"));
  EXPECT_TRUE(key.ExtractVersion("_v2_00_b"));
  EXPECT_EQ(key.GetKey(), "abc_v1_00_a");
  EXPECT_TRUE(key.ExtractVersion(key.GetKey()));
  EXPECT_EQ(key.GetVersion(), "1.00.a");
  const Kel_Key& same = key;
  key = same;
  EXPECT_FALSE(key.ExtractVersion(key.GetName()));
  EXPECT_EQ(Dump(key), Bare("abc"));
  EXPECT_FALSE(key.ExtractVersion("_v2_00_b"));
  EXPECT_EQ(Dump(key), Bare("_v2_00_b"));
}

// The version as one number; whatever has none comes last.
long Rank(const Kel_Key& key) {
  if (!key.IsValid()) return std::numeric_limits<long>::max();
  return (key.GetMajorVersion() * 100L + key.GetMinorVersion()) * 256 + key.GetRevision()[0];
}

TEST(Kel_Key, OrdersByVersionAlone) {
  const char* const keys[] = {"",
                              "abc",
                              "xyz",
                              "abc_v1_00_a",
                              "xyz_v1_00_a",
                              "abc_v01_00_a",
                              "abc_V1_00_A",
                              "abc_v1_00_b",
                              "abc_v1_99_z",
                              "abc_v2_00_a",
                              "abc_v9_00_a",
                              "abc_v10_00_a",
                              "_v1_00_a"};
  for (const char* left : keys) {
    for (const char* right : keys) {
      const Kel_Key a(left), b(right);
      SCOPED_TRACE(Dump(a) + " against " + Dump(b));
      EXPECT_EQ(a < b, Rank(a) < Rank(b));
      EXPECT_EQ(a > b, Rank(a) > Rank(b));
      EXPECT_EQ(a == b, a.GetKey() == b.GetKey());
      EXPECT_EQ(a != b, !(a == b));
    }
  }
}

}  // namespace
