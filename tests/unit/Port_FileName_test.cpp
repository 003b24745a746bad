#include "Port_FileName.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace {

using Port::FileName;

TEST(FileName, SplitsAndKeepsTheText) {
  struct Row {
    const char* name;
    const char* head;
    const char* path;
    const char* tail;
    const char* base;
    bool extended;
  };
  const Row rows[] = {{"", "", "", "", "", false},
                      {"a.vhd", "", "", "a.vhd", "a", true},
                      {"sub/a", "sub", "sub", "a", "a", false},
                      {"../x/a.b.v", "../x", "../x", "a.b.v", "a.b", true},
                      {"/a.v", "/", "", "a.v", "a", true},
                      {"//x//a.v", "//x", "x", "a.v", "a", true},
                      {"/x/", "/x", "x", "", "", false},
                      {"x.y/a", "x.y", "x.y", "a", "a", false},
                      {"d/.profile", "d", "d", ".profile", ".profile", false},
                      {"d/a.", "d", "d", "a.", "a.", false},
                      {"..", "", "", "..", "..", false}};
  for (const Row& row : rows) {
    SCOPED_TRACE(row.name);
    const FileName name(row.name);
    EXPECT_EQ(name.GetName(), row.name);
    EXPECT_EQ(name.GetHead(false, false), row.head);
    EXPECT_EQ(name.GetPath(), row.path);
    EXPECT_EQ(name.GetTail(), row.tail);
    EXPECT_EQ(name.GetBase(), row.base);
    EXPECT_EQ(name.HasExtension(), row.extended);
  }
}

TEST(FileName, ComparesExtensionsExactly) {
  EXPECT_TRUE(FileName("a.v").HasExtension("v"));
  EXPECT_FALSE(FileName("a.vhd").HasExtension("v"));
  EXPECT_FALSE(FileName("a.v").HasExtension("vhd"));
  EXPECT_FALSE(FileName("a.V").HasExtension("v"));
  EXPECT_FALSE(FileName("a").HasExtension(""));
}

TEST(FileName, BuildsTheNamesOfDataFiles) {
  FileName file;
  file.SetHead("/lib/ipmods/a.b_v1_00_a");
  file.PushPathEnd("data");
  file.SetBase("a.b_v2_1_0");
  file.SetExtension("qvr");
  EXPECT_EQ(file.GetName(), "/lib/ipmods/a.b_v1_00_a/data/a.b_v2_1_0.qvr");
  file.SetBase("c");
  EXPECT_EQ(file.GetTail(), "c");
  file.SetTail("sub/deep/a.edn");
  EXPECT_EQ(file.GetName(), "/lib/ipmods/a.b_v1_00_a/data/sub/deep/a.edn");
  EXPECT_EQ(file.GetTail(), "a.edn");
}

// What is pushed comes back level by level, down to the root or to nothing.
TEST(FileName, PushesAndPopsLevels) {
  struct Row {
    const char* head;
    const char* pushed;
    const char* name;
    const char* popped;
  };
  const Row rows[] = {{"", "", "t", ""},
                      {"", "a", "a/t", "a|"},
                      {"/", "", "/t", ""},
                      {"/", "a", "/a/t", "a|"},
                      {"/r", "a/b", "/r/a/b/t", "b|a|r|"},
                      {"r", "/a/", "r/a/t", "a|r|"},
                      {"r//", "..//b", "r//..//b/t", "b|..|r|"}};
  for (const Row& row : rows) {
    SCOPED_TRACE(row.name);
    FileName file("t");
    file.SetHead(row.head);
    file.PushPathEnd(row.pushed);
    EXPECT_EQ(file.GetName(), row.name);
    std::string popped;
    for (auto level = file.PopPathEnd(); level.GetLength() > 0; level = file.PopPathEnd()) {
      popped += std::string(level) + "|";
    }
    EXPECT_EQ(popped, row.popped);
    EXPECT_EQ(file.PopPathEnd(), "");
    EXPECT_EQ(file.GetTail(), "t");
  }
}

TEST(FileName, MakesPathsAbsoluteAndNormal) {
  const std::string here = std::filesystem::current_path();
  EXPECT_EQ(FileName("/a/../b//c").GetAbsolutePath(false), "/a/../b//c");
  EXPECT_EQ(FileName("./a").GetAbsolutePath(false).View(), here + "/./a");
  EXPECT_EQ(FileName("/a/./../b//c.v").Normalize(true), "/b/c.v");
  EXPECT_EQ(FileName("a/../../b").Normalize(true), "../b");
}

}  // namespace
