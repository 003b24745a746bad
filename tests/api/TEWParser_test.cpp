#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "Tarvo_AppException.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_TEWParser.h"

namespace {

using namespace Tarvo;
using testing::ElementsAre;
using testing::IsEmpty;

class Netlists : public testing::Test, protected IndexedRepository {
 protected:
  Netlists() {
    repo.Core("abc_v1_00_a")
        .Qvr(
            "PARAMETER A = fast\nPARAMETER B = 32, TYPE = NON_HDL\nPARAMETER E = ''\n"
            "PARAMETER FILES = 1\nPARAMETER Q = 'x, y'");
    for (const char* core : {"abc_v1_00_a", "xyz_v1_00_a", "xyz_v2_00_a"}) Add(core);
    description = std::make_unique<QVRParser>(index, key);
    recorder.Take();
  }

  // The selected netlists of a table, or what is thrown.
  std::string Read(const std::string& table, bool described = true) {
    repo.Core("abc_v1_00_a").Tew(table);
    try {
      const TEWParser parser(index, key, described ? description.get() : nullptr);
      return Shorten(parser.ListFiles());
    } catch (const AppException& exception) {
      return std::to_string(exception.level) + " " + exception.what();
    }
  }

  const Kel_Key key = Kel_Key(StringBase("abc_v1_00_a"));
  const std::string own = "abc_v1_00_a/netlist/";
  const std::string file = repo / "ipmods/abc_v1_00_a/data/abc_v2_1_0.tew";
  std::unique_ptr<QVRParser> description;
  MessageRecorder recorder;
};

TEST_F(Netlists, TakesLinesByTheirForm) {
  const std::string invalid = "1 Invalid TEW " + file + "\n";
  const std::string refused = "refused";  // the row, by an exception that names it
  const struct {
    const char *header, *row;
    std::string expected;
  } rows[] = {{"FILES", "a.edn", own + "a.edn"},
              {"files and more", "\n a.edn # comment\n\n", own + "a.edn"},
              {"FILES", "a.edn b.edn c.edn", own + "a.edn"},
              {"FILES", "a.edn ,", own + "a.edn"},
              {"FILES", "a.edn,b.edn , 'c d'", own + "a.edn " + own + "b.edn " + own + "c d"},
              {"FILES", ", a.edn", own + ","},
              {"FILES", "a.edn, , b.edn", own + "a.edn " + own + ","},
              {"FILES", "(a, b)", own + "(a " + own + "b)"},
              {"FILES", "sub/a.edn", own + "sub/a.edn"},
              {"FILES", "xyz:c.edn", "xyz_v2_00_a/netlist/c.edn"},
              {"FILES", "\"xyz_v1_00_a:c:d.edn\"", "xyz_v1_00_a/netlist/c:d.edn"},
              {"FILES", ":c.edn", "0 Cannot find IP key for \n"},
              {"FILES", "no:c.edn", "0 Cannot find IP key for no\n"},
              {"FILES", "'a.edn", invalid},
              {"FILES", "\"", invalid},
              {"FILES", "a.edn, 'b.edn", refused},
              {"A B FILES", "fast 32 a.edn", own + "a.edn"},
              {"A B FILES", "'fast' \"32\" a.edn, b.edn", own + "a.edn " + own + "b.edn"},
              {"A FILES", "FAST a.edn\nfast b.edn\nfast c.edn", own + "b.edn " + own + "c.edn"},
              {"B FILES", "0x20 a.edn\n32 b.edn\n32 b.edn", own + "b.edn " + own + "b.edn"},
              {"E Q FILES", "'' \"x, y\" a.edn\n'' x a.edn", own + "a.edn"},
              {"A B FILES", "fast 32", refused},
              {"A B FILES", "fast", refused},
              {"A B FILES", "fast, 32 a.edn", ""},
              {"A B FILES", "fast '32 a.edn", refused},
              {"A B A FILES", "fast 32 fast a.edn", own + "a.edn"},
              {"FILES", "", ""}};
  for (const auto& [header, row, expected] : rows) {
    SCOPED_TRACE(std::string(header) + " / " + row);
    const std::string read = Read(std::string("# table\n\n") + header + "\n" + row);
    const std::string why = "1 TEW unparsable file entry: " + file + " line 4, " + row + "\n";
    EXPECT_EQ(read, expected == refused ? why : expected);
  }
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

// A line that is no header leaves its names, and the next line gets its turn.
TEST_F(Netlists, TriesEachLineAsHeader) {
  const auto unparsable = [&](int line, const std::string& text) {
    return "error s/Tarvo_TEWParser: TEW unparsable header: " + file + " line " +
           std::to_string(line) + ", " + text + "\n";
  };
  EXPECT_EQ(Read("A B\n'A FILES\nA FILES\nfast 32 fast a.edn"), own + "a.edn");
  EXPECT_THAT(recorder.Take(), ElementsAre(unparsable(1, "A B")));
  EXPECT_EQ(Read("A, B FILES\na FILES\nB 'A\nFILES\nfast 32 a.edn"), own + "a.edn");
  EXPECT_THAT(recorder.Take(), ElementsAre(unparsable(1, "A, B FILES"), unparsable(2, "a FILES"),
                                           unparsable(3, "B 'A")));
  EXPECT_EQ(Read("A FILES\nfast a.edn", false), "1 Invalid TEW " + file + "\n");
  EXPECT_EQ(recorder.Take().size(), 2U);
  for (const char* none : {"", "# FILES", "\"FILES"}) {
    EXPECT_EQ(Read(none), "1 Invalid TEW " + file + "\n");
  }
  EXPECT_EQ(Read("FILES\na.edn", false), own + "a.edn");
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

// The text of what an operation throws.
template <class Operation>
std::string NotFound(const Operation& operation) {
  try {
    operation();
    return "nothing";
  } catch (const AppException& exception) {
    return exception.what();
  }
}

TEST_F(Netlists, FollowTheParameters) {
  repo.Core("abc_v1_00_a")
      .Tew("A B FILES\nfast 32 xyz:c.edn, b.edn\nslow 32 a.edn\nfast 32 xyz_v1_00_a:c.edn, a.edn");
  const TEWParser parser(index, key, description.get());
  EXPECT_EQ(Shorten(parser.ListFiles()), "xyz_v2_00_a/netlist/c.edn " + own +
                                             "b.edn xyz_v1_00_a/netlist/c.edn " + own + "a.edn");
  EXPECT_EQ(Shorten(parser.ListLibraries()), "abc_v1_00_a xyz_v1_00_a xyz_v2_00_a");
  const auto library = [&](const std::string& path) {
    return parser.GetFileLibrary(Port::FileName((repo / "ipmods/" + path).c_str())).GetKey();
  };
  EXPECT_EQ(library("xyz_v2_00_a/netlist/c.edn"), "xyz_v2_00_a");
  EXPECT_EQ(library(own + "a.edn"), "abc_v1_00_a");
  description->SetParameterProperty("A", "VALUE", "slow");
  EXPECT_EQ(Shorten(parser.ListFiles()), own + "a.edn");
  EXPECT_EQ(Shorten(parser.ListLibraries()), "abc_v1_00_a");
  EXPECT_EQ(library(own + "a.edn"), "abc_v1_00_a");
  try {
    library(own + "b.edn");
    FAIL();
  } catch (const AppException& exception) {
    EXPECT_EQ(exception.level, AppException::Failure);
    EXPECT_EQ(exception.what(), "Could not find netlist " + (repo / "ipmods/" + own) +
                                    "b.edn in order to identify library\n");
  }
  EXPECT_EQ(NotFound([&] { parser.GetFileLibrary(Port::FileName("a.edn")); }),
            "Could not find netlist a.edn in order to identify library\n");
  const std::string path = own + "a.edn";
  index.ClearIP();
  EXPECT_EQ(NotFound([&] { library(path); }), "Cannot find IP key for abc_v1_00_a\n");
  EXPECT_EQ(NotFound([&] { parser.ListLibraries(); }),
            "Cannot find IP index entry for abc_v1_00_a\n");
  EXPECT_EQ(Shorten(parser.ListFiles()), path);
  description->SetParameterProperty("B", "VALUE", "");
  EXPECT_THAT(parser.ListFiles(), IsEmpty());
  EXPECT_THAT(parser.ListLibraries(), IsEmpty());
}

TEST_F(Netlists, TraceAndRefuseTheirFile) {
  EXPECT_THROW(TEWParser(index, Kel_Key(StringBase("none")), nullptr), AppException);
  EXPECT_THROW(TEWParser(index, key, nullptr), AppException);
  repo.Core("abc_v1_00_a").Tew("FILES");
  recorder.Take();
  MessageRecorder traces(MessageRecorder::MessagesAndTraces);
  const TEWParser parser(Port::FileName(file.c_str()), index, key, nullptr);
  EXPECT_THAT(traces.Take(),
              ElementsAre("trace:   Parsing TEW File for abc_v1_00_a\n",
                          "trace: Opening File " + file + "\n", "trace: Closed File " + file + "\n",
                          "trace:   Parse successful\n"));
}

}  // namespace
