// Options, from the scanner to the library. How their statements are read is among the cases of
// Readers_test.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "OrdinaryUser.h"
#include "Outcome.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_OptionScanner.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;

TEST(OptionScanner, TakesAnyBytes) {
  RepositoryBuilder directory;
  const Port::FileName file((directory / "f").c_str());
  const auto last = [&](const char* key) {
    return Outcome([&] { return OptionScanner(Kel_Key(key), file).GetOptions().at(2).second; });
  };
  directory.File("f", std::string(1000, '\0') + "\nOPTION A = \xFF\xC3(");
  EXPECT_EQ(last("abc_v1_00_a"), "\xFF\xC3(");
  EXPECT_EQ(last("abc"), "failure: Invalid IP key abc for file " + directory / "f" + "\n");
  const std::string deep = std::string(3000000, '(') + std::string(3000000, ')');
  directory.File("f", "OPTION A = " + deep);
  EXPECT_EQ(last("abc_v1_00_a"), deep);
}

TEST(OptionScanner, FindsTheFirstValueAndTracesAMiss) {
  MessageRecorder recorder(MessageRecorder::MessagesAndTraces);
  const PropertyList options = {{"NAME", "n"}, {"A", "1"}, {"A", "2"}};
  EXPECT_EQ(OptionScanner::GetOptionValue(options, "A"), "1");
  EXPECT_THAT(recorder.Take(), IsEmpty());
  EXPECT_EQ(OptionScanner::GetOptionValue(options, "a"), "");
  EXPECT_THAT(recorder.Take(), ElementsAre("trace: Cannot find option a on IP n version \n"));
}

class Options : public testing::Test, protected IndexedRepository {
 protected:
  std::string Keys() {
    StringList keys;
    EXPECT_TRUE(library.ListAllIPKeys(keys));
    return Join(keys);
  }
  bool Walk() { return library.SetRepositoryPath(repo.Path().c_str()); }
  // The messages of the library itself, behind what all of them begin with.
  static std::string Unable(const std::string& text) { return "error s/Tarvo_KelLibrary: " + text; }

  MessageRecorder recorder;
  KelLibrary library;
};

TEST_F(Options, AreAnsweredByTheLibrary) {
  repo.Core("abc_v1_00_a").Qvr("OPTION DESC = one");
  repo.Core("abc_v10_00_a").Qvr("OPTION DESC = ten");
  repo.Core("abc_v20_00_a");
  repo.Core("Abc_v2_00_a").Qvr("");
  EXPECT_TRUE(Walk());
  EXPECT_EQ(Keys(), "Abc_v2_00_a, abc_v10_00_a, abc_v1_00_a");
  EXPECT_EQ(library.GetVersion("abc"), "20.00.a");
  const char* const rows[][3] = {{"abc", "DESC", "ten"},
                                 {"abc_v1_00_a", "DESC", "one"},
                                 {"abc", "NONE", ""},
                                 {"abc_v20_00_a", "DESC", "refused"}};
  for (const auto& [key, option, expected] : rows) {
    EXPECT_THAT(recorder.Take(), IsEmpty());
    StringBase value = "refused";
    EXPECT_EQ(library.GetIPProperty(key, option, value), *expected != 'r');
    EXPECT_EQ(value, expected);
  }
  StringList list = {"old"};
  EXPECT_FALSE(library.ListIPProperties("x%s", list));
  EXPECT_THAT(list, IsEmpty());
  EXPECT_THAT(recorder.Take(),
              ElementsAre(Unable("Unable to access IP abc_v20_00_a property DESC\n"
                                 "Cannot find IP index entry for abc_v20_00_a\n\n"),
                          Unable("Unable to access IP x%s properties\n"
                                 "Cannot find IP index entry for x%s\n\n")));
}

TEST_F(Options, CountInTheIndex) {
  const auto add = [&](const std::string& key) {
    repo.Core(key).Qvr("OPTION A = " + key);
    Add(key);
  };
  add("abc_v2_00_a");
  const PropertyList& options = index.GetIPOptions(Kel_Key("abc"));
  for (const char* key : {"abc_v1_00_a", "abc_v3_00_a", "xyz_v1_00_a", "abc_v1_00_a"}) add(key);
  EXPECT_EQ(OptionScanner::GetOptionValue(options, "A"), "abc_v2_00_a");
  EXPECT_EQ(index.GetBaseIPCount(), 2U);
  EXPECT_EQ(index.GetFullIPCount(), 4U);
  EXPECT_EQ(Join(index.GetLatestIPKeys()), "abc_v3_00_a, xyz_v1_00_a");
}

// Descriptions that are refused cost the versions that they belong to their options, and no more.
TEST_F(Options, AreLostOnlyToTheBadVersion) {
  repo.Core("good_v1_00_a").Qvr("OPTION A = 1");
  repo.Core("bad_v1_00_a").Qvr("OPTION A");
  const std::string shut = repo.Core("shut_v1_00_a").Qvr("OPTION A = 1").Location() + "/data";
  fs::permissions(shut, fs::perms::none);
  {
    const OrdinaryUser user;
    EXPECT_TRUE(Walk());
  }
  fs::permissions(shut, fs::perms::all);
  std::vector<std::string> messages = recorder.Take();
  for (std::string& message : messages) message = Shorten(message);
  EXPECT_THAT(messages, testing::UnorderedElementsAre(
                            "error s/Tarvo_OptionScanner: QVR unparsable OPTION: "
                            "bad_v1_00_a/data/bad_v2_1_0.qvr line 1, OPTION A\n",
                            Unable("Invalid IP index entry bad_v1_00_a at bad_v1_00_a\n"
                                   "Unable to parse QVR bad_v1_00_a/data/bad_v2_1_0.qvr\n\n"),
                            Unable("Invalid IP index entry shut_v1_00_a at shut_v1_00_a\n"
                                   "Cannot read file shut_v1_00_a/data/shut_v2_1_0.qvr\n\n")));
  EXPECT_EQ(Keys(), "good_v1_00_a");
  for (const char* core : {"bad", "shut"}) EXPECT_EQ(library.GetVersion(core), "1.00.a");
}

}  // namespace
