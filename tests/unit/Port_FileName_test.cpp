#include "Port_FileName.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <utility>

namespace {

using Port::FileName;

TEST(FileName, SplitsAndKeepsTheText) {
  // Head, path, tail and base, and whether there is an extension.
  const std::pair<const char*, const char*> rows[] = {{"", "||||"},
                                                      {"a.vhd", "||a.vhd|a|yes"},
                                                      {"sub/a", "sub|sub|a|a|"},
                                                      {"../x/a.b.v", "../x|../x|a.b.v|a.b|yes"},
                                                      {"/a.v", "/||a.v|a|yes"},
                                                      {"//x//a.v", "//x|x|a.v|a|yes"},
                                                      {"/x/", "/x|x|||"},
                                                      {"x.y/a", "x.y|x.y|a|a|"},
                                                      {"d/.profile", "d|d|.profile|.profile|"},
                                                      {"d/a.", "d|d|a.|a.|"},
                                                      {"..", "||..|..|"}};
  for (const auto& [text, expected] : rows) {
    const FileName name(text);
    std::string parts;
    for (const auto& part :
         {name.GetHead(false, false), name.GetPath(), name.GetTail(), name.GetBase()}) {
      parts += std::string(part) + "|";
    }
    EXPECT_EQ(parts + (name.HasExtension() ? "yes" : ""), expected) << text;
    EXPECT_EQ(name.GetName(), text);
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
  // The head, what is pushed, the name then, and what is popped.
  const char* const rows[][4] = {{"", "", "t", ""},
                                 {"", "a", "a/t", "a|"},
                                 {"/", "", "/t", ""},
                                 {"/", "a", "/a/t", "a|"},
                                 {"/r", "a/b", "/r/a/b/t", "b|a|r|"},
                                 {"r", "/a/", "r/a/t", "a|r|"},
                                 {"r//", "..//b", "r//..//b/t", "b|..|r|"}};
  for (const auto& [head, pushed, name, popped] : rows) {
    FileName file("t");
    file.SetHead(head);
    file.PushPathEnd(pushed);
    EXPECT_EQ(file.GetName(), name);
    std::string levels;
    for (auto level = file.PopPathEnd(); level.GetLength() > 0; level = file.PopPathEnd()) {
      levels += std::string(level) + "|";
    }
    EXPECT_EQ(levels + file.GetTail().GetText(), std::string(popped) + "t") << name;
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
