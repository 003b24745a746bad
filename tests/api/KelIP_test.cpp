// What an instance keeps, and when it reads; what its operations say is in Operations_test.cpp.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <string>

#include "MessageRecorder.h"
#include "RepositoryBuilder.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;

class Instance : public testing::Test {
 protected:
  // Walks anew first.
  std::unique_ptr<KelIP> Open(const char* key) {
    EXPECT_TRUE(library.SetRepositoryPath(repo.Path().c_str()));
    return std::unique_ptr<KelIP>(library.CreateIP(key));
  }
  // What a question gives, as the last names of its paths, or that it has no answer.
  static std::string Ask(const KelIP& ip, bool (KelIP::*question)(StringList&) const) {
    StringList list = {"old"};
    if (!(ip.*question)(list)) return list.empty() ? "none" : "left";
    std::string text;
    for (const StringBase& name : list) text += fs::path(name.GetText()).filename().string() + " ";
    return text;
  }
  std::string At(const std::string& name) const { return repo / "ipmods/abc_v1_00_a/" + name; }

  RepositoryBuilder repo;
  MessageRecorder recorder;
  KelLibrary library;
};

TEST_F(Instance, IsMadeForTheVersionThatAKeyStandsFor) {
  repo.Core("abc_v1_00_a").Qvr("PORT a = 1");
  repo.Core("abc_V02_00_B").Qvr("OPTION EMPTY = ''\nOPTION NAME = other");
  const auto old = Open("abc_v1_00_a"), ip = Open("abc");
  EXPECT_EQ(std::string(ip->GetKey()) + " " + ip->GetName().GetText() + " " +
                ip->GetVersion().GetText() + " " + ip->GetLocation().GetText(),
            "abc_v02_00_b abc 2.00.b " + (repo / "ipmods/abc_V02_00_B"));
  EXPECT_EQ(Ask(*ip, &KelIP::ListIPProperties),
            "NAME VERSION EMPTY NAME IMP_NETLIST RUN_TRAMFOLD STYLE USAGE_LEVEL ");
  StringBase value = "NAME";
  EXPECT_TRUE(ip->GetIPProperty(value, value));  // an argument may be the output, or lie in it
  EXPECT_EQ(value, "abc");
  StringList list = {"a"};
  EXPECT_TRUE(old->ListPortProperties(list[0], list));
  EXPECT_FALSE(ip->GetIPProperty("EMPTY", value));
  EXPECT_EQ(value, "");
  EXPECT_THAT(recorder.Take(), IsEmpty());

  // A walk that finds another newest version changes no instance.
  repo.Core("abc_v3_00_a").Qvr("");
  fs::remove_all(repo / "ipmods/abc_v1_00_a");
  EXPECT_EQ(Open("abc")->GetKey(), "abc_v3_00_a");
  EXPECT_EQ(ip->GetKey(), "abc_v02_00_b");
  EXPECT_EQ(old->GetLocation(), (repo / "ipmods/abc_v1_00_a").c_str());
  EXPECT_EQ(Ask(*old, &KelIP::ListPorts), "a ");
}

TEST_F(Instance, TakesTheLanguageFromTheOption) {
  const char* const rows[][2] = {{"", "a.vhd "},
                                 {"OPTION HDL = verilog", "a.v "},
                                 {"OPTION hdl = Verilog", "a.vhd "},
                                 {"OPTION HDL = Verilog\nOPTION HDL = VHDL", "a.v "}};
  for (const auto& [option, sources] : rows) {
    repo.Core("abc_v1_00_a").Qvr(option).Ldx("lib abc a");
    EXPECT_EQ(Ask(*Open("abc"), &KelIP::ListSynthesisSources), sources) << option;
  }
}

TEST_F(Instance, GivesPropertiesOfSources) {
  repo.Core("abc_v1_00_a").Ldx("lib abc s/a.vhd\nsimlib abc b.vh VHDL").Qvr("");
  const auto ip = Open("abc");
  const std::string a = At("hdl/vhdl/s/a.vhd"), b = At("hdl/vhdl/b.vh"), other = "no/such.v";
  const std::string rows[][3] = {{a, "FILENAME_HEAD", At("hdl/vhdl/s")},
                                 {a, "library", ""},
                                 {b, "LIBRARY", "abc_v1_00_a"},
                                 {b, "LANGUAGE", ""},
                                 {other, "LANGUAGE", "Verilog"},
                                 {other, "FILENAME_HEAD", fs::current_path() / "no"},
                                 {other, "LIBRARY", ""}};
  for (const auto& [source, property, expected] : rows) {
    StringBase value = "old";
    EXPECT_EQ(ip->GetSourceProperty(source.c_str(), property.c_str(), value), !expected.empty());
    EXPECT_EQ(value.View(), expected) << source << " " << property;
  }
  StringList list = {"old"};
  EXPECT_FALSE(ip->ListSourceProperties(other.c_str(), list));
  EXPECT_THAT(list, IsEmpty());
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

TEST_F(Instance, FollowsTheParametersWithoutReadingAgain) {
  auto core = repo.Core("abc_v1_00_a");
  core.Qvr("OPTION STYLE = MIX\nPARAMETER A = 1");
  core.Tew("A FILES\n1 one.edn\n2 two.edn, three.edn");
  const auto ip = Open("abc");
  EXPECT_EQ(Ask(*ip, &KelIP::ListNetlists), "one.edn ");
  fs::remove_all(At("data"));
  EXPECT_TRUE(ip->SetParameterProperty("A", "VALUE", "2"));
  EXPECT_EQ(Ask(*ip, &KelIP::ListNetlists), "two.edn three.edn ");
  EXPECT_TRUE(ip->SetParameterProperty("A", "VALUE", "3"));
  EXPECT_EQ(Ask(*ip, &KelIP::ListNetlists), "");
  StringBase value;
  const StringBase netlist = At("netlist/one.edn").c_str();
  EXPECT_FALSE(ip->GetNetlistProperty(netlist, "library", value));
  EXPECT_THAT(recorder.Take(), IsEmpty());
  // The list asks for the property, whose message is then the only one.
  StringList list;
  EXPECT_FALSE(ip->ListNetlistProperties(netlist, list));
  EXPECT_THAT(
      recorder.Take(),
      ElementsAre(testing::HasSubstr("property LIBRARY for IP abc_v1_00_a\nCould not find")));
}

// A file that is bad fails each question anew, and no other, until it is mended.
TEST_F(Instance, TriesAgainAfterAFailure) {
  auto core = repo.Core("abc_v1_00_a");
  core.Qvr("OPTION STYLE = MIX\nPARAMETER A = 1").Ldx("lib").Tew("FILES\nb.edn, '");
  const auto ip = Open("abc");
  for (int round = 0; round < 2; ++round) {
    EXPECT_EQ(Ask(*ip, &KelIP::ListSynthesisSources), "none");
    EXPECT_EQ(recorder.Take().size(), 2U);
    EXPECT_EQ(Ask(*ip, &KelIP::ListParameters), "A ");
    EXPECT_EQ(Ask(*ip, &KelIP::ListNetlistLibraries), "none");
    EXPECT_EQ(recorder.Take().size(), 1U);
  }
  core.Ldx("lib abc a.vhd").Tew("FILES\nb.edn");
  EXPECT_EQ(Ask(*ip, &KelIP::ListSynthesisSources), "a.vhd ");
  EXPECT_EQ(Ask(*ip, &KelIP::ListNetlists), "b.edn ");
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

}  // namespace
