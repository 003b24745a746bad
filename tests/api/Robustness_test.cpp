// Whole requests, from the walk to the netlists, while memory and files work against them, and with
// words that mean something to whoever prints them.

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <vector>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "OrdinaryUser.h"
#include "RepositoryBuilder.h"
#include "Tarvo_AppException.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Index.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::IsEmpty;

using Question = bool (KelIP::*)(StringList&) const;
const Question kQuestions[] = {&KelIP::ListPorts, &KelIP::ListSynthesisSources,
                               &KelIP::ListSimulationLibraries, &KelIP::ListNetlists};

// Asks all of a core, and gives each answer to `add`. Makes no allocation of its own.
template <class Add>
void Ask(const KelLibrary& library, const StringBase& key, const Add& add) {
  StringList list;
  if (library.ListIPProperties(key, list)) add(list);
  const std::unique_ptr<KelIP> ip(library.CreateIP(key));
  for (const Question question : kQuestions) {
    if (ip && (*ip.*question)(list)) add(list);
  }
}

std::size_t Count(const KelLibrary& library, const StringBase& key) {
  std::size_t count = 0;
  Ask(library, key, [&](const StringList& list) { count += 1 + list.size(); });
  return count;
}

StringList Answers(const KelLibrary& library, const StringBase& key) {
  StringList answers;
  Ask(library, key, [&](const StringList& list) {
    answers.insert(answers.end(), list.begin(), list.end());
    answers.emplace_back("");
  });
  return answers;
}

class Request : public testing::Test {
 protected:
  Request() {
    MakeChanged();
    repo.Core("bystander_v1_00_a")
        .Qvr("OPTION STYLE = MIX\nPORT a = b")
        .Ldx("lib bystander one.vhd")
        .Tew("FILES\none.edif");
  }

  // The core that things happen to.
  void MakeChanged() {
    repo.Core("changed_v1_00_a")
        .Qvr(
            "OPTION STYLE = MIX\nOPTION DESC = a description of some length\n"
            "PARAMETER MODE = FAST\nPORT a_port_with_a_long_name = b, BUS = REGS")
        .Ldx(
            "lib changed a_source_with_a_long_name.vhd\nlib bystander all\n"
            "simlib changed_v1_00_a another_source_with_a_long_name")
        .Tew("MODE FILES\nFAST a_netlist_with_a_long_name.edif, bystander:two.edif");
  }

  RepositoryBuilder repo;
  MessageRecorder recorder;
  KelLibrary library;
  const StringBase path = repo.Path().c_str();
  const StringBase key = "changed";
  const StringBase bystander = "bystander";
};

TEST_F(Request, SurvivesEachFailedAllocation) {
  ASSERT_TRUE(library.SetRepositoryPath(path));
  const std::size_t expected = Count(library, key);
  for (const auto kind : {AllocationFault::BadAlloc, AllocationFault::SomethingElse}) {
    bool fired = true;
    for (int n = 0; fired; ++n) {
      std::size_t count = 0;
      {
        const AllocationFault fault(n, kind);
        library.SetRepositoryPath(path);
        count = Count(library, key);
      }
      fired = AllocationFault::Fired();
      EXPECT_LE(count, expected) << n;
      const bool told = !recorder.Take().empty();  // also a walk that failed, the old one standing
      EXPECT_TRUE(told || count == expected) << n;
      ASSERT_TRUE(library.SetRepositoryPath(path)) << n;
      ASSERT_EQ(Count(library, key), expected) << n;
    }
  }
}

const char* const kDataFiles[] = {"data/changed_v2_1_0.qvr", "data/changed_v2_1_0.ldx",
                                  "data/changed_v2_1_0.tew"};

struct Change {
  const char* into;
  void (*make)(const fs::path& path);
};
const Change kChanges[] = {
    {"nothing", [](const fs::path&) {}},
    {"a directory", [](const fs::path& path) { fs::create_directory(path); }},
    {"a pipe", [](const fs::path& path) { ASSERT_EQ(::mkfifo(path.c_str(), 0666), 0); }},
    {"a link to itself", [](const fs::path& path) { fs::create_symlink(path, path); }},
    {"a link to an endless device",
     [](const fs::path& path) { fs::create_symlink("/dev/zero", path); }},
    {"what nobody may read", [](const fs::path& path) {
       std::ofstream(path) << "OPTION STYLE = MIX";
       fs::permissions(path, fs::perms::none);
     }}};

// The core answers less or as before, and says so; its neighbour answers as ever, before and after
// a further walk.
TEST_F(Request, TellsWhatChangedBehindItsBack) {
  ASSERT_TRUE(library.SetRepositoryPath(path));
  const StringList before = Answers(library, key);
  const StringList others = Answers(library, bystander);
  const fs::path core = repo / "ipmods/changed_v1_00_a";
  for (const char* const file : {kDataFiles[0], kDataFiles[1], kDataFiles[2], "data", ""}) {
    for (const Change& change : kChanges) {
      SCOPED_TRACE(std::string("'") + file + "' becomes " + change.into);
      const fs::path changed = *file == 0 ? core : core / file;
      fs::remove_all(changed);
      change.make(changed);
      {
        const OrdinaryUser user;
        EXPECT_LT(Answers(library, key).size(), before.size());
        EXPECT_FALSE(recorder.Take().empty());
        EXPECT_EQ(Answers(library, bystander), others);
        library.RefreshLibrary();
        recorder.Take();
        EXPECT_LT(Answers(library, key).size(), before.size());
        EXPECT_FALSE(recorder.Take().empty());
        EXPECT_EQ(Answers(library, bystander), others);
        EXPECT_THAT(recorder.Take(), IsEmpty());
      }
      fs::remove_all(core);
      MakeChanged();
      ASSERT_TRUE(library.RefreshLibrary());
      ASSERT_EQ(Answers(library, key), before);
    }
  }
}

TEST_F(Request, OutlivesItsRepository) {
  fs::create_directory_symlink("..", repo / "ipmods/circle_v1_00_a");
  fs::create_directory_symlink("loop_v1_00_a", repo / "ipmods/loop_v1_00_a");
  ASSERT_TRUE(library.SetRepositoryPath(path));
  const std::unique_ptr<KelIP> ip(library.CreateIP(key));
  StringList list;
  ASSERT_TRUE(ip && ip->ListSynthesisSources(list));
  fs::remove_all(repo.Path());
  EXPECT_TRUE(ip->ListPorts(list) && ip->ListSimulationSources(list));
  EXPECT_EQ(library.GetLocation(key), (repo / "ipmods/changed_v1_00_a").c_str());
  EXPECT_THAT(recorder.Take(), IsEmpty());
  EXPECT_FALSE(ip->ListNetlists(list));
  EXPECT_FALSE(library.RefreshLibrary());
  EXPECT_EQ(library.GetLocation(key), "");
  EXPECT_EQ(recorder.Take().size(), 3U);
}

// Words that a format, a terminal or a text of lines would obey.
TEST_F(Request, PassesAnyWordUnharmed) {
  for (const std::string word : {"%s%n%1000000d%", "\x1B\x63\x07", "\xFF\xFE\x80", "\r\x08"}) {
    const std::string directory = word + "_v1_00_a";
    repo.Core(directory).Qvr("PORT " + word + " = " + word + "\nOPTION DESC = " + word);
    ASSERT_TRUE(library.SetRepositoryPath(path));
    const StringBase core = word.c_str();
    StringBase value;
    EXPECT_TRUE(library.GetIPProperty(core, "DESC", value));
    EXPECT_EQ(value, core);
    const std::unique_ptr<KelIP> ip(library.CreateIP(core));
    ASSERT_TRUE(ip);
    EXPECT_TRUE(ip->GetPortProperty(core, "DEFAULT", value));
    EXPECT_EQ(value, core);
    EXPECT_EQ(ip->GetLocation(), (repo / "ipmods/" + directory).c_str());
    EXPECT_FALSE(ip->GetPortProperty(core, core, value));
    EXPECT_EQ(library.GetLocation((word + "_v9_00_a").c_str()), "");
    const std::vector<std::string> messages = recorder.Take();
    ASSERT_EQ(messages.size(), 2U);
    EXPECT_THAT(messages[0], HasSubstr("Cannot find Port " + word + " Property " + word + "\n"));
    EXPECT_THAT(messages[1], HasSubstr("Cannot find IP index entry for " + word + "_v9_00_a\n"));
    try {
      Kel_Index().GetIPLocation(Kel_Key(core));
      ADD_FAILURE();
    } catch (const AppException& exception) {
      EXPECT_EQ(std::string(exception.what()), "Cannot find IP index entry for " + word + "\n");
    }
  }
}

}  // namespace
