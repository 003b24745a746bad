#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <random>
#include <string>
#include <vector>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "OrdinaryUser.h"
#include "Tarvo_AppException.h"
#include "Tarvo_LDXParser.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;

const std::string kLdx = "s/Tarvo_LDXParser: ";

class AnalyseOrder : public testing::Test, protected IndexedRepository {
 protected:
  RepositoryBuilder::CoreBuilder Core(const std::string& key, const std::string& ldx) {
    auto core = repo.Core(key);
    core.Ldx(ldx);
    Add(key);
    return core;
  }
  LDXParser Parse(const std::string& key, const char* hdl = "VHDL") {
    return LDXParser(index, Kel_Key(StringBase(key.c_str())), Kel_Key(), hdl);
  }
  // The same with the levels `hdl` left out.
  std::string Shorten(const StringList& paths) const {
    std::string text = IndexedRepository::Shorten(paths);
    for (std::size_t hdl; (hdl = text.find("/hdl/")) != std::string::npos;) text.erase(hdl, 4);
    return text;
  }
  // Both lists, once if they are equal, or what is thrown.
  std::string Read(const std::string& key, const char* hdl = "VHDL") {
    try {
      const LDXParser order = Parse(key, hdl);
      const std::string synthesis = Shorten(order.ListSynthesisAnalyseOrder());
      const std::string simulation = Shorten(order.ListSimulationAnalyseOrder());
      return synthesis == simulation ? synthesis : synthesis + " | " + simulation;
    } catch (const AppException& exception) {
      return std::to_string(exception.level) + " " + exception.what();
    }
  }
  std::string File(const std::string& key) const {
    return repo / "ipmods/" + key + "/data/" + key.substr(0, key.find('_')) + "_v2_1_0.ldx";
  }
  std::string Invalid(const std::string& key) const { return "1 Invalid LDX " + File(key) + "\n"; }
  std::string Unparsable(const std::string& key, const std::string& line,
                         const char* kind = "library", int number = 1) const {
    return "error " + kLdx + "LDX unparsable " + kind + " entry: " + File(key) + " line " +
           std::to_string(number) + ", " + line + "\n";
  }
  // The error of an include entry, and that of its line.
  static std::string Unable(const std::string& library, const std::string& why) {
    return "error " + kLdx + "Unable to analyse library " + library + "\n" + why + "\n";
  }

  MessageRecorder recorder;
};

TEST_F(AnalyseOrder, TakesLinesByTheirForm) {
  Core("xyz_v1_00_a", "lib xyz_v1_00_a x.vhd\nsimlib xyz_v1_00_a t.vhd");
  const std::string own = "abc_v1_00_a/vhdl/",
                    all = "xyz_v1_00_a/vhdl/x.vhd | xyz_v1_00_a/vhdl/x.vhd xyz_v1_00_a/vhdl/t.vhd";
  const std::string library = "library", path = "path";
  const std::string rows[][2] = {
      {"lib abc_v1_00_a abc.vhd", own + "abc.vhd"},
      {"lib ABC_V1_00_A abc.vhd", library},
      {"synlib abc_v1_00_a abc.vhd", own + "abc.vhd | "},
      {"simlib xyz_v1_00_a sub/m.v Verilog", " | xyz_v1_00_a/verilog/sub/m.v"},
      {"lib abc_v1_00_a abc_top verilog", "abc_v1_00_a/verilog/abc_top.v"},
      {"lib abc_v1_00_a \"my file.vhd\"", own + "my file.vhd"},
      {"lib abc_v1_00_a ( a b ).vhd", library},
      {"lib abc_v1_00_a ( a ) VHDL", own + "( a ).vhd"},
      {"lib abc_v1_00_a a(1),b:c=[2].vhd", own + "a(1),b:c=[2].vhd"},
      {"'lib'abc_v1_00_a'a.vhd'\"VHDL\"", own + "a.vhd"},
      {"lib abc_v1_00_a a.vh", own + "a.vh"},
      {"lib abc_v1_00_a ../x/a.vhd", own + "../x/a.vhd"},
      {"lib abc_v1_00_a ''", own + ".vhd"},
      {"lib xyz all", all},
      {"simlib xyz_v1_00_a ALL", all},
      {"synlib xyz_v1_00_a \"all\"", all},
      {"lib xyz_v1_00_a all vhdl", library},
      {"lib abc_v1_00_a abc.vhd vhdl extra", library},
      {"lib abc_v1_00_a", library},
      {"lib", library},
      {"LIB abc_v1_00_a abc.vhd", library},
      {"include abc_v1_00_a abc.vhd", library},
      {"vlgincdir xyz_v1_00_a hdl/verilog/inc", ""},
      {"vlgincdir 'abc' \"hdl/verilog\"", ""},
      {"vlgincdir abc_v1_00_a", path},
      {"vlgincdir", library},
      {"\"vlgincdir\" abc_v1_00_a hdl", library},
      {"VLGINCDIR abc_v1_00_a nowhere", ""},
      {"vlgincdir abc_v1_00_a hdl extra", ""},
      {"vlgincdir abc_v1_00_a hdl/none extra", path},
      {"vlgincdir abc_v1_00_a 'hdl", path},
      {"lib abc_v1_00_a \"abc.vhd", library},
      {"lib abc_v1_00_a ' # '", library},
      {"lib abc_v1_00_a abc.vhd \"", own + "abc.vhd"},
      {"lib abc_v1_00_a abc.vhd 'VHDL", own + "abc.vhd"},
      {"lib abc_v1_00_a abc.vhd ( VHDL )", ""},
      {"lib abc_v1_00_a abc.vhd other", ""},
      {"", ""}};
  for (const auto& [line, expected] : rows) {
    SCOPED_TRACE(line);
    auto core = Core("abc_v1_00_a", "\n# comment\n\t" + line + " #\nlib abc_v1_00_a abc.vhd x y");
    core.File("hdl/verilog/inc/i.vh", "");
    recorder.Take();
    const std::string read = Read("abc_v1_00_a");
    const auto messages = recorder.Take();
    const bool refused = expected == library || expected == path;
    const std::string cut = line.substr(0, line.find(" #"));
    EXPECT_EQ(read, Invalid("abc_v1_00_a"));
    ASSERT_FALSE(messages.empty());
    EXPECT_EQ(messages.back(),
              refused ? Unparsable("abc_v1_00_a", cut, expected.c_str(), 3)
                      : Unparsable("abc_v1_00_a", "lib abc_v1_00_a abc.vhd x y", "library", 4));
    core.Ldx(line);
    EXPECT_EQ(Read("abc_v1_00_a"), refused ? Invalid("abc_v1_00_a") : expected);
  }
}

TEST_F(AnalyseOrder, ReportsFileEntries) {
  Core("xyz_v1_00_a", "");
  const std::string missing =
      "Unable to determine location for library no, file a.vhd\nCannot find IP key for no\n\n";
  const struct {
    const char *hdl, *line, *error;
    bool refused;
  } rows[] = {{"VHDL", "lib abc_v1_00_a a.vhd abc", "Unknown HDL language specified\n", false},
              {"BOTH", "lib abc_v1_00_a a.vhd VHDL",
               "HDL language specified when IP core is BOTH\n", false},
              {"verilog", "lib xyz a.vhd", "File a.vhd declared to be verilog\n", true},
              {"BOTH", "simlib xyz s/a", "Unable to add file extension to s/a\n", true},
              {"VHDL", "lib no a.vhd", missing.c_str(), true}};
  for (const auto& [hdl, line, error, refused] : rows) {
    Core("abc_v1_00_a", line);
    recorder.Take();
    EXPECT_EQ(Read("abc_v1_00_a", hdl), refused ? Invalid("abc_v1_00_a") : "");
    std::vector<std::string> expected = {"error " + kLdx + error};
    if (refused) expected.push_back(Unparsable("abc_v1_00_a", line));
    EXPECT_EQ(recorder.Take(), expected) << line;
  }
}

// What an included core is called, and looked up by, is the text of the entry.
TEST_F(AnalyseOrder, NamesIncludedCoresAsTheirEntriesDo) {
  Core("a_v1_00_a", "lib a_v1_00_a s//a.vhd");
  Core("b_v1_00_a", "lib a s/a.vhd\nlib a all");
  EXPECT_EQ(Read("b"), "a_v1_00_a/vhdl/s/a.vhd");
  EXPECT_THAT(recorder.Take(), IsEmpty());
  Core("e_v1_00_a", "lib e e.vhd\nlib e e.vhd");
  Core("f_v1_00_a", "lib e all");
  EXPECT_EQ(Read("f"), "e_v1_00_a/vhdl/e.vhd");
  EXPECT_THAT(recorder.Take(), testing::Each(testing::HasSubstr("LDXParser: e - File e_v1_00_a:")));
  repo.Core("g_v1_00_a").Qvr("OPTION HDL = Verilog");
  Core("g_v1_00_a", "");
  Core("g_v2_00_a", "lib g a");
  Core("h_v1_00_a", "lib g all");
  EXPECT_EQ(Read("h"), "g_v2_00_a/verilog/a.v");
  Core("a_v1_00_a", "lib none all x");
  EXPECT_EQ(Read("a"), Invalid("a_v1_00_a"));
  EXPECT_EQ(recorder.Take().size(), 1U);
  Core("a_v1_00_a", "vlgincdir b data x\nvlgincdir a .\nvlgincdir a data x");
  EXPECT_THAT(Parse("a").ListVerilogIncludeLibraryKeys(), ElementsAre("a"));
}

// Each byte of a long path is looked at once.
TEST_F(AnalyseOrder, TakesPathsOfAnyLength) {
  std::string path;
  for (int i = 0; i < 200000; ++i) path += "d/";
  Core("a_v1_00_a", "lib a " + path + "a.vhd\nlib a " + path + "b.vhd");
  const LDXParser order = Parse("a");
  const Port::FileName last(order.ListSynthesisAnalyseOrder().back());
  EXPECT_EQ(order.GetFileLibrary(last).GetKey(), "a_v1_00_a");
}

TEST_F(AnalyseOrder, WarnsOfDuplicatesAndKeepsTheFirst) {
  Core("xyz_v1_00_a", "");
  Core("abc_v1_00_a",
       "synlib abc_v1_00_a s/a.vhd\nlib abc_v1_00_a s/a\nlib abc s/a.vhd VHDL\nlib xyz s/a.vhd");
  recorder.Take();
  EXPECT_EQ(Read("abc_v1_00_a"), "abc_v1_00_a/vhdl/s/a.vhd xyz_v1_00_a/vhdl/s/a.vhd");
  const std::string warning =
      "warning " + kLdx + "abc_v1_00_a - File abc_v1_00_a:a.vhd already exists in ";
  EXPECT_THAT(recorder.Take(),
              ElementsAre(warning + "synthesis library\n", warning + "synthesis library\n",
                          warning + "simulation library\n"));
}

// Shapes of inclusion: the core `top` over what stands in the row.
TEST_F(AnalyseOrder, MergesByLibrary) {
  using Cores = std::vector<std::pair<std::string, std::string>>;
  const struct {
    Cores cores;
    std::string expected;
  } rows[] = {
      {{{"top", "lib b x1.vhd\nlib top t.vhd\nlib b x2.vhd"}, {"b", ""}}, "b/x1 b/x2 top/t"},
      {{{"top", "lib b all\nlib c all\nlib top t.vhd"},
        {"b", "lib d all\nlib b b.vhd"},
        {"c", "lib d all\nlib c c.vhd"},
        {"d", "lib d d.vhd"}},
       "d/d b/b c/c top/t"},
      {{{"top", "lib b 2.vhd\nlib b all\nlib b 4.vhd"},
        {"b", "lib b 1.vhd\nlib b 2.vhd\nlib b 3.vhd"}},
       "b/2 b/1 b/3 b/4"},
      {{{"top", "lib d 3.vhd\nlib c all\nlib b all"},
        {"b", "lib d 1.vhd\nlib b b.vhd"},
        {"c", "lib d 2.vhd\nlib d 3.vhd"},
        {"d", ""}},
       "d/3 d/2 d/1 b/b"},
      {{{"top", "lib b all\nlib c a.vhd"}, {"b", "lib b a.vhd"}, {"c", ""}}, "b/a c/a"},
      {{{"top", "simlib b all\nsynlib top t.vhd"}, {"b", "synlib b s.vhd\nsimlib b t.vhd"}},
       "b/s top/t | b/t"},
      {{{"top", "lib b all\nlib c all"},
        {"b", "simlib c m.vhd\nlib b b.vhd"},
        {"c", "lib c c.vhd"}},
       "b/b c/c | c/m c/c b/b"},
      {{{"top", "lib b all"}, {"b", ""}}, ""}};
  for (const auto& row : rows) {
    index.ClearIP();
    for (const auto& [name, ldx] : row.cores) Core(name + "_v1_00_a", ldx);
    const LDXParser order = Parse("top_v1_00_a");
    std::string text;
    const auto add = [&](const StringList& paths) {
      for (const StringBase& path : paths) {
        const StringBase library = order.GetFileLibrary(Port::FileName(path)).GetName();
        text += (text.empty() || text.back() == ' ' ? "" : " ") + std::string(library) + "/" +
                fs::path(path.GetText()).stem().string();
      }
    };
    add(order.ListSynthesisAnalyseOrder());
    if (order.ListSynthesisAnalyseOrder() != order.ListSimulationAnalyseOrder()) {
      text += " | ";
      add(order.ListSimulationAnalyseOrder());
    }
    EXPECT_EQ(text, row.expected) << row.cores[0].second;
  }
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

TEST_F(AnalyseOrder, FindsTheLanguageOfIncludedCores) {
  const auto include = [&](const std::string& description, const char* hdl) {
    index.ClearIP();
    if (!description.empty()) repo.Core("sub_v1_00_a").Qvr(description);
    Core("sub_v1_00_a", "lib sub_v1_00_a a");
    Core("top_v1_00_a", "lib sub all");
    return Read("top_v1_00_a", hdl);
  };
  EXPECT_EQ(include("", "Verilog"), "sub_v1_00_a/verilog/a.v");
  EXPECT_EQ(include("", ""), "sub_v1_00_a/vhdl/a.vhd");
  EXPECT_EQ(include("OPTION A = b", "Verilog"), "sub_v1_00_a/vhdl/a.vhd");
  EXPECT_EQ(include("OPTION HDL = verilog", "VHDL"), "sub_v1_00_a/verilog/a.v");
  EXPECT_EQ(include("OPTION HDL = ''", "Verilog"), "sub_v1_00_a/vhdl/a.vhd");
}

TEST_F(AnalyseOrder, AnswersForSourcesAndDirectories) {
  Core("sub_v1_00_a",
       "vlgincdir sub_v1_00_a hdl/../data\nvlgincdir gone data\nsimlib sub s.v Verilog")
      .File("hdl/verilog/s.v", "");
  Core("far_v1_00_a", "");
  Core("top_v1_00_a",
       "vlgincdir gone .\nlib sub all\nlib top_v1_00_a d/vhdl/a.vhd\nlib top_v1_00_a b.vhd");
  const LDXParser order = Parse("top_v1_00_a");
  const std::string at = repo / "ipmods/";
  const auto library = [&](const std::string& path) {
    return order.GetFileLibrary(Port::FileName(path.c_str())).GetKey();
  };
  EXPECT_EQ(library(at + "sub_v1_00_a/hdl/verilog/s.v"), "sub_v1_00_a");
  EXPECT_EQ(library("top_v1_00_a/anything/verilog/b.vhd"), "top_v1_00_a");
  for (const char* path : {"top_v1_00_a/hdl/vhdl/nothing.vhd", "top_v1_00_a/hdl/vhdl/d/vhdl/a.vhd",
                           "b.vhd", "vhdl/b.vhd", "top_v1_00_a/hdl/VHDL/b.vhd", ""}) {
    EXPECT_EQ(library(path), "") << path;
  }
  const char* const languages[][2] = {
      {"a.v", "Verilog"}, {"/x/a.vhd", "VHDL"}, {"a.V", ""}, {"a.vh", ""}, {"", ""}};
  for (const auto& [file, language] : languages)
    EXPECT_EQ(order.GetFileLanguage(Port::FileName(file)), language);
  EXPECT_EQ(Shorten(order.ListSynthesisLibraries()), "top_v1_00_a");
  EXPECT_EQ(Shorten(order.ListSimulationLibraries()), "sub_v1_00_a top_v1_00_a");
  EXPECT_THAT(order.ListVerilogIncludeLibraryKeys(), ElementsAre("gone", "sub_v1_00_a"));
  EXPECT_EQ(order.GetVerilogIncludeLocation("gone"), (at + "top_v1_00_a/.").c_str());
  EXPECT_EQ(order.GetVerilogIncludeLocation("sub_v1_00_a"),
            (at + "sub_v1_00_a/hdl/../data").c_str());
  EXPECT_EQ(order.GetVerilogIncludeLocation("sub"), (at + "sub_v1_00_a").c_str());
  EXPECT_EQ(order.GetVerilogIncludeLocation("far"), (at + "far_v1_00_a").c_str());
  EXPECT_THROW(order.GetVerilogIncludeLocation("nowhere"), AppException);
}

TEST_F(AnalyseOrder, ReportsIncludeDirectories) {
  Core("abc_v1_00_a", "vlgincdir xyz hdl/none");
  EXPECT_EQ(Read("abc_v1_00_a"), Invalid("abc_v1_00_a"));
  EXPECT_THAT(recorder.Take(),
              ElementsAre("warning " + kLdx +
                              "The include directory hdl/none for library xyz does not exist\n",
                          Unparsable("abc_v1_00_a", "vlgincdir xyz hdl/none", "path")));
  Core("abc_v1_00_a", "vlgincdir xyz data\nvlgincdir xyz .");
  recorder.Take();
  EXPECT_EQ(Read("abc_v1_00_a"), Invalid("abc_v1_00_a"));
  EXPECT_THAT(recorder.Take(),
              ElementsAre("warning " + kLdx + "Library xyz already has path " +
                              repo / "ipmods/abc_v1_00_a/data" + " defined\n",
                          Unparsable("abc_v1_00_a", "vlgincdir xyz .", "path", 2)));
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
    ASSERT_EQ(Read("abc_v1_00_a"), exists ? "" : Invalid("abc_v1_00_a")) << directory;
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
  const Port::FileName other((repo / "other").c_str());
  const Kel_Key abc("abc_v1_00_a");
  const LDXParser order(other, index, abc, Kel_Key("xyz_v2_00_a"), "VHDL");
  EXPECT_EQ(Shorten(order.ListSynthesisAnalyseOrder()),
            "abc_v1_00_a/vhdl/a.vhd abc_v1_00_a/vhdl/b.vhd xyz_v1_00_a/vhdl/x.vhd");
  EXPECT_THROW(LDXParser(other, index, abc, Kel_Key(), "VHDL"), AppException);
  const LDXParser bare(index, Kel_Key("abc"), Kel_Key(), "VHDL");  // each level is its own root
  EXPECT_EQ(bare.ListSynthesisAnalyseOrder().size(), 2U);
  const Kel_Key root("xyz_v1_00_a");
  EXPECT_THROW(LDXParser(other, index, abc, root, "VHDL"), AppException);
}

TEST_F(AnalyseOrder, KeepsThePlaceOfEachEntry) {
  Core("sub_v1_00_a", "\n\tsimlib sub  's x.v' Verilog # c\nvlgincdir gone data");
  Core("top_v1_00_a", "lib sub all\n\nlib sub b vhdl\nlib top_v1_00_a a");
  const LDXParser order = Parse("top_v1_00_a", "verilog");
  const auto dump = [&](const KelPlace& place) {
    const std::string file = place.file.GetText();
    return file.substr(file.rfind('/') + 1, 3) + ":" + std::to_string(place.line) + ":" +
           std::to_string(place.column) + "+" + std::to_string(place.length);
  };
  std::string text;
  for (const auto& list : {order.GetSynthesisSources(), order.GetSimulationSources()}) {
    for (const KelSource& source : list) {
      text += Shorten({source.path}) + " " + source.library.GetKey().GetText() + " " +
              source.language.GetText() + " " + dump(source.place) + "\n";
    }
  }
  for (const KelIncludeDirectory& directory : order.GetVerilogIncludeDirectories()) {
    text += Shorten({directory.path}) + " " + directory.library.GetText() + " " +
            dump(directory.place) + "\n";
  }
  for (const KelInclude& include : order.GetIncludes()) {
    text += std::string(include.library) + " " + include.core.GetKey().GetText() + " " +
            dump(include.place) + "\n";
  }
  EXPECT_EQ(text,
            "sub_v1_00_a/vhdl/b.vhd sub_v1_00_a vhdl top:3:9+1\n"
            "top_v1_00_a/verilog/a.v top_v1_00_a verilog top:4:17+1\n"
            "sub_v1_00_a/verilog/s x.v sub_v1_00_a Verilog sub:2:15+5\n"
            "sub_v1_00_a/vhdl/b.vhd sub_v1_00_a vhdl top:3:9+1\n"
            "top_v1_00_a/verilog/a.v top_v1_00_a verilog top:4:17+1\n"
            "sub_v1_00_a/data gone sub:3:16+4\n"
            "sub sub_v1_00_a top:1:5+3\n");
}

TEST_F(AnalyseOrder, ReportsACircleThroughTheRootAtEachLevel) {
  Core("abc_v1_00_a", "lib abc_v1_00_a a.vhd\nlib xyz_v1_00_a all\nlib");
  Core("xyz_v1_00_a", "lib abc_v1_00_a all");
  EXPECT_EQ(Read("abc_v1_00_a"), Invalid("abc_v1_00_a"));
  EXPECT_THAT(recorder.Take(),
              ElementsAre(Unable("abc_v1_00_a", "Circular LDX definition for abc_v1_00_a\n"),
                          Unparsable("xyz_v1_00_a", "lib abc_v1_00_a all"),
                          Unable("xyz_v1_00_a", Invalid("xyz_v1_00_a").substr(2)),
                          Unparsable("abc_v1_00_a", "lib xyz_v1_00_a all", "library", 2)));
  EXPECT_THAT(recorder.Inputs(), ElementsAre("xyz_v2_1_0.ldx:1", "xyz_v2_1_0.ldx:1",
                                             "abc_v2_1_0.ldx:2", "abc_v2_1_0.ldx:2"));
}

// Whatever the way of a circle, it ends where it would begin again.
TEST_F(AnalyseOrder, EndsEveryCircle) {
  const struct {
    std::vector<std::pair<const char*, const char*>> cores;
    const char* root;
    std::string closedAt;
    std::size_t messages;
  } rows[] = {
      {{{"a_v1_00_a", "lib a_v1_00_a all"}}, "a_v1_00_a", "a_v1_00_a", 2},
      {{{"a_v1_00_a", "lib a all"}}, "a_v1_00_a", "a_v1_00_a", 2},
      {{{"a_v1_00_a", "lib a all"}}, "a", "a_v1_00_a", 2},
      {{{"a_v1_00_a", "lib b all"}, {"b_v1_00_a", "lib a all"}}, "a_v1_00_a", "a_v1_00_a", 4},
      {{{"a_v1_00_a", "lib b all"}, {"b_v1_00_a", "lib c all"}, {"c_v1_00_a", "lib b_v1_00_a all"}},
       "a_v1_00_a",
       "b_v1_00_a",
       6}};
  for (const auto& row : rows) {
    index.ClearIP();
    for (const auto& [key, ldx] : row.cores) Core(key, ldx);
    EXPECT_EQ(Read(row.root).substr(0, 14), "1 Invalid LDX ");
    const auto messages = recorder.Take();
    EXPECT_EQ(messages.size(), row.messages);
    EXPECT_THAT(messages.front(),
                testing::HasSubstr("\nCircular LDX definition for " + row.closedAt + "\n"));
  }
}

// The root is told by the text of its key alone; all else is left to the levels between.
TEST_F(AnalyseOrder, KnowsItsRoot) {
  const auto read = [&](const char* key, const char* root) {
    const LDXParser order(index, Kel_Key(key), Kel_Key(root), "VHDL");
    return Shorten(order.ListSynthesisAnalyseOrder());
  };
  Core("a_v1_00_a", "lib a a.vhd");
  Core("b_v1_00_a", "lib a all");
  EXPECT_EQ(read("a", "a_v1_00_a"), "a_v1_00_a/vhdl/a.vhd");
  EXPECT_EQ(read("b", "a_v1_00_a"), "a_v1_00_a/vhdl/a.vhd");
  const LDXParser other(Port::FileName(File("b_v1_00_a").c_str()), index, Kel_Key("none"),
                        Kel_Key(), "VHDL");
  EXPECT_EQ(Shorten(other.ListSynthesisAnalyseOrder()), "a_v1_00_a/vhdl/a.vhd");
  for (const char* key : {"a_v1_00_a", "unknown_v1_00_a"}) {
    fs::remove(File("a_v1_00_a"));
    try {
      read(key, key);
      FAIL();
    } catch (const AppException& exception) {
      EXPECT_EQ(exception.level, AppException::Failure);
      EXPECT_STREQ(exception.what(),
                   (std::string("Circular LDX definition for ") + key + "\n").c_str());
    }
  }
}

// Two versions of one core are two cores.
TEST_F(AnalyseOrder, IncludesAnotherVersionOfTheSameCore) {
  Core("a_v2_00_a", "lib a_v2_00_a a.vhd");
  Core("a_v1_00_a", "lib a all\nlib a_v1_00_a a.vhd");
  EXPECT_EQ(Read("a_v1_00_a"), "a_v2_00_a/vhdl/a.vhd a_v1_00_a/vhdl/a.vhd");
}

TEST_F(AnalyseOrder, FollowsChainsDownToTheirLimit) {
  constexpr int limit = 1000;
  const auto name = [](int i) { return "c" + std::to_string(i); };
  for (int i = 0; i < limit; ++i) {
    const std::string next = i + 1 < limit ? "lib " + name(i + 1) + " all\n" : "";
    Core(name(i) + "_v1_00_a", next + (i % 333 == 0 ? "lib " + name(i) + " a.vhd" : ""));
  }
  const std::string source = "_v1_00_a/vhdl/a.vhd";
  EXPECT_EQ(Read("c0_v1_00_a"),
            "c999" + source + " c666" + source + " c333" + source + " c0" + source);
  EXPECT_THAT(recorder.Take(), IsEmpty());
  Core("top_v1_00_a", "lib c0 all");
  EXPECT_EQ(Read("top_v1_00_a"), Invalid("top_v1_00_a"));
  const auto messages = recorder.Take();
  EXPECT_EQ(messages.size(), 2000U);
  EXPECT_EQ(messages.front(),
            Unable("c999", "LDX definition for c999_v1_00_a nested below 1000 others\n"));
}

TEST_F(AnalyseOrder, RefusesWhatItCannotRead) {
  Core("abc_v1_00_a", "lib gone all");
  EXPECT_EQ(Read("nope"), "0 Cannot find IP index entry for nope\n");
  EXPECT_EQ(Read("abc_v1_00_a"), Invalid("abc_v1_00_a"));
  const std::string line = Unparsable("abc_v1_00_a", "lib gone all");
  EXPECT_THAT(recorder.Take(),
              ElementsAre(Unable("gone", "Cannot find IP index entry for gone\n"), line));
  fs::remove(Core("gone_v1_00_a", "").Location() + "/data/gone_v2_1_0.ldx");
  EXPECT_EQ(Read("gone_v1_00_a"), Invalid("gone_v1_00_a"));
  EXPECT_EQ(Read("abc_v1_00_a"), Invalid("abc_v1_00_a"));
  EXPECT_THAT(recorder.Take(),
              ElementsAre(Unable("gone", Invalid("gone_v1_00_a").substr(2)), line));
  fs::create_directories(File("gone_v1_00_a"));
  EXPECT_EQ(Read("gone_v1_00_a"), "1 Cannot read file " + File("gone_v1_00_a") + "\n");
  fs::permissions(fs::path(File("gone_v1_00_a")).parent_path(), fs::perms::none);
  {
    const OrdinaryUser user;
    EXPECT_EQ(Read("gone_v1_00_a"), "1 Cannot read file " + File("gone_v1_00_a") + "\n");
  }
  fs::permissions(fs::path(File("gone_v1_00_a")).parent_path(), fs::perms::all);
}

TEST_F(AnalyseOrder, TracesWhatItReadsAndLeavesOut) {
  Core("sub_v1_00_a", "lib sub a.vhd");
  Core("top_v1_00_a", "lib sub_v1_00_a a.vhd VHDL\nsimlib top b.vhd\nlib sub all");
  MessageRecorder traces(MessageRecorder::MessagesAndTraces);
  Read("top_v1_00_a", "MIXED");
  const auto reads = [&](const std::string& key) {
    return std::vector<std::string>{"trace:   Parsing LDX File " + File(key) + "\n",
                                    "trace: Opening File " + File(key) + "\n",
                                    "trace: Closed File " + File(key) + "\n"};
  };
  std::vector<std::string> expected = reads("top_v1_00_a");
  expected.push_back(
      "trace: HDL language not specified for file top:b.vhd when IP core is MIXED\n");
  const auto nested = reads("sub_v1_00_a");
  expected.insert(expected.end(), nested.begin(), nested.end());
  const std::string assumed =
      "trace: HDL language not specified for file sub:a.vhd when IP core is MIXED\n";
  const std::string success = "trace:   Parse successful\n";
  const std::string known =
      "trace: top_v1_00_a - File sub_v1_00_a:a.vhd included from sub already exists in ";
  expected.insert(expected.end(), {assumed, success, known + "synthesis library\n",
                                   known + "simulation library\n", success});
  EXPECT_EQ(traces.Take(), expected);
}

// Over random inclusions without circles: each source stands once on each side, libraries in the
// order of their first source, the sources of each together, and each source finds its library.
TEST_F(AnalyseOrder, KeepsItsLawsOverAnyInclusions) {
  std::mt19937 random(1);
  const auto below = [&](int limit) {
    return std::uniform_int_distribution<int>(0, limit - 1)(random);
  };
  for (int round = 0; round < 60; ++round) {
    index.ClearIP();
    const int cores = 2 + below(7);
    for (int core = 0; core < cores; ++core) {
      std::string ldx;
      for (int line = below(6); line > 0; --line) {
        const std::string other = "c" + std::to_string(below(core + 1));
        const char* const keyword[] = {"lib ", "synlib ", "simlib "};
        const bool include = other != "c" + std::to_string(core) && below(2) == 0;
        ldx += keyword[below(3)] + other +
               (include ? " all" : " f" + std::to_string(below(3)) + ".vhd") + "\n";
      }
      Core("c" + std::to_string(core) + "_v1_00_a", ldx);
    }
    const LDXParser order = Parse("c" + std::to_string(cores - 1));
    const auto check = [&](StringList sources, const StringList& directories) {
      StringList libraries;
      for (const StringBase& source : sources) {
        const Kel_Key library = order.GetFileLibrary(Port::FileName(source));
        ASSERT_TRUE(library.IsValid());
        const StringBase directory = index.GetIPLocation(library).GetAbsolutePath();
        if (libraries.empty() || libraries.back() != directory) libraries.push_back(directory);
      }
      EXPECT_EQ(libraries, directories);
      std::sort(sources.begin(), sources.end());
      EXPECT_EQ(std::adjacent_find(sources.begin(), sources.end()), sources.end());
    };
    check(order.ListSynthesisAnalyseOrder(), order.ListSynthesisLibraries());
    check(order.ListSimulationAnalyseOrder(), order.ListSimulationLibraries());
  }
}

}  // namespace
