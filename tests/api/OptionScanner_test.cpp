#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <string>

#include "MessageRecorder.h"
#include "OrdinaryUser.h"
#include "RepositoryBuilder.h"
#include "Tarvo_AppException.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_OptionScanner.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;

std::string Dump(const PropertyList& options) {
  std::string text;
  for (const auto& [name, value] : options) {
    text += std::string(name) + "=" + value.GetText() + ";";
  }
  return text;
}

// The options that a description gives for abc_v1_00_a, or what is thrown.
std::string Scan(const std::string& description) {
  RepositoryBuilder directory;
  directory.File("f", description);
  try {
    return Dump(
        OptionScanner(Kel_Key(StringBase("abc_v1_00_a")), Port::FileName((directory / "f").c_str()))
            .GetOptions());
  } catch (const AppException& exception) {
    return std::to_string(exception.level) + " " + std::string(exception.what()).substr(0, 20);
  }
}

TEST(OptionScanner, AddsNamesAndDefaults) {
  MessageRecorder recorder;
  const std::string own = "NAME=abc;VERSION=1.00.a;";
  EXPECT_EQ(Scan(""),
            own + "IMP_NETLIST=FALSE;RUN_TRAMFOLD=FALSE;STYLE=HDL;USAGE_LEVEL=ADVANCED_USER;");
  EXPECT_EQ(Scan("OPTION STYLE = MIX\nPORT bad\nOPTION\nOPTION NAME = x\nOPTION style = y\n"
                 "OPTION STYLE = z"),
            own +
                "STYLE=MIX;NAME=x;style=y;STYLE=z;IMP_NETLIST=FALSE;RUN_TRAMFOLD=FALSE;"
                "USAGE_LEVEL=ADVANCED_USER;");
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

TEST(OptionScanner, ReportsEachBadStatement) {
  MessageRecorder recorder;
  EXPECT_EQ(Scan("OPTION A = b\n OPTION\tB # =\n\nOPTION C = \"x # y\"\n"),
            "1 Unable to parse QVR ");
  const auto messages = recorder.Take();
  ASSERT_EQ(messages.size(), 2U);
  EXPECT_THAT(messages[0],
              testing::MatchesRegex(
                  "error s/Tarvo_OptionScanner: QVR unparsable OPTION: /.*/f line 2, OPTION B\n"));
  EXPECT_THAT(messages[1], testing::EndsWith("/f line 4, OPTION C = \"x\n"));
  try {
    const OptionScanner scanner(Kel_Key(StringBase("abc")), Port::FileName("nowhere"));
    FAIL();
  } catch (const AppException& exception) {
    EXPECT_STREQ(exception.what(), "Invalid IP key abc for file nowhere\n");
    EXPECT_EQ(exception.level, AppException::Failure);
  }
}

TEST(OptionScanner, TakesAnyBytes) {
  MessageRecorder recorder;
  EXPECT_THAT(Scan(std::string(1000, '\0') + "\nOPTION A = \xFF\xC3("),
              testing::HasSubstr("A=\xFF\xC3(;"));
  EXPECT_THAT(Scan("OPTION A = " + std::string(3000000, '(') + std::string(3000000, ')')),
              testing::EndsWith("USAGE_LEVEL=ADVANCED_USER;"));
}

TEST(OptionScanner, FindsTheFirstValueAndTracesAMiss) {
  MessageRecorder recorder(MessageRecorder::MessagesAndTraces);
  const PropertyList options = {{"NAME", "n"}, {"A", "1"}, {"A", "2"}};
  EXPECT_EQ(OptionScanner::GetOptionValue(options, "A"), "1");
  EXPECT_THAT(recorder.Take(), IsEmpty());
  EXPECT_EQ(OptionScanner::GetOptionValue(options, "a"), "");
  EXPECT_THAT(recorder.Take(), ElementsAre("trace: Cannot find option a on IP n version \n"));
}

class Options : public testing::Test {
 protected:
  std::string Ask(const char* key, const char* property) {
    StringBase value = "untouched";
    const bool found = library.GetIPProperty(key, property, value);
    return (found ? "" : "no ") + std::string(value);
  }
  std::string Keys() {
    StringList keys;
    EXPECT_TRUE(library.ListAllIPKeys(keys));
    std::string text;
    for (const StringBase& key : keys) text += std::string(key) + " ";
    return text;
  }
  bool Walk() { return library.SetRepositoryPath(repo.Path().c_str()); }

  RepositoryBuilder repo;
  MessageRecorder recorder;
  KelLibrary library;
};

TEST_F(Options, AreAnsweredByTheLibrary) {
  repo.Core("abc_v1_00_a").Qvr("OPTION DESC = one");
  repo.Core("abc_v10_00_a").Qvr("OPTION DESC = ten");
  repo.Core("abc_v20_00_a");
  repo.Core("Abc_v2_00_a").Qvr("");
  EXPECT_TRUE(Walk());
  EXPECT_EQ(Keys(), "Abc_v2_00_a abc_v10_00_a abc_v1_00_a ");
  EXPECT_EQ(Ask("abc", "DESC"), "ten");
  EXPECT_EQ(Ask("abc_v1_00_a", "DESC"), "one");
  EXPECT_EQ(Ask("abc", "NONE"), "");
  EXPECT_EQ(library.GetVersion("abc"), "20.00.a");
  StringList list = {"old"};
  EXPECT_TRUE(library.ListIPProperties("abc_v1_00_a", list));
  EXPECT_THAT(list, ElementsAre("NAME", "VERSION", "DESC", "IMP_NETLIST", "RUN_TRAMFOLD", "STYLE",
                                "USAGE_LEVEL"));
  EXPECT_TRUE(library.ListAllIPProperties(list));
  EXPECT_THAT(list,
              ElementsAre("NAME", "VERSION", "ALERT", "ARCH_SUPPORT", "ARCH_SUPPORT_MAP", "BUS_STD",
                          "CORE_STATE", "DESC", "EARLY_ACCESS_ARCH_SUPPORT", "HDL", "IMP_NETLIST",
                          "IP_GROUP", "IPLEVEL_DRC_PROC", "IPTYPE", "LAST_UPDATED", "LONG_DESC",
                          "MAX_MASTERS", "MAX_SLAVES", "RUN_TRAMFOLD", "SPECIAL", "STYLE",
                          "SYSLEVEL_DRC_PROC", "TCL_FILE", "USAGE_LEVEL"));
  EXPECT_THAT(recorder.Take(), IsEmpty());

  EXPECT_EQ(Ask("abc_v20_00_a", "DESC"), "no untouched");
  EXPECT_FALSE(library.ListIPProperties("x%s", list));
  EXPECT_THAT(list, IsEmpty());
  const std::string error = "error s/Tarvo_KelLibrary: Unable to access IP ";
  EXPECT_THAT(
      recorder.Take(),
      ElementsAre(
          error + "abc_v20_00_a property DESC\nCannot find IP index entry for abc_v20_00_a\n\n",
          error + "x%s properties\nCannot find IP index entry for x%s\n\n"));
}

TEST_F(Options, CountInTheIndex) {
  Kel_Index index;
  const auto add = [&](const std::string& key) {
    Port::FileName location;
    location.SetHead(repo.Core(key).Qvr("OPTION A = " + key).Location().c_str());
    index.AddIP(Kel_Key(StringBase(key.c_str())), location);
  };
  add("abc_v2_00_a");
  const PropertyList& options = index.GetIPOptions(Kel_Key(StringBase("abc")));
  for (const char* key : {"abc_v1_00_a", "abc_v3_00_a", "xyz_v1_00_a", "abc_v1_00_a"}) add(key);
  EXPECT_EQ(OptionScanner::GetOptionValue(options, "A"), "abc_v2_00_a");
  EXPECT_EQ(index.GetBaseIPCount(), 2U);
  EXPECT_EQ(index.GetFullIPCount(), 4U);
  EXPECT_THAT(index.GetLatestIPKeys(), ElementsAre("abc_v3_00_a", "xyz_v1_00_a"));
}

// Descriptions that are refused cost the versions that they belong to their options, and no more.
TEST_F(Options, AreLostOnlyToTheBadVersion) {
  repo.Core("good_v1_00_a").Qvr("OPTION A = 1");
  repo.Core("bad_v1_00_a").Qvr("OPTION A");
  const auto file = [&](const std::string& core) {
    return repo.Core(core + "_v1_00_a").Location() + "/data/" + core + "_v2_1_0.qvr";
  };
  fs::create_directories(file("dir"));
  fs::create_directories(fs::path(file("pipe")).parent_path());
  ASSERT_EQ(::mkfifo(file("pipe").c_str(), 0644), 0);
  repo.Core("shut_v1_00_a").Qvr("OPTION A = 1");
  fs::permissions(fs::path(file("shut")).parent_path(), fs::perms::none);
  {
    const OrdinaryUser user;
    EXPECT_TRUE(Walk());
  }
  fs::permissions(fs::path(file("shut")).parent_path(), fs::perms::all);
  const auto invalid = [&](const std::string& core, const std::string& why) {
    return "error s/Tarvo_KelLibrary: Invalid IP index entry " + core + "_v1_00_a at " +
           repo.Core(core + "_v1_00_a").Location() + "\n" + why + file(core) + "\n\n";
  };
  EXPECT_THAT(recorder.Take(),
              testing::UnorderedElementsAre(
                  "error s/Tarvo_OptionScanner: QVR unparsable OPTION: " + file("bad") +
                      " line 1, OPTION A\n",
                  invalid("bad", "Unable to parse QVR "), invalid("dir", "Cannot read file "),
                  invalid("pipe", "Cannot read file "), invalid("shut", "Cannot read file ")));
  EXPECT_EQ(Keys(), "good_v1_00_a ");
  for (const char* core : {"bad", "dir", "pipe", "shut"})
    EXPECT_EQ(library.GetVersion(core), "1.00.a");
}

}  // namespace
