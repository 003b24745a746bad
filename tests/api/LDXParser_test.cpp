// What an analyse order answers beyond the cases of Readers_test, and the laws that it keeps.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "OrdinaryUser.h"
#include "Outcome.h"
#include "Tarvo_LDXParser.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;

class AnalyseOrder : public testing::Test, protected IndexedRepository {
 protected:
  RepositoryBuilder::CoreBuilder Core(const std::string& key, const std::string& ldx) {
    auto core = repo.Core(key);
    core.Ldx(ldx);
    Add(key);
    return core;
  }
  LDXParser Parse(const std::string& key, const char* root = "") {
    return LDXParser(index, Kel_Key(StringBase(key.c_str())), Kel_Key(root), "VHDL");
  }
  // The sources for synthesis below `ipmods`, or what is thrown.
  std::string Read(const std::string& key, const char* root = "") {
    return Shorten(Outcome([&] { return Join(Parse(key, root).ListSynthesisAnalyseOrder()); }));
  }
  // The same for a file that is taken for the core's own.
  std::string ReadOther(const std::string& name, const char* key, const char* root = "") {
    return Shorten(Outcome([&] {
      const Port::FileName file((repo / name).c_str());
      const LDXParser order(file, index, Kel_Key(key), Kel_Key(root), "VHDL");
      return Join(order.ListSynthesisAnalyseOrder());
    }));
  }

  MessageRecorder recorder;
};

// Each byte of a long path is looked at once.
TEST_F(AnalyseOrder, TakesPathsOfAnyLength) {
  std::string path;
  for (int i = 0; i < 200000; ++i) path += "d/";
  Core("a_v1_00_a", "lib a " + path + "a.vhd\nlib a " + path + "b.vhd");
  const LDXParser order = Parse("a");
  const Port::FileName last(order.ListSynthesisAnalyseOrder().back());
  EXPECT_EQ(order.GetFileLibrary(last).GetKey(), "a_v1_00_a");
}

TEST_F(AnalyseOrder, AnswersForSourcesAndDirectories) {
  Core("sub_v1_00_a", "vlgincdir sub_v1_00_a data\nsimlib sub s.v Verilog");
  Core("far_v1_00_a", "");
  Core("top_v1_00_a", "lib sub all\nlib top_v1_00_a d/vhdl/a.vhd\nlib top_v1_00_a b.vhd");
  const LDXParser order = Parse("top_v1_00_a");
  const std::string verilog = repo / "ipmods/sub_v1_00_a/hdl/verilog/s.v";
  const char* const libraries[][2] = {{verilog.c_str(), "sub_v1_00_a"},
                                      {"top_v1_00_a/anything/verilog/b.vhd", "top_v1_00_a"},
                                      {"top_v1_00_a/hdl/vhdl/nothing.vhd", ""},
                                      {"top_v1_00_a/hdl/vhdl/d/vhdl/a.vhd", ""},
                                      {"b.vhd", ""},
                                      {"vhdl/b.vhd", ""},
                                      {"top_v1_00_a/hdl/VHDL/b.vhd", ""},
                                      {"", ""}};
  for (const auto& [file, library] : libraries)
    EXPECT_EQ(order.GetFileLibrary(Port::FileName(file)).GetKey(), library) << file;
  const char* const languages[][2] = {
      {"a.v", "Verilog"}, {"/x/a.vhd", "VHDL"}, {"a.V", ""}, {"a.vh", ""}, {"", ""}};
  for (const auto& [file, language] : languages)
    EXPECT_EQ(order.GetFileLanguage(Port::FileName(file)), language);
  const char* const directories[][2] = {{"sub_v1_00_a", "sub_v1_00_a/data"},
                                        {"sub", "sub_v1_00_a"},
                                        {"far", "far_v1_00_a"},
                                        {"no", "not found: Cannot find IP index entry for no\n"}};
  for (const char* const(&row)[2] : directories) {
    EXPECT_EQ(Shorten(Outcome([&] { return order.GetVerilogIncludeLocation(row[0]); })), row[1]);
  }
}

// What is tested is what is given out, as the system resolves it: a step back from a link leads to
// where its target lies. The version's directory may be a link too.
TEST_F(AnalyseOrder, FollowsLinksToIncludeDirectories) {
  repo.File("far/inc/x", "");
  repo.File("far/core/data/abc_v2_1_0.ldx", "");
  fs::create_directory(repo / "ipmods");
  fs::create_directory_symlink(repo / "far/core", repo / "ipmods/abc_v1_00_a");
  const std::pair<const char*, bool> rows[] = {
      {"../inc", true},          {"data/../../inc", true}, {"../inc/../core/data", true},
      {"../abc_v1_00_a", false}, {"none/../hdl", false},   {"link/../hdl", false},
      {"link/../x", false},      {"link/..", true}};
  Core("abc_v1_00_a", "").File("hdl/y", "");
  fs::create_directory_symlink(repo / "far/inc", repo / "far/core/link");
  for (const auto& [directory, exists] : rows) {
    Core("abc_v1_00_a", std::string("vlgincdir abc ") + directory);
    ASSERT_EQ(Read("abc_v1_00_a").empty(), exists) << directory;
    if (!exists) continue;
    const StringBase given = Parse("abc_v1_00_a").GetVerilogIncludeLocation("abc");
    EXPECT_TRUE(fs::is_directory(given.GetText())) << given;
  }
}

// A file that is read in the name of another core is none of that core's own.
TEST_F(AnalyseOrder, ReadsAnyFileForACore) {
  Core("abc_v1_00_a", "lib abc_v1_00_a a.vhd\nlib xyz_v1_00_a all");
  Core("xyz_v1_00_a", "lib xyz_v1_00_a x.vhd");
  repo.File("other", "lib abc_v1_00_a all\nlib abc_v1_00_a b.vhd");
  EXPECT_EQ(ReadOther("other", "abc_v1_00_a", "xyz_v2_00_a"),
            "abc_v1_00_a/hdl/vhdl/a.vhd, abc_v1_00_a/hdl/vhdl/b.vhd, xyz_v1_00_a/hdl/vhdl/x.vhd");
  const std::string refused = "failure: Invalid LDX " + repo / "other" + "\n";
  EXPECT_EQ(ReadOther("other", "abc_v1_00_a"), refused);
  EXPECT_EQ(ReadOther("other", "abc_v1_00_a", "xyz_v1_00_a"), refused);
  EXPECT_EQ(Read("abc"), "abc_v1_00_a/hdl/vhdl/a.vhd, xyz_v1_00_a/hdl/vhdl/x.vhd");
  // By its bare name the root's core may be included, by its key never.
  repo.File("twice", "lib abc all\nlib abc_v1_00_a all");
  EXPECT_EQ(ReadOther("twice", "abc_v1_00_a"), "failure: Invalid LDX " + repo / "twice" + "\n");
}

// A core that is read again, for its warnings, adds nothing: not even what was written meanwhile.
TEST_F(AnalyseOrder, KeepsWhatItReadFirst) {
  const std::string known = "lib a a.vhd\nlib a a.vhd";
  Core("a_v1_00_a", known);
  Core("n_v1_00_a", "lib n n.vhd");
  Core("b_v1_00_a", "lib a all");
  Core("top_v1_00_a", "lib a all\nlib b all");
  const auto previous = Port_MsgManData::setHandler(
      [&](const Port_Message&) { repo.Core("a_v1_00_a").Ldx(known + "\nlib a x.vhd\nlib n all"); });
  EXPECT_EQ(Read("top_v1_00_a"), "a_v1_00_a/hdl/vhdl/a.vhd");
  Port_MsgManData::setHandler(previous);
}

// The root is told by the text of its key alone; all else is left to the levels between.
TEST_F(AnalyseOrder, KnowsItsRoot) {
  const std::string source = "a_v1_00_a/hdl/vhdl/a.vhd";
  Core("a_v1_00_a", "lib a a.vhd");
  Core("b_v1_00_a", "lib a all");
  EXPECT_EQ(Read("a", "a_v1_00_a"), source);
  EXPECT_EQ(Read("b", "a_v1_00_a"), source);
  EXPECT_EQ(ReadOther("ipmods/b_v1_00_a/data/b_v2_1_0.ldx", "none"), source);
  fs::remove_all(repo / "ipmods/a_v1_00_a/data");  // before its file is looked for
  for (const char* key : {"a_v1_00_a", "unknown_v1_00_a"}) {
    EXPECT_EQ(Read(key, key), std::string("failure: Circular LDX definition for ") + key + "\n");
  }
}

TEST_F(AnalyseOrder, FollowsChainsDownToTheirLimit) {
  constexpr int limit = 1000;
  const auto name = [](int i) { return "c" + std::to_string(i); };
  for (int i = 0; i < limit; ++i) {
    const std::string next = i + 1 < limit ? "lib " + name(i + 1) + " all\n" : "";
    Core(name(i) + "_v1_00_a", next + (i % 333 == 0 ? "lib " + name(i) + " a.vhd" : ""));
  }
  const std::string source = "_v1_00_a/hdl/vhdl/a.vhd";
  EXPECT_EQ(Read("c0_v1_00_a"),
            "c999" + source + ", c666" + source + ", c333" + source + ", c0" + source);
  EXPECT_THAT(recorder.Take(), testing::IsEmpty());
  Core("top_v1_00_a", "lib c0 all");
  EXPECT_EQ(Read("top_v1_00_a"), "failure: Invalid LDX top_v1_00_a/data/top_v2_1_0.ldx\n");
  const auto messages = recorder.Take();
  EXPECT_EQ(messages.size(), 2000U);
  EXPECT_EQ(messages.front(),
            "error s/Tarvo_LDXParser: Unable to analyse library c999\n"
            "LDX definition for c999_v1_00_a nested below 1000 others\n\n");
  // What was read at a higher level is not taken for what nests too deep.
  Core("deep_v1_00_a", "lib c1 all\nlib c0 all");
  EXPECT_EQ(Read("deep_v1_00_a"), "failure: Invalid LDX deep_v1_00_a/data/deep_v2_1_0.ldx\n");
}

// With each of these layers the ways double; nobody could wait for a core that is read for each.
TEST_F(AnalyseOrder, ReadsALadderOnce) {
  constexpr int layers = 40;
  for (int i = 0; i < 2 * layers; ++i) {
    const std::string core = "c" + std::to_string(i);
    const int next = i - i % 2 + 2;
    std::string ldx = "lib " + core + " a.vhd";
    for (int j = next; next < 2 * layers && j < next + 2; ++j)
      ldx += "\nlib c" + std::to_string(j) + " all";
    Core(core + "_v1_00_a", ldx);
  }
  EXPECT_EQ(Parse("c0_v1_00_a").ListSynthesisAnalyseOrder().size(), 2 * layers - 1U);
}

TEST_F(AnalyseOrder, RefusesWhatIsShut) {
  const std::string data = Core("abc_v1_00_a", "").Location() + "/data";
  fs::permissions(data, fs::perms::none);
  {
    const OrdinaryUser user;
    EXPECT_EQ(Read("abc"), "failure: Cannot read file abc_v1_00_a/data/abc_v2_1_0.ldx\n");
  }
  fs::permissions(data, fs::perms::all);
}

}  // namespace
