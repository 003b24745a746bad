// The sources and netlists of an instance: which core has which, and when their files are read.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <string>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "RepositoryBuilder.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;

class Views : public testing::Test {
 protected:
  std::unique_ptr<KelIP> Open(const char* key) {
    EXPECT_TRUE(library.RefreshLibrary());
    return std::unique_ptr<KelIP>(library.CreateIP(key));
  }
  // What a question gives: its list, or that it has none.
  static std::string Ask(const KelIP& ip, bool (KelIP::*question)(StringList&) const) {
    StringList list = {"old"};
    if (!(ip.*question)(list)) return list.empty() ? "none" : "left";
    std::string text;
    for (const StringBase& name : list) text += fs::path(name.GetText()).filename().string() + " ";
    return text;
  }
  std::string At(const std::string& name) const { return repo / "ipmods/abc_v1_00_a/" + name; }

  Views() { EXPECT_TRUE(library.SetRepositoryPath(repo.Path().c_str())); }

  // The repository is there before the path is set.
  struct Repository : RepositoryBuilder {
    Repository() { fs::create_directories(*this / "ipmods"); }
  };
  Repository repo;
  MessageRecorder recorder;
  KelLibrary library;
};

TEST_F(Views, FollowTheStyle) {
  const struct {
    const char* option;
    bool sources, netlists;
  } rows[] = {{"", true, false},
              {"OPTION STYLE = HDL", true, false},
              {"OPTION STYLE = hdl", true, false},
              {"OPTION style = BLACKBOX", true, false},
              {"OPTION STYLE = BlackBox", false, true},
              {"OPTION STYLE = Mix\nOPTION STYLE = HDL", true, true},
              {"OPTION STYLE = OTHER", false, false},
              {"OPTION STYLE = ''", false, false}};
  for (const auto& [option, sources, netlists] : rows) {
    SCOPED_TRACE(option);
    repo.Core("abc_v1_00_a").Qvr(option).Ldx("lib abc a.vhd").Tew("FILES\nb.edn");
    const auto ip = Open("abc");
    const bool answers[] = {sources, netlists};
    const struct {
      bool (KelIP::*list)(StringList&) const;
      int kind;
    } lists[] = {{&KelIP::ListSynthesisSources, 0},        {&KelIP::ListSimulationSources, 0},
                 {&KelIP::ListSynthesisLibraries, 0},      {&KelIP::ListSimulationLibraries, 0},
                 {&KelIP::ListVerilogIncludeLibraries, 0}, {&KelIP::ListNetlists, 1},
                 {&KelIP::ListNetlistLibraries, 1}};
    for (const auto& [list, kind] : lists) EXPECT_EQ(Ask(*ip, list) != "none", answers[kind]);
    const StringBase source = At("hdl/vhdl/a.vhd").c_str();
    const StringBase netlist = At("netlist/b.edn").c_str();
    StringBase value = "old";
    StringList list = {"old"};
    EXPECT_EQ(ip->GetVerilogIncludeLocation("abc", value), sources);
    EXPECT_EQ(ip->GetSourceProperty(source, "LIBRARY", value), sources);
    EXPECT_EQ(value, sources ? "abc_v1_00_a" : "");
    EXPECT_EQ(ip->ListSourceProperties(source, list), sources);
    EXPECT_EQ(ip->GetNetlistProperty(netlist, "LIBRARY", value), netlists);
    EXPECT_EQ(value, netlists ? "abc_v1_00_a" : "");
    EXPECT_EQ(ip->ListNetlistProperties(netlist, list), netlists);
    EXPECT_EQ(list.size(), netlists ? 1U : 0U);
    EXPECT_THAT(recorder.Take(), IsEmpty());
  }
}

TEST_F(Views, TakeTheLanguageFromTheOption) {
  const char* const rows[][2] = {{"", "a.vhd "},
                                 {"OPTION HDL = verilog", "a.v "},
                                 {"OPTION hdl = Verilog", "a.vhd "},
                                 {"OPTION HDL = Verilog\nOPTION HDL = VHDL", "a.v "}};
  for (const auto& [option, sources] : rows) {
    repo.Core("abc_v1_00_a").Qvr(option).Ldx("lib abc a");
    EXPECT_EQ(Ask(*Open("abc"), &KelIP::ListSynthesisSources), sources) << option;
  }
}

TEST_F(Views, GivePropertiesOfSources) {
  repo.Core("abc_v1_00_a").Ldx("lib abc s/a.vhd\nsimlib abc b.vh VHDL").Qvr("");
  const auto ip = Open("abc");
  const auto get = [&](const std::string& source, const char* property) {
    StringBase value = "old";
    const bool found = ip->GetSourceProperty(source.c_str(), property, value);
    EXPECT_EQ(found, value.GetLength() > 0);
    return std::string(value);
  };
  EXPECT_EQ(get(At("hdl/vhdl/s/a.vhd"), "FILENAME_HEAD"), At("hdl/vhdl/s"));
  EXPECT_EQ(get(At("hdl/vhdl/s/a.vhd"), "FILENAME_TAIL"), "a.vhd");
  EXPECT_EQ(get(At("hdl/vhdl/b.vh"), "LIBRARY"), "abc_v1_00_a");
  EXPECT_EQ(get(At("hdl/vhdl/b.vh"), "LANGUAGE"), "");
  EXPECT_EQ(get("no/such.v", "LANGUAGE"), "Verilog");
  EXPECT_EQ(get("no/such.v", "FILENAME_HEAD"), (fs::current_path() / "no").string());
  EXPECT_EQ(get("no/such.v", "LIBRARY"), "");
  EXPECT_EQ(get(At("hdl/vhdl/s/a.vhd"), "language"), "");
  EXPECT_EQ(get(At("hdl/vhdl/s/a.vhd"), "library"), "");
  StringList list;
  EXPECT_TRUE(ip->ListSourceProperties(At("hdl/vhdl/b.vh").c_str(), list));
  EXPECT_THAT(list, ElementsAre("LIBRARY", "LANGUAGE", "FILENAME_HEAD", "FILENAME_TAIL"));
  EXPECT_FALSE(ip->ListSourceProperties("no/such.v", list));
  EXPECT_THAT(list, IsEmpty());
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

TEST_F(Views, FollowTheParametersWithoutReadingAgain) {
  auto core = repo.Core("abc_v1_00_a");
  core.Qvr("OPTION STYLE = MIX\nPARAMETER A = 1");
  core.Tew("A FILES\n1 one.edn\n2 two.edn, three.edn");
  const auto ip = Open("abc");
  EXPECT_TRUE(ip->SetParameterProperty("A", "VALUE", "2"));
  EXPECT_EQ(Ask(*ip, &KelIP::ListNetlists), "two.edn three.edn ");
  fs::remove(At("data/abc_v2_1_0.tew"));
  fs::remove(At("data/abc_v2_1_0.qvr"));
  EXPECT_TRUE(ip->SetParameterProperty("A", "VALUE", "1"));
  EXPECT_EQ(Ask(*ip, &KelIP::ListNetlists), "one.edn ");
  EXPECT_TRUE(ip->SetParameterProperty("A", "VALUE", "3"));
  EXPECT_EQ(Ask(*ip, &KelIP::ListNetlists), "");
  EXPECT_THAT(recorder.Take(), IsEmpty());
  StringBase value;
  EXPECT_FALSE(ip->GetNetlistProperty(At("netlist/one.edn").c_str(), "library", value));
  EXPECT_THAT(recorder.Take(), IsEmpty());
  // The list asks for the property, whose message is then the only one.
  const std::string unknown = "error s/Tarvo_KelIP: Unable to get netlist " +
                              At("netlist/one.edn") +
                              " property LIBRARY for IP abc_v1_00_a\nCould not find netlist " +
                              At("netlist/one.edn") + " in order to identify library\n\n";
  StringList list;
  EXPECT_FALSE(ip->GetNetlistProperty(At("netlist/one.edn").c_str(), "LIBRARY", value));
  EXPECT_FALSE(ip->ListNetlistProperties(At("netlist/one.edn").c_str(), list));
  EXPECT_THAT(recorder.Take(), ElementsAre(unknown, unknown));
}

// Whatever way the repository was given, paths come out absolute.
TEST_F(Views, AreAbsolute) {
  repo.Core("abc_v1_00_a")
      .Qvr("OPTION STYLE = MIX")
      .Ldx("synlib abc a\nsimlib xyz b")
      .Tew("FILES\nb.edn");
  repo.Core("xyz_v1_00_a");
  const fs::path relative = fs::relative(repo.Path());
  ASSERT_TRUE(library.SetRepositoryPath(relative.c_str()));
  const std::unique_ptr<KelIP> ip(library.CreateIP("abc"));
  const std::string at = fs::current_path() / relative / "ipmods/";
  const auto ask = [&](bool (KelIP::*question)(StringList&) const) {
    StringList list;
    EXPECT_TRUE(((*ip).*question)(list));
    return list.size() == 1 ? std::string(list[0]) : "not one";
  };
  EXPECT_EQ(ask(&KelIP::ListSynthesisLibraries), at + "abc_v1_00_a");
  EXPECT_EQ(ask(&KelIP::ListSimulationLibraries), at + "xyz_v1_00_a");
  EXPECT_EQ(ask(&KelIP::ListNetlistLibraries), at + "abc_v1_00_a");
  EXPECT_EQ(ask(&KelIP::ListNetlists), at + "abc_v1_00_a/netlist/b.edn");
  StringBase value;
  EXPECT_TRUE(ip->GetNetlistProperty((relative / "ipmods/abc_v1_00_a/netlist/b.edn").c_str(),
                                     "LIBRARY", value));
}

// A file that is bad fails each question anew, and no other, until it is mended.
// What the files state, each with its place; nothing where the style has none.
TEST_F(Views, KnowTheirPlaces) {
  repo.Core("abc_v1_00_a")
      .Qvr("OPTION STYLE = MIX\n\nPORT p = q\nPARAMETER P = 1\nIO_INTERFACE IO_IF = I\nPORT p = r")
      .Ldx("lib abc a.vhd")
      .Tew("# table\nP FILES\n1 xyz:n.edn, m.edn # c\n\n2 n.edn m.edn");
  repo.Core("xyz_v1_00_a").Qvr("");
  repo.Core("box_v1_00_a").Qvr("OPTION STYLE = none");
  const auto ip = Open("abc");
  std::vector<KelStatement> statements;
  std::string text;
  EXPECT_TRUE(ip->GetStatements(statements));
  for (const KelStatement& one : statements) {
    text += std::to_string(one.kind) + one.name.GetText() + std::to_string(one.place.line) + " ";
  }
  EXPECT_EQ(text, "0STYLE1 2p3 1P4 4I5 2p6 ");
  EXPECT_EQ(statements.at(0).place.file, (repo / "ipmods/abc_v1_00_a/data/abc_v2_1_0.qvr").c_str());
  KelNetlistTable table;
  ip->SetParameterProperty("P", "VALUE", "2");
  EXPECT_TRUE(ip->GetNetlistTable(table));
  text = std::string(table.parameters.at(0)) + " ";
  for (const KelNetlistRow& row : table.rows) {
    text += std::to_string(row.place.line) + row.values.at(0).GetText() + (row.applies ? "*" : "-");
    for (const KelNetlist& netlist : row.netlists) {
      text += std::string(netlist.library.GetKey()) +
              fs::path(netlist.path.GetText()).filename().string();
    }
    text += std::string("<") + row.ignored.GetText() + "> ";
  }
  EXPECT_EQ(text,
            "P 31-xyz_v1_00_an.edn"
            "abc_v1_00_am.edn<> 52*abc_v1_00_an.edn<m.edn> ");
  std::vector<KelSource> sources(1);
  const auto box = Open("box");
  EXPECT_FALSE(box->GetSimulationSources(sources));
  EXPECT_FALSE(box->GetNetlistTable(table));
  EXPECT_TRUE(sources.empty() && table.rows.empty() && table.parameters.empty());
  EXPECT_TRUE(recorder.Take().empty());
  repo.Core("abc_v1_00_a").Ldx("lib");
  EXPECT_FALSE(ip->GetSynthesisSources(sources));
  EXPECT_EQ(recorder.Take().back().substr(0, 58),
            "error s/Tarvo_KelIP: Unable to list synthesis analyse orde");
}

TEST_F(Views, TryAgainAfterAFailure) {
  auto core = repo.Core("abc_v1_00_a");
  core.Qvr("OPTION STYLE = MIX\nPARAMETER A = 1").Ldx("lib").Tew("FILES\nb.edn, '");
  const auto ip = Open("abc");
  for (int round = 0; round < 2; ++round) {
    EXPECT_EQ(Ask(*ip, &KelIP::ListSynthesisSources), "none");
    const std::string ldx = At("data/abc_v2_1_0.ldx"), tew = At("data/abc_v2_1_0.tew");
    EXPECT_THAT(recorder.Take(),
                ElementsAre("error s/Tarvo_LDXParser: LDX unparsable library entry: " + ldx +
                                " line 1, lib\n",
                            "error s/Tarvo_KelIP: Unable to list synthesis analyse order for IP "
                            "abc_v1_00_a\nInvalid LDX " +
                                ldx + "\n\n"));
    EXPECT_EQ(Ask(*ip, &KelIP::ListParameters), "A ");
    EXPECT_EQ(Ask(*ip, &KelIP::ListNetlistLibraries), "none");
    EXPECT_THAT(recorder.Take(),
                ElementsAre("error s/Tarvo_KelIP: Unable to list netlist libraries for IP "
                            "abc_v1_00_a\nTEW unparsable file entry: " +
                            tew + " line 2, b.edn, '\n\n"));
  }
  core.Ldx("lib abc a.vhd").Tew("FILES\nb.edn");
  EXPECT_EQ(Ask(*ip, &KelIP::ListSynthesisSources), "a.vhd ");
  EXPECT_EQ(Ask(*ip, &KelIP::ListNetlists), "b.edn ");
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

// The same for a parser that memory is too short for, at each of its allocations.
TEST_F(Views, TryAgainWhenMemoryWasShort) {
  repo.Core("sub_v1_00_a").Qvr("").Ldx("lib sub a_source_with_a_long_name.vhd\nvlgincdir sub data");
  repo.Core("abc_v1_00_a")
      .Qvr("OPTION STYLE = MIX")
      .Ldx("lib sub all\nlib sub sub")
      .Tew("FILES\nb, sub:a");
  for (const auto question : {&KelIP::ListSynthesisSources, &KelIP::ListNetlists}) {
    for (const auto kind : {AllocationFault::BadAlloc, AllocationFault::SomethingElse,
                            AllocationFault::FatalException}) {
      for (int count = 0;; ++count) {
        const auto ip = Open("abc");
        StringList list;
        bool done = false;
        {
          const AllocationFault fault(count, kind);
          done = ((*ip).*question)(list);
        }
        if (!AllocationFault::Fired()) break;
        EXPECT_FALSE(done);
        EXPECT_THAT(recorder.Take().back(),
                    testing::StartsWith("error s/Tarvo_KelIP: Unable to list "));
        EXPECT_TRUE(((*ip).*question)(list)) << count;
        EXPECT_EQ(list.size(), 2U);
        EXPECT_THAT(recorder.Take(), IsEmpty());
      }
    }
  }
}

}  // namespace
