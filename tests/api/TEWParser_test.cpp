#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "Outcome.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_TEWParser.h"

namespace {

using namespace Tarvo;

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

}  // namespace
