// Whole requests, from the walk to the netlists, while memory and files work against them, and with
// words that mean something to whoever prints them.

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <memory>
#include <optional>
#include <string>
#include <thread>
#include <utility>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "OpenHook.h"
#include "OrdinaryUser.h"
#include "Outcome.h"
#include "RepositoryBuilder.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Index.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;

using Question = bool (KelIP::*)(StringList&) const;
const Question kQuestions[] = {&KelIP::ListPorts, &KelIP::ListSynthesisSources,
                               &KelIP::ListSimulationLibraries, &KelIP::ListNetlists};

// The answers of a core, each empty where there is none.
using Answers = std::array<StringList, std::size(kQuestions) + 1>;

// Asks the library and an instance of it, made if there is none. Makes no allocation of its own.
Answers Ask(const KelLibrary& library, const StringBase& key, std::unique_ptr<KelIP>& ip) {
  Answers answers;
  library.ListIPProperties(key, answers.back());
  if (!ip) ip.reset(library.CreateIP(key));
  for (std::size_t i = 0; ip && i < std::size(kQuestions); ++i) {
    ((*ip).*kQuestions[i])(answers[i]);
  }
  return answers;
}
Answers Ask(const KelLibrary& library, const StringBase& key) {
  std::unique_ptr<KelIP> ip;
  return Ask(library, key, ip);
}

// Whether each answer is the whole one or none.
bool IsPartOf(const Answers& answers, const Answers& whole) {
  return std::equal(
      answers.begin(), answers.end(), whole.begin(),
      [](const StringList& one, const StringList& other) { return one.empty() || one == other; });
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

// What fails is told and costs one answer. The same instance answers whole when asked again.
TEST_F(Request, SurvivesEachFailedAllocation) {
  ASSERT_TRUE(library.SetRepositoryPath(path));
  const Answers whole = Ask(library, key);
  for (const auto kind : {AllocationFault::BadAlloc, AllocationFault::SomethingElse,
                          AllocationFault::FatalException}) {
    bool fired = true;
    for (int n = 0; fired; ++n) {
      Answers answers;
      std::unique_ptr<KelIP> ip;
      {
        const AllocationFault fault(n, kind);
        library.SetRepositoryPath(path);
        answers = Ask(library, key, ip);
      }
      fired = AllocationFault::Fired();
      EXPECT_TRUE(IsPartOf(answers, whole)) << n;
      const bool told = !recorder.Take().empty();  // also a walk that failed, the old one standing
      EXPECT_TRUE(told || answers == whole) << n;
      ASSERT_TRUE(library.SetRepositoryPath(path)) << n;
      ASSERT_EQ(Ask(library, key, ip), whole) << n;
      EXPECT_THAT(recorder.Take(), IsEmpty());
    }
  }
}

// Where memory runs out for who reads ahead, the walk reads itself.
TEST_F(Request, NeedsNoMemoryToReadAhead) {
  for (int i = 0; i < 60; ++i) {
    repo.Core("c" + std::to_string(i) + "_v1_00_a").Qvr("OPTION DESC = some text of some length");
  }
  static const auto self = std::this_thread::get_id();
  static std::atomic<int> others;
  const OpenHook slow([](const char*) {
    std::this_thread::sleep_for(std::chrono::microseconds(300));
    thread_local std::optional<AllocationFault> fault;
    if (std::this_thread::get_id() == self) return 0;
    fault.emplace(0,
                  ++others % 2 == 0 ? AllocationFault::BadAlloc : AllocationFault::SomethingElse);
    return 0;
  });
  EXPECT_TRUE(library.SetRepositoryPath(path));
  EXPECT_GT(others, 0);
  StringList keys;
  EXPECT_TRUE(library.ListAllIPKeys(keys) && keys.size() == 62);
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

// What a file becomes, and how.
const std::pair<const char*, void (*)(const fs::path&)> kChanges[] = {
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

// The core answers less, and says so; its neighbour answers as ever, before and after a further
// walk.
TEST_F(Request, TellsWhatChangedBehindItsBack) {
  ASSERT_TRUE(library.SetRepositoryPath(path));
  const Answers before = Ask(library, key);
  const Answers others = Ask(library, bystander);
  const fs::path core = repo / "ipmods/changed_v1_00_a";
  for (const char* const file : {"data/changed_v2_1_0.qvr", "data/changed_v2_1_0.ldx",
                                 "data/changed_v2_1_0.tew", "data", ""}) {
    for (const auto& [into, make] : kChanges) {
      SCOPED_TRACE(std::string("'") + file + "' becomes " + into);
      const fs::path changed = *file == 0 ? core : core / file;
      fs::remove_all(changed);
      make(changed);
      for (const bool again : {false, true}) {
        const OrdinaryUser user;
        if (again) library.RefreshLibrary();
        recorder.Take();
        const Answers after = Ask(library, key);
        EXPECT_TRUE(after != before && IsPartOf(after, before));
        EXPECT_FALSE(recorder.Take().empty());
        EXPECT_EQ(Ask(library, bystander), others);
        EXPECT_THAT(recorder.Take(), IsEmpty());
      }
      fs::remove_all(core);
      MakeChanged();
      ASSERT_TRUE(library.RefreshLibrary());
      ASSERT_EQ(Ask(library, key), before);
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
    repo.Core(word + "_v1_00_a").Qvr("PORT " + word + " = " + word + "\nOPTION DESC = " + word);
    ASSERT_TRUE(library.SetRepositoryPath(path));
    const StringBase core = word.c_str();
    const std::unique_ptr<KelIP> ip(library.CreateIP(core));
    StringBase option, value;
    ASSERT_TRUE(ip && library.GetIPProperty(core, "DESC", option));
    EXPECT_TRUE(ip->GetPortProperty(core, "DEFAULT", value));
    EXPECT_EQ(std::string(option) + " " + value.GetText(), word + " " + word);
    EXPECT_EQ(ip->GetLocation(), (repo / "ipmods/" + word + "_v1_00_a").c_str());
    EXPECT_FALSE(ip->GetPortProperty(core, core, value));
    EXPECT_THAT(recorder.Take(), ElementsAre(testing::HasSubstr("Cannot find Port " + word +
                                                                " Property " + word + "\n")));
    EXPECT_EQ(Outcome([&] { Kel_Index().GetIPLocation(Kel_Key(core)); }),
              "not found: Cannot find IP index entry for " + word + "\n");
  }
}

}  // namespace
