#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <string>
#include <tuple>
#include <utility>

#include "MessageRecorder.h"
#include "OrdinaryUser.h"
#include "RepositoryBuilder.h"
#include "ReviewedText.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;

const std::string kLibrary = "error s/Tarvo_KelLibrary: ";

bool SetPath(KelLibrary& library, const std::string& path) {
  return library.SetRepositoryPath(path.c_str());
}

class Library : public testing::Test {
 protected:
  std::string At(const std::string& key) const { return repo / "ipmods/" + key; }

  RepositoryBuilder repo;
  RepositoryBuilder other;
  MessageRecorder recorder;
  KelLibrary library;
};

TEST_F(Library, AnswersForVersionsAndBareNames) {
  repo.Core("abc_v1_00_a");
  repo.Core("abc_V2_00_B");
  other.Core("abc_v1_00_a");
  other.Core("xyz_v1_00_a");
  EXPECT_TRUE(SetPath(library, repo.Path() + ";" + other.Path()));
  EXPECT_EQ(library.GetLocation("abc_v1_00_a").View(), At("abc_v1_00_a"));
  EXPECT_EQ(library.GetLocation("abc").View(), At("abc_V2_00_B"));
  EXPECT_EQ(library.GetName("abc"), "abc");
  EXPECT_EQ(library.GetVersion("abc"), "2.00.b");
  EXPECT_EQ(library.GetVersion("abc_v1_00_a"), "1.00.a");
  EXPECT_EQ(library.GetVersion("xyz"), "1.00.a");
  EXPECT_EQ(library.GetLatestIPKey("abc_v9_99_z"), "abc_v2_00_b");
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

TEST_F(Library, PassesOverWhatIsNoVersionDirectory) {
  for (const char* name : {"abc_v1_00_a", "docs", "_v1_00_a", "abc_v99999999999_00_a"}) {
    repo.Core(name);
  }
  repo.File("ipmods/plain_v1_00_a", "");
  fs::create_symlink("nowhere", repo / "ipmods/gone_v1_00_a");
  fs::create_symlink("loop_v1_00_a", repo / "ipmods/loop_v1_00_a");
  fs::create_symlink("abc_v1_00_a", repo / "ipmods/link_v1_00_a");
  EXPECT_TRUE(SetPath(library, repo.Path()));
  EXPECT_THAT(recorder.Take(), IsEmpty());
  EXPECT_EQ(library.GetLocation("link").View(), At("link_v1_00_a"));
  for (const char* key : {"docs", "plain", "gone", "loop"}) EXPECT_EQ(library.GetName(key), "");
}

TEST_F(Library, KeepsItsRepositoriesWhenAPathIsBad) {
  repo.Core("abc_v1_00_a");
  EXPECT_TRUE(SetPath(library, repo.Path()));
  const std::string bad = repo.Path() + ";" + repo / "none";
  EXPECT_FALSE(SetPath(library, bad));
  EXPECT_EQ(recorder.Take().size(), 1U);
  repo.Core("abc_v2_00_a");
  EXPECT_EQ(library.GetVersion("abc"), "1.00.a");
  EXPECT_TRUE(library.RefreshLibrary());
  EXPECT_EQ(library.GetVersion("abc"), "2.00.a");
  EXPECT_TRUE(SetPath(library, ""));
  EXPECT_EQ(library.GetVersion("abc"), "");
}

// What was found before stays, and a version that can't be looked at is refused by itself.
TEST_F(Library, TellsWhatItMayNotReach) {
  RepositoryBuilder behind;
  behind.Core("last_v1_00_a");
  repo.Core("abc_v1_00_a");
  other.Core("xyz_v1_00_a");
  // What is shut, with which permissions, the version found behind it, and the message.
  const std::tuple<std::string, unsigned, const char*, std::string> rows[] = {
      {other / "ipmods", 0, "", kLibrary + "Unable to analyse repository\nboost.*/ipmods.*\n"},
      {other.Path(), 0, "", kLibrary + "Unable to analyse repository\nboost.*/ipmods.*\n"},
      {other / "ipmods", 0444, "1.00.a",
       "error s/Tarvo_Kel_Index: Invalid IP index entry xyz_v1_00_a at .*/ipmods/xyz_v1_00_a\n"}};
  for (const auto& [shut, mode, last, message] : rows) {
    fs::permissions(shut, fs::perms(mode));
    {
      const OrdinaryUser user;
      EXPECT_FALSE(SetPath(library, repo.Path() + ";" + other.Path() + ";" + behind.Path()));
    }
    fs::permissions(shut, fs::perms::all);
    EXPECT_THAT(recorder.Take(), ElementsAre(testing::MatchesRegex(message)));
    EXPECT_EQ(library.GetVersion("abc"), "1.00.a");
    EXPECT_EQ(library.GetVersion("last"), last);
    recorder.Take();
  }
}

// What a library and an instance say and trace, from the walk to the netlists.
class Session : public testing::Test {
 protected:
  // One core in each repository, since a directory has no order.
  Session() {
    const std::pair<const char*, const char*> files[] = {
        {"1/ipmods/top_v1_00_a/data/top_v2_1_0.qvr",
         "OPTION STYLE = MIX\nOPTION\tHDL = MIXED\nPARAMETER P = 1"},
        {"1/ipmods/top_v1_00_a/data/top_v2_1_0.ldx",
         "lib sub_v1_00_a a.vhd VHDL\nsynlib top b.vhd\nsimlib top c.vhd\nlib sub all"},
        {"1/ipmods/top_v1_00_a/data/top_v2_1_0.tew", "P FILES\n1 sub:n.edn\n2 m.edn"},
        {"2/ipmods/sub_v1_00_a/data/sub_v2_1_0.qvr", ""},
        {"2/ipmods/sub_v1_00_a/data/sub_v2_1_0.ldx", "lib sub a.vhd"},
        {"3/ipmods/sub_v1_00_a/readme", ""},
        {"4/ipmods/bad_v1_00_a/data/bad_v2_1_0.qvr", "PORT p\nOPTION STYLE"},
        {"5/ipmods/none_v1_00_a/readme", ""},
        {"6/ipmods", "no directory"}};
    for (const auto& [name, text] : files) repo.File(name, text);
  }

  // Writes down a call with what came of it.
  void Tell(const std::string& call, const std::string& answer) {
    report += call + " -> " + answer + "\n";
    for (const std::string& entry : recorder.Take()) report += "    " + entry;
  }

  RepositoryBuilder repo;
  MessageRecorder recorder{MessageRecorder::MessagesAndTraces};
  std::string report;
};

// Paths are relative as they were given, below "$", or absolute, below "/$".
TEST_F(Session, TellsMessagesAndTracesInOrder) {
  const std::string given = fs::relative(repo.Path());
  std::string path;
  for (const char number : std::string("612345")) path += given + "/" + number + ";";
  KelLibrary library;
  Tell("SetRepositoryPath /nowhere", SetPath(library, "/nowhere") ? "true" : "false");
  Tell("SetRepositoryPath", SetPath(library, path) ? "true" : "false");
  StringBase value;
  Tell("GetIPProperty MISS", library.GetIPProperty("top", "MISS", value) ? "true" : "false");
  std::unique_ptr<KelIP> ip;
  for (const char* const key : {"none", "bad", "Other_V1_00_A", "top"}) {
    ip.reset(library.CreateIP(key));
    Tell(std::string("CreateIP ") + key, ip ? ip->GetLocation().GetText() : "null");
  }
  for (const auto question :
       {&KelIP::ListSynthesisSources, &KelIP::ListSimulationSources, &KelIP::ListSynthesisLibraries,
        &KelIP::ListSimulationLibraries, &KelIP::ListNetlists, &KelIP::ListNetlistLibraries}) {
    StringList list;
    EXPECT_TRUE(((*ip).*question)(list));
    for (const StringBase& one : list) Tell("listed", one.GetText());
  }
  const std::string netlist = given + "/2/ipmods/sub_v1_00_a/netlist/n.edn";
  ip->GetNetlistProperty(netlist.c_str(), "LIBRARY", value);
  Tell("GetNetlistProperty", value.GetText());
  report = Replaced(report, fs::current_path() / given, "/$");
  ExpectReviewed("session.txt", Replaced(report, given, "$"));
}

}  // namespace
