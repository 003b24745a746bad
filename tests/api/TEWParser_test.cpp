#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <random>
#include <string>
#include <vector>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "Outcome.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_TEWParser.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;

// How a table is read is among the cases of Readers_test.
TEST(Netlists, FollowTheParameters) {
  IndexedRepository cores;
  const MessageRecorder recorder;
  cores.repo.Core("abc_v1_00_a")
      .Qvr("PARAMETER A = fast\nPARAMETER B = 32")
      .Tew("A B FILES\nfast 32 xyz:c.edn, b.edn\nslow 32 a.edn\nfast 32 xyz_v1_00_a:c.edn, a.edn");
  for (const char* core : {"abc_v1_00_a", "xyz_v1_00_a", "xyz_v2_00_a"}) cores.Add(core);
  const Kel_Key key("abc_v1_00_a");
  QVRParser description(cores.index, key);
  const TEWParser parser(cores.index, key, &description);
  const auto files = [&] { return cores.Shorten(parser.ListFiles()); };
  const auto libraries = [&] {
    return cores.Shorten(Outcome([&] { return Join(parser.ListLibraries()); }));
  };
  const auto library = [&](const std::string& path) {
    const Port::FileName file((cores.repo / "ipmods/" + path).c_str());
    return cores.Shorten(
        Outcome([&] { return std::string(parser.GetFileLibrary(file).GetKey()); }));
  };
  const std::string own = "abc_v1_00_a/netlist/";
  EXPECT_EQ(files(), "xyz_v2_00_a/netlist/c.edn, " + own + "b.edn, xyz_v1_00_a/netlist/c.edn, " +
                         own + "a.edn");
  EXPECT_EQ(libraries(), "abc_v1_00_a, xyz_v1_00_a, xyz_v2_00_a");
  EXPECT_EQ(library("xyz_v2_00_a/netlist/c.edn"), "xyz_v2_00_a");
  EXPECT_EQ(library(own + "a.edn"), "abc_v1_00_a");
  description.SetParameterProperty("A", "VALUE", "slow");
  EXPECT_EQ(files(), own + "a.edn");
  EXPECT_EQ(libraries(), "abc_v1_00_a");
  EXPECT_EQ(library(own + "a.edn"), "abc_v1_00_a");
  EXPECT_EQ(library(own + "b.edn"),
            "failure: Could not find netlist " + own + "b.edn in order to identify library\n");
  cores.index.ClearIP();
  EXPECT_EQ(files(), own + "a.edn");
  EXPECT_EQ(library(own + "a.edn"), "not found: Cannot find IP key for abc_v1_00_a\n");
  EXPECT_EQ(libraries(), "not found: Cannot find IP index entry for abc_v1_00_a\n");
  description.SetParameterProperty("B", "VALUE", "");
  EXPECT_EQ(files() + libraries(), "");
}

struct Row {
  std::string value, path, library;
};

// What a question for the library of a netlist gives, by looking at all rows from the front.
std::string FromTheFront(const std::vector<Row>& rows, const std::string& value,
                         const Port::FileName& file) {
  const StringBase wanted = file.GetAbsolutePath();
  for (const Row& row : rows) {
    if (row.value != value) continue;
    if (Port::FileName(row.path.c_str()).GetAbsolutePath() == wanted) return row.library;
  }
  return std::string("failure: Could not find netlist ") + file.GetName().GetText() +
         " in order to identify library\n";
}

template <class Question>
std::string OutcomeOfPath(const Question& question) {
  try {
    return Outcome(question);
  } catch (const fs::filesystem_error&) {
    return "no current directory";
  }
}

// With relative locations, one directory for two versions, netlists that are called alike, and in
// the end without a current directory.
TEST(Netlists, BelongToTheFirstThatApplies) {
  IndexedRepository cores;
  const std::string relative = "ipmods/rel_v1_00_a", absolute = cores.repo / "ipmods/abc_v1_00_a";
  const std::string libraries[][2] = {
      {"abc_v1_00_a", absolute}, {"abc_v1_00_b", absolute}, {"rel_v1_00_a", relative}};
  const char* const names[] = {"/a.edn", "/b.edn", "/sub/a.edn", ""};
  std::vector<Row> rows;
  std::string table = "A FILES\n";
  std::mt19937 random;
  for (int i = 0; i < 40; ++i) {
    const auto& [library, location] = libraries[random() % 3];
    const std::string name = names[random() % 4], value = random() % 4 == 0 ? "2" : "1";
    rows.push_back({value, location + "/netlist" + name, library});
    table += value + " " + library + ":" + name.substr(name.empty() ? 0 : 1) + "\n";
  }
  cores.repo.Core("rel_v1_00_a").Qvr("");
  cores.repo.Core("abc_v1_00_a").Qvr("PARAMETER A = 1").Tew(table);
  const fs::path before = fs::current_path();
  fs::current_path(cores.repo.Path());
  for (const auto& [library, location] : libraries) {
    Port::FileName directory;
    directory.SetHead(location.c_str());
    ASSERT_TRUE(cores.index.AddIP(Kel_Key(library.c_str()), directory));
  }
  const Kel_Key key("abc_v1_00_a");
  QVRParser description(cores.index, key);
  const TEWParser parser(cores.index, key, &description);
  for (const char* const directory : {"", "ipmods", "gone"}) {
    fs::create_directory(cores.repo / directory);
    fs::current_path(cores.repo / directory);
    fs::remove(cores.repo / "gone");
    for (const Row& row : rows) {
      const char* const value = random() % 2 == 0 ? "1" : "2";
      description.SetParameterProperty("A", "VALUE", value);
      for (const std::string& path : {row.path, cores.repo / "" + row.path, row.path + "x"}) {
        const Port::FileName file(path.c_str());
        EXPECT_EQ(OutcomeOfPath([&] { return std::string(parser.GetFileLibrary(file).GetKey()); }),
                  OutcomeOfPath([&] { return FromTheFront(rows, value, file); }))
            << directory << " " << path;
      }
    }
  }
  fs::current_path(before);
}

}  // namespace
