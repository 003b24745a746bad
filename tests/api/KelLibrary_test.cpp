#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "OrdinaryUser.h"
#include "RepositoryBuilder.h"
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

// All four queries for a key in one line.
std::string Ask(const KelLibrary& library, const char* key) {
  std::string answers = library.GetLocation(key).GetText();
  answers += std::string(" ") + library.GetName(key).GetText();
  answers += std::string(" ") + library.GetVersion(key).GetText();
  return answers + " " + library.GetLatestIPKey(key).GetText();
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
  EXPECT_EQ(Ask(library, "abc_v1_00_a"), At("abc_v1_00_a") + " abc 1.00.a abc_v2_00_b");
  EXPECT_EQ(Ask(library, "abc"), At("abc_V2_00_B") + " abc 2.00.b abc_v2_00_b");
  EXPECT_EQ(Ask(library, "xyz"), other / "ipmods/xyz_v1_00_a xyz 1.00.a xyz_v1_00_a");
  EXPECT_EQ(library.GetLatestIPKey("abc_v9_99_z"), "abc_v2_00_b");
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

TEST_F(Library, ReportsUnknownKeysAsGiven) {
  EXPECT_EQ(Ask(library, "Ab%s_V1_00_A"), "   ");
  const std::string entry = "\nCannot find IP index entry for Ab%s_v1_00_a\n\n";
  const std::string key = "\nCannot find IP key for Ab%s_v1_00_a\n\n";
  EXPECT_THAT(recorder.Take(),
              ElementsAre(kLibrary + "Unable to get location for IP Ab%s_V1_00_A" + entry,
                          kLibrary + "Unable to get name for IP Ab%s_V1_00_A" + key,
                          kLibrary + "Unable to get version for IP Ab%s_V1_00_A" + key,
                          kLibrary + "Unable to get latest IP key for IP Ab%s_V1_00_A\n"
                                     "Cannot find IP key for Ab%s\n\n"));
}

TEST_F(Library, PassesOverWhatIsNoVersionDirectory) {
  repo.Core("abc_v1_00_a");
  repo.Core("docs");
  repo.Core("_v1_00_a");
  repo.Core("abc_v99999999999_00_a");
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
  EXPECT_THAT(recorder.Take(), ElementsAre(kLibrary + "Unable to set repository path to " + bad +
                                           "\nInvalid path directory " + repo / "none" + "\n\n"));
  repo.Core("abc_v2_00_a");
  EXPECT_EQ(library.GetVersion("abc"), "1.00.a");
  EXPECT_TRUE(library.RefreshLibrary());
  EXPECT_EQ(library.GetVersion("abc"), "2.00.a");
  EXPECT_TRUE(SetPath(library, ""));
  EXPECT_EQ(library.GetVersion("abc"), "");
}

TEST_F(Library, GoesOnBehindARepositoryWithoutCores) {
  repo.Core("abc_v1_00_a");
  other.File("ipmods", "not a directory");
  EXPECT_FALSE(SetPath(library, other.Path() + ";" + repo.Path()));
  EXPECT_EQ(library.GetVersion("abc"), "1.00.a");
  EXPECT_THAT(recorder.Take(), ElementsAre("warning s/Tarvo_KelLibrary: Unable to add directory " +
                                           other.Path() + " to library\n"));
}

// Whether `ipmods` may not be listed or the repository not be entered.
TEST_F(Library, EndsItsWalkWhenReadingFails) {
  RepositoryBuilder behind;
  behind.Core("last_v1_00_a");
  repo.Core("abc_v1_00_a");
  other.Core("xyz_v1_00_a");
  for (const std::string& shut : {other / "ipmods", other.Path()}) {
    fs::permissions(shut, fs::perms::none);
    {
      const OrdinaryUser user;
      EXPECT_FALSE(SetPath(library, repo.Path() + ";" + other.Path() + ";" + behind.Path()));
    }
    fs::permissions(shut, fs::perms::all);
    EXPECT_EQ(library.GetVersion("abc"), "1.00.a");
    EXPECT_THAT(recorder.Take(),
                ElementsAre(testing::MatchesRegex(
                    kLibrary + "Unable to analyse repository\nboost.*" + shut + ".*\n")));
    EXPECT_EQ(library.GetVersion("last"), "");
    recorder.Take();
  }
}

// A directory that may be listed but not entered: each version is refused by itself.
TEST_F(Library, ReportsVersionsThatItCannotReach) {
  repo.Core("abc_v1_00_a");
  other.Core("xyz_v1_00_a");
  fs::permissions(other / "ipmods", fs::perms(0444));
  {
    const OrdinaryUser user;
    EXPECT_FALSE(SetPath(library, other.Path() + ";" + repo.Path()));
  }
  fs::permissions(other / "ipmods", fs::perms::all);
  EXPECT_EQ(library.GetVersion("abc"), "1.00.a");
  EXPECT_THAT(recorder.Take(),
              ElementsAre("error s/Tarvo_Kel_Index: Invalid IP index entry xyz_v1_00_a at " +
                          other / "ipmods/xyz_v1_00_a" + "\n"));
}

TEST(LibraryTraces, TellTheWalkInOrder) {
  RepositoryBuilder repo;
  const RepositoryBuilder empty;
  repo.Core("abc_v1_00_a").Qvr("");
  const std::string file = repo / "ipmods/abc_v1_00_a/data/abc_v2_1_0.qvr\n";
  MessageRecorder recorder(MessageRecorder::MessagesAndTraces);
  KelLibrary library;
  EXPECT_FALSE(SetPath(library, "/nowhere"));
  EXPECT_THAT(recorder.Take(), ElementsAre("trace: Constructing empty KEL Library\n",
                                           "trace: KEL Library: Reading repository path /nowhere\n",
                                           kLibrary + "Unable to set repository path to /nowhere\n"
                                                      "Invalid path directory /nowhere\n\n"));
  const std::string path = repo.Path() + ";" + empty.Path();
  EXPECT_FALSE(SetPath(library, path));
  EXPECT_THAT(recorder.Take(),
              ElementsAre("trace: KEL Library: Reading repository path " + path + "\n",
                          "trace: KEL Library: Analysing repository " + repo.Path() + "\n",
                          "trace:   Parsing QVR File " + file, "trace: Opening File " + file,
                          "trace: Closed File " + file,
                          "trace: KEL Library: Analysing repository " + empty.Path() + "\n",
                          "warning s/Tarvo_KelLibrary: Unable to add directory " + empty.Path() +
                              " to library\n",
                          "trace:   Detected 1 valid cores (1 all versions)\n",
                          "trace: KEL Library: repository path set to " + path + "\n"));
}

// Each operation with its n-th allocation failing, for every n until it succeeds: nothing escapes,
// the result says so, one message tells it, and the library goes on answering.
struct Operation {
  const char* heads;  // what the message says behind "Unable to", as a regular expression
  const char* tail;   // what it ends in when that which failed has no text
  bool (*run)(KelLibrary& library, const StringBase& path, const StringBase& key);
};

const char kUnknown[] = ", unknown exception\n";

const Operation kOperations[] = {
    {"set repository path to [^\n]*|analyse repository", "\n",
     [](auto& library, auto& path, auto&) { return library.SetRepositoryPath(path); }},
    {"analyse repository", "\n",
     [](auto& library, auto&, auto&) { return library.RefreshLibrary(); }},
    {"get location for IP a_core_with_a_long_name", kUnknown,
     [](auto& library, auto&, auto& key) { return library.GetLocation(key).GetLength() > 0; }},
    {"get latest IP key for IP a_core_with_a_long_name", kUnknown,
     [](auto& library, auto&, auto& key) { return library.GetLatestIPKey(key).GetLength() > 0; }},
    {"get name for IP a_core_with_a_long_name", kUnknown,
     [](auto& library, auto&, auto& key) { return library.GetName(key).GetLength() > 0; }},
    {"get version for IP a_core_with_a_long_name", kUnknown,
     [](auto& library, auto&, auto& key) { return library.GetVersion(key).GetLength() > 0; }},
    {"access IP a_core_with_a_long_name property DESC", "\n\n",
     [](auto& library, auto&, auto& key) {
       StringBase value = "old";
       const bool done = library.GetIPProperty(key, "DESC", value);
       return done || value != "old";
     }},
    {"access IP a_core_with_a_long_name properties", "\n\n", [](auto& library, auto&, auto& key) {
       StringList list;
       const bool done = library.ListIPProperties(key, list);
       return done || !list.empty();
     }}};

bool RunWithFault(const Operation& operation, KelLibrary& library, const StringBase& path,
                  const StringBase& key, int count, AllocationFault::Kind kind) {
  const AllocationFault fault(count, kind);
  return operation.run(library, path, key);
}

TEST_F(Library, LetsNothingEscape) {
  repo.Core("a_core_with_a_long_name_v1_00_a").Qvr("OPTION DESC = a description of some length");
  const StringBase path = repo.Path().c_str();
  const StringBase key = "a_core_with_a_long_name";
  for (const Operation& operation : kOperations) {
    for (const auto kind : {AllocationFault::BadAlloc, AllocationFault::SomethingElse}) {
      const std::string tail = kind == AllocationFault::BadAlloc ? "\n[^\n]+\n" : operation.tail;
      int count = 0;
      for (;; ++count) {
        ASSERT_TRUE(library.SetRepositoryPath(path));
        const bool done = RunWithFault(operation, library, path, key, count, kind);
        if (!AllocationFault::Fired()) {
          EXPECT_TRUE(done);
          break;
        }
        EXPECT_FALSE(done);
        EXPECT_THAT(recorder.Take(), ElementsAre(testing::MatchesRegex(
                                         kLibrary + "Unable to (" + operation.heads + ")" + tail)))
            << count;
      }
      EXPECT_GT(count, 0) << operation.heads;
    }
  }
}

}  // namespace
