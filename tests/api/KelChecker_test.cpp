#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "MessageRecorder.h"
#include "RepositoryBuilder.h"
#include "Tarvo_KelChecker.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;

class Checker : public testing::Test {
 protected:
  // A core without a fault, and what it has beside the file that a test writes anew.
  RepositoryBuilder::CoreBuilder Good(const std::string& name) {
    return repo.Core(name + "_v1_00_a")
        .Qvr("OPTION STYLE = MIX\nPARAMETER P = 1")
        .Ldx("lib " + name + " a.vhd")
        .File("hdl/vhdl/a.vhd", "")
        .Tew("P FILES\n1 n.edn\n2 n.edn")
        .File("netlist/n.edn", "");
  }

  // A place as "l5.ldx:2:8+5", or a path below `ipmods`.
  std::string Dump(const KelPlace& place) const {
    std::string file = place.file.GetText();
    const std::string root = repo / "ipmods/";
    if (file.rfind(root, 0) == 0) file.erase(0, root.size());
    const std::size_t data = file.find("/data/");
    if (data != std::string::npos) file.erase(0, data + 6);
    const std::size_t version = file.find("_v2_1_0");
    if (version != std::string::npos) file.erase(version, 7);
    if (place.line == 0) return file;
    return file + ":" + std::to_string(place.line) + ":" + std::to_string(place.column) + "+" +
           std::to_string(place.length);
  }
  std::string Dump(const std::vector<KelDiagnostic>& found) const {
    std::string text;
    for (const KelDiagnostic& one : found) {
      const char* const severities[] = {"note ", "", "error "};
      std::string line = Dump(one.place) + " " + severities[one.severity] + one.code.GetText() +
                         ": " + one.text.GetText();
      if (one.hint.GetLength() > 0) line += std::string(" | ") + one.hint.GetText();
      for (const KelRelatedPlace& other : one.related) {
        line += " @ " + Dump(other.place) + " " + other.text.GetText();
      }
      const std::string root = repo / "ipmods/";
      for (std::size_t at; (at = line.find(root)) != std::string::npos;)
        line.erase(at, root.size());
      text += line + "\n";
    }
    return text;
  }
  // What is wrong with the whole library. Nothing is issued.
  std::string Check() {
    const MessageRecorder messages;
    KelLibrary library;
    library.SetRepositoryPath(repo.Path().c_str());
    MessageRecorder recorder;
    const std::string found = Dump(KelChecker(library).CheckLibrary());
    EXPECT_TRUE(recorder.Take().empty());
    return found;
  }

  RepositoryBuilder repo;
};

TEST_F(Checker, FindsEachFaultOnceAtItsPlace) {
  const auto qvr = [&](const char* name, const char* text) { Good(name).Qvr(text); };
  const auto ldx = [&](const char* name, const char* text) { Good(name).Ldx(text); };
  const auto tew = [&](const char* name, const char* text) { Good(name).Tew(text); };
  Good("good");
  qvr("q1", "OPTION STYLE = MIX\nPARAMETER P = 1\nOPTION C\n\tPORT a = \"b # c\nOPTION a:b = c");
  repo.Core("q4_v1_00_a");
  ldx("l1", "lib l1 a.vhd\nlib\nlib nowhere all\n\nlib goood a.vhd\nlib good_v9_00_a a");
  ldx("l4", "lib l4 a.v\nlib l4 a.vhd VDHL\nlib l4 a.vhd\nLib l4 a\nlib l4 a.vhd 'VHDL' x");
  Good("l5").Qvr("OPTION HDL = BOTH").Ldx("lib l5 a\nlib l5 a.vhd VHDL\nlib l5 a.vhd");
  ldx("l6", "lib l6 a.vhd\nsynlib l6 a.vhd\nlib l6 b\nsimlib good c/d");
  ldx("l7",
      "vlgincdir l7 nothing\nVLGINCDIR l7 hdl\nvlgincdir l7 hdl x\nvlgincdir l7 hdl\n"
      "vlgincdir l7 data\nvlgincdir l\nlib l7 a.vhd\nlib l7 ( x y ) VHDL\n"
      "vlgincdir good hdl/vhdl/a.vhd");
  repo.Core("l9_v1_00_a").Qvr("");
  ldx("la", "lib la a.vhd\nlib lb all");
  ldx("lb", "lib lb a.vhd\nlib lc all");
  ldx("lc", "lib la all");
  ldx("le", "");
  tew("t1", "P FILES\n1 n.edn\n2\n1 'n.edn");
  tew("t2", "P FILES\n1 n.edn\n2 m.edn, n.edn\n1 n.edn m.edn\n1, n.edn\n3 n.edn,");
  tew("t3", "Q p P FILES\n1 2 3 n.edn\n1 n.edn");
  tew("t4", "P P FILES\n1 1 n.edn\n1 2 n.edn\n3 3 noware:n.edn\n3 3 q4:n.edn");
  tew("t5", "1 n.edn\n2 n.edn");
  Good("t6").Qvr("OPTION STYLE = BLACKBOX\nPARAMETER P = 1, VALUES = (1: a; 3: b)");
  fs::remove(repo / "ipmods/t6_v1_00_a/netlist/n.edn");
  Good("t7").Qvr("OPTION STYLE = BLACKBOX");
  fs::remove(repo / "ipmods/t7_v1_00_a/data/t7_v2_1_0.tew");
  ldx("top", "lib top a.vhd\nlib good all\nlib l6 all\nlib l9 all\nlib l1 all");
  repo.File("ipmods/near_v2_0_a/data/near_v2_1_0.qvr", "");
  repo.File("ipmods/notes/readme", "");
  EXPECT_EQ(
      Check(),
      "l1.ldx:2:4+0 error bad-entry: missing library\n"
      "l1.ldx:3:5+7 error unknown-library: there is no core 'nowhere'\n"
      "l1.ldx:5:5+5 error unknown-library: there is no core 'goood' | did you mean good?\n"
      "l1.ldx:6:5+12 error unknown-library: there is no core 'good_v9_00_a' | the versions of this "
      "core are good_v1_00_a\n"
      "l4.ldx:1:8+3 error language-mismatch: 'a.v' can't be VHDL by its extension\n"
      "l4.ldx:2:14+4 error unknown-language: unknown language 'VDHL'; the source is left out | did "
      "you mean VHDL?\n"
      "l4.ldx:4:1+3 error bad-entry: unknown keyword | did you mean lib?\n"
      "l4.ldx:5:21+1 error bad-entry: nothing may follow the language\n"
      "l5.ldx:1:8+1 error no-language: the language of 'a' is unknown: it has no extension "
      "v or vhd, and no language is given\n"
      "l5.ldx:2:14+4 error language-not-allowed: a core of HDL BOTH names no languages; the "
      "source is left out\n"
      "l6.ldx:2:11+5 duplicate-source: 'a.vhd' of l6_v1_00_a is listed already for synthesis @ "
      "l6.ldx:1:8+5 first listed here\n"
      "l6.ldx:3:8+1 error missing-source: source does not exist: l6_v1_00_a/hdl/vhdl/b.vhd\n"
      "l6.ldx:4:13+3 error missing-source: source does not exist: "
      "good_v1_00_a/hdl/vhdl/c/d.vhd\n"
      "l7.ldx:1:14+7 error missing-include-directory: include directory does not exist: nothing\n"
      "l7.ldx:2:1+9 ignored-entry: the entry is ignored; write vlgincdir in small letters\n"
      "l7.ldx:3:18+1 ignored-entry: the entry is ignored, because something follows the directory\n"
      "l7.ldx:5:11+2 error duplicate-include-directory: 'l7' has an include directory already @ "
      "l7.ldx:4:14+3 first given here\n"
      "l7.ldx:6:12+0 error bad-entry: missing directory\n"
      "l7.ldx:8:8+7 error missing-source: source does not exist: l7_v1_00_a/hdl/vhdl/( x y ).vhd\n"
      "l7.ldx:9:16+14 error missing-include-directory: include directory is not a directory: "
      "l7_v1_00_a/hdl/vhdl/a.vhd\n"
      "l9.ldx error missing-order: the file does not exist\n"
      "la.ldx:2:5+2 error include-circle: circle of includes: la_v1_00_a, lb_v1_00_a, lc_v1_00_a, "
      "la_v1_00_a | take one of the includes out @ lb.ldx:2:5+2 includes lc_v1_00_a @ "
      "lc.ldx:1:5+2 includes la_v1_00_a\n"
      "le.ldx empty-order: the order lists no source\n"
      "le_v1_00_a/hdl/vhdl/a.vhd note unlisted-file: nothing lists this file\n"
      "near_v2_0_a not-a-key: this directory is ignored: its name is not a key such as "
      "abc_v1_00_a\n"
      "q1.qvr:3:9+0 error bad-statement: missing '=' after the name\n"
      "q1.qvr:4:11+2 error bad-statement: quote is not closed | '#' begins a comment, "
      "in "
      "quotes too\n"
      "q1.qvr:5:9+1 error bad-statement: missing '=' after the name\n"
      "q4.qvr error missing-description: the file does not exist\n"
      "t1.tew:3:2+0 error bad-row: missing netlist after the values\n"
      "t1.tew:4:3+6 error bad-row: quote is not closed\n"
      "t2.tew:3:3+5 error missing-netlist: netlist does not exist: t2_v1_00_a/netlist/m.edn\n"
      "t2.tew:4:3+5 duplicate-row: 'n.edn' is already listed for these values @ t2.tew:2:3+5 first "
      "listed here\n"
      "t2.tew:4:9+5 list-ends: missing ',' before m.edn; the rest of the line is ignored | write "
      "n.edn, m.edn\n"
      "t2.tew:5:2+1 row-never-applies: the comma is read as a netlist | separate values by blanks "
      "only\n"
      "t2.tew:6:8+1 trailing-comma: the row ends in a comma, but can't continue on the next line | "
      "remove the comma\n"
      "t3.tew:1:1+1 error unknown-parameter: the core has no parameter 'Q'\n"
      "t3.tew:1:3+1 error unknown-parameter: the core has no parameter 'p'\n"
      "t3.tew:3:8+0 error bad-row: missing value\n"
      "t4.tew:3:3+1 row-never-applies: the row gives P two values: '1' and '2'\n"
      "t4.tew:4:5+6 error unknown-library: there is no core 'noware'\n"
      "t4.tew:5:5+8 error missing-netlist: netlist does not exist: q4_v1_00_a/netlist/n.edn\n"
      "t5.tew:1:1+7 error bad-header: missing header: names of parameters, then FILES\n"
      "t6.tew:2:3+5 error missing-netlist: netlist does not exist: t6_v1_00_a/netlist/n.edn\n"
      "t6.tew:3:1+1 row-never-applies: P does not take the value '2'\n"
      "t6.tew:3:3+5 error missing-netlist: netlist does not exist: t6_v1_00_a/netlist/n.edn\n"
      "t7.tew error missing-table: the file does not exist\n");
}

TEST_F(Checker, LooksIntoDescriptions) {
  Good("x").Qvr(
      "// PORT\nPROT a = b\nOPTIONS c = d\nport e = f\nEND e\nOPTION STYLE = mix\n"
      "OPTION HDL = VDHL, Verilog\nOPTION HDL = none\nOPTION VERSION = 1\nOPTION IMP_NETLSIT = 1\n"
      "BUS_INTERFACE BUS = B1, BUS_TYPE = X Y\nBUS_INTERFACE BUS = B1\n"
      "PARAMETER P = 1, DESC = (a, (b) c) , D = [1, 2],\n"
      "PORT p = '', DIR = I, VEC = [(P - 1):0], BUS = B1:C, IO_IF = B1\nPARAMETER P = 2\n"
      "\tPORT p = P, DIRR = I, DIR = X, DIR = O, ENDIAN = little, SIGIS = INTERUPT\n"
      "PORT q = q(1), DIR = I, VEC = [1:0]\nPORT r = \"(q\", DIR = I VEC = [1:0]\n"
      "PORT s = s, VEC = [7..0], DEFAULT = 1\nPARAMETER R = 1, RANGE = 1:2, TYPE = NONHDL\n"
      "PORT t = t, VEC = [R-1:0x0*(2+P)]");
  Good("y").Qvr("OPTION STYLE = MIX\nPARAMETER P = 1\nPORT s = s, VEC = [Q-1:0], BUS = B1");
  const std::string ends = "; the rest of the line is ignored";
  const std::string rest = ends + "\n";
  const std::string ignored =
      " unknown-keyword: unknown keyword; the line is ignored | did you mean ";
  const std::string again = " is declared already; the first one counts @ ";
  EXPECT_EQ(
      Check(),
      "x.qvr:2:1+4" + ignored + "PORT?\nx.qvr:3:1+7" + ignored + "OPTION?\nx.qvr:4:1+4" + ignored +
          "PORT?\nx.qvr:7:14+13 bad-value: HDL can't be 'VDHL, Verilog' | write VHDL, Verilog, "
          "MIXED "
          "or BOTH\n"
          "x.qvr:8:8+3 duplicate-name: OPTION 'HDL'" +
          again +
          "x.qvr:7:8+3 first declared here\n"
          "x.qvr:9:8+7 duplicate-name: 'VERSION' is set already; this value is ignored\n"
          "x.qvr:10:8+11 unknown-property: unknown option 'IMP_NETLSIT' | did you mean "
          "IMP_NETLIST?\n"
          "x.qvr:11:38+1 list-ends: missing ',' or quotes before 'Y'" +
          rest + "x.qvr:12:21+2 duplicate-name: BUS_INTERFACE 'B1'" + again +
          "x.qvr:11:21+2 first declared here\n"
          "x.qvr:13:48+1 trailing-comma: the statement ends in a comma, but can't continue on the "
          "next line | remove the comma\n"
          "x.qvr:14:51+1 undeclared-interface: bus interface 'C' of this port is not declared\n"
          "x.qvr:14:62+2 undeclared-interface: I/O interface 'B1' of this port is not declared\n"
          "x.qvr:15:11+1 duplicate-name: PARAMETER 'P'" +
          again +
          "x.qvr:13:11+1 first declared here\n"
          "x.qvr:16:7+1 duplicate-name: PORT 'p'" +
          again +
          "x.qvr:14:6+1 first declared here\n"
          "x.qvr:16:14+4 unknown-property: unknown property 'DIRR' | did you mean DIR?\n"
          "x.qvr:16:30+1 bad-value: DIR can't be 'X' | write I, O or IO\n"
          "x.qvr:16:33+3 duplicate-name: 'DIR' is given already; the first one counts @ "
          "x.qvr:16:24+3 first given here\n"
          "x.qvr:16:67+8 bad-value: SIGIS can't be 'INTERUPT' | did you mean INTERRUPT?\n"
          "x.qvr:17:11+1 list-ends: missing ',' or quotes before '('" +
          rest + "x.qvr:18:24+3 list-ends: missing ',' before VEC" + ends +
          " | write DIR = I, VEC = [1:0]\n" +
          "x.qvr:19:19+6 bad-range: range can't be read: [7..0] | write [LEFT:RIGHT]\n"
          "x.qvr:19:27+7 duplicate-name: 'DEFAULT' is set already; this value is ignored\n"
          "x.qvr:20:26+3 bad-range: range can't be read: 1:2 | write (LOW:HIGH), or values with "
          "commas between\n"
          "x.qvr:20:38+6 bad-value: TYPE can't be 'NONHDL' | did you mean NON_HDL?\n"
          "y.qvr:3:20+1 bad-range: the core has no parameter 'Q'\n"
          "y.qvr:3:34+2 undeclared-interface: bus interface 'B1' of this port is not declared\n");
}

// Whoever takes in a core by two versions is told once, with both ways.
TEST_F(Checker, FindsTwoVersionsInOneOrder) {
  for (const char* key : {"m_v1_00_a", "m_v2_00_a"}) {
    repo.Core(key).Qvr("").Ldx("lib " + std::string(key) + " a.vhd").File("hdl/vhdl/a.vhd", "");
  }
  Good("u1").Ldx("lib u1 a.vhd\nlib m_v1_00_a all");
  Good("u2").Ldx("lib u2 a.vhd\nlib u1 all\nlib m all");
  Good("u3").Ldx("lib u3 a.vhd\nlib u2 all");
  Good("u4").Ldx("lib u4 a.vhd\nlib u1 a.vhd\nlib m a.vhd");  // single sources bring no includes
  const std::string expected =
      "u1.ldx:2:5+9 version-conflict: m_v1_00_a and the newer m_v2_00_a are both in one order | "
      "use m_v2_00_a everywhere @ u2.ldx:2:5+2 u2_v1_00_a includes u1_v1_00_a @ u2.ldx:3:5+1 "
      "u2_v1_00_a includes m_v2_00_a\n";
  EXPECT_EQ(Check(), expected);
  KelLibrary library;
  library.SetRepositoryPath(repo.Path().c_str());
  EXPECT_EQ(Dump(KelChecker(library).CheckCore("u2")), expected);
  EXPECT_EQ(Dump(KelChecker(library).CheckCores({"u1", "u4", "nope"})),
            " error unknown-library: there is no core 'nope'\n");
}

// However cores include each other, each file is read once in an analysis. Whoever asks the library
// meanwhile gets its answers, and its messages.
TEST_F(Checker, LeavesTheLibraryAsItIs) {
  std::string all;
  for (const char* name : {"a", "b", "c", "d", "e", "f", "g", "h"}) {
    all += std::string("lib ") + name + " all\n";
  }
  for (const char* name : {"a", "b", "c", "d", "e", "f", "g", "h"}) Good(name).Ldx(all);
  MessageRecorder recorder;
  KelLibrary library;
  library.SetRepositoryPath(repo.Path().c_str());
  const std::unique_ptr<KelIP> core(library.CreateIP("a"));
  const auto ask = [&] {
    StringList list;
    core->ListSynthesisSources(list);
    return recorder.Take();
  };
  const std::vector<std::string> before = ask();
  EXPECT_EQ(before.size(), 3U);
  std::size_t cores = 0;
  KelChecker(library).CheckLibrary([&](std::size_t done, std::size_t total) {
    EXPECT_EQ(done, ++cores);
    EXPECT_EQ(total, 8U);
    EXPECT_EQ(ask(), before);
  });
  EXPECT_EQ(cores, 8U);
}

// What others may write, and mean.
TEST_F(Checker, TakesWhatIsPlausible) {
  Good("v").Qvr("OPTION HDL = Verilog").Ldx("lib v b.v").File("hdl/verilog/b.v", "");
  fs::remove_all(repo / "ipmods/v_v1_00_a/hdl/vhdl");
  fs::remove_all(repo / "ipmods/v_v1_00_a/netlist");
  Good("t")
      .Qvr(
          "OPTION STYLE = MIX\nPARAMETER P = 1, VALUES = (1 = one, \"2\" : two)\n"
          "PARAMETER N = 2, RANGE = (\"a\",\"b\"), VALUES = (any text, other)\n"
          "PORT p = q, VEC = [log2(N)-1:2**N], OWN = 1, ID = x")
      .Ldx("lib t a.vhd\nlib v all")
      .Tew("Z FILES\nP N FILES\n1 x n.edn\n2 y n.edn");
  const std::string expected =
      "t.tew:1:1+1 error unknown-parameter: the core has no parameter 'Z'\n";
  EXPECT_EQ(Check(), expected);
  KelLibrary library;
  library.SetRepositoryPath(repo.Path().c_str());
  EXPECT_EQ(Dump(KelChecker(library).CheckCore("t")), expected);
}

TEST_F(Checker, SeesWhatIsNearlyRight) {
  Good("x")
      .Qvr(
          "\xEF\xBB\xBFOPTION STYLE = MIXX\nPORT\nPORT = a\nPORT a = b,, DIR = I\n"
          "PORT b = , DIR = I\nPORT c = d, DRI = I, DIR == O\nPARAMETER Y = 8; RANGE = (1:2)\n"
          "PORT e = f, BUS = G\nPORT g = h, BUS = G")
      .Ldx("lib x a.vhd\nlib x ./a.vhd\nlib x ../vhdl//a.vhd")
      .Tew("Y, Q FILES\n1, n.edn\n1 1 :n.edn, x:\n2 2 n.edn; m.edn");
  EXPECT_EQ(
      Check(),
      "x.ldx:2:7+7 duplicate-source: x_v1_00_a/hdl/vhdl/./a.vhd is listed already under another "
      "name @ x.ldx:1:7+5 first listed here\n"
      "x.ldx:3:7+14 duplicate-source: x_v1_00_a/hdl/vhdl/../vhdl/a.vhd is listed already under "
      "another name @ x.ldx:1:7+5 first listed here\n"
      "x.qvr:1:16+4 bad-value: STYLE can't be 'MIXX' | did you mean MIX?\n"
      "x.qvr:2:1+4 unknown-keyword: the line is ignored; a keyword has a blank and a name after "
      "it\n"
      "x.qvr:3:6+1 error bad-statement: missing name before '='\n"
      "x.qvr:4:12+1 error bad-statement: one comma too many\n"
      "x.qvr:5:10+1 list-ends: missing value after '='; the rest of the line is ignored\n"
      "x.qvr:6:13+3 unknown-property: unknown property 'DRI' | did you mean DIR?\n"
      "x.qvr:6:27+1 list-ends: '=' stands twice; the rest of the line is ignored\n"
      "x.qvr:7:18+5 list-ends: missing ',' before RANGE; the rest of the line is ignored | write "
      "Y = 8, RANGE = (1:2)\n"
      "x.qvr:8:19+1 undeclared-interface: bus interface 'G' of this port is not declared @ "
      "x.qvr:9:19+1 named here too\n"
      "x.tew:1:2+1 error bad-header: a comma is read as a name | separate names by blanks only\n"
      "x.tew:1:4+1 error unknown-parameter: the core has no parameter 'Q'\n"
      "x.tew:2:2+1 row-never-applies: the comma is read as a value | separate values by blanks "
      "only\n"
      "x.tew:3:5+6 error unknown-library: missing library before ':'\n"
      "x.tew:3:13+2 error missing-netlist: missing netlist after ':'\n"
      "x.tew:4:5+6 error missing-netlist: netlist does not exist: x_v1_00_a/netlist/n.edn;\n"
      "x.tew:4:12+5 list-ends: missing ',' before m.edn; the rest of the line is ignored | write "
      "n.edn, m.edn\n");
}

// A log has each fault once, however many messages follow from it, with the lines that lead to it.
TEST_F(Checker, LogsWhatAnOperationMeets) {
  Good("in").Ldx("lib in a.vhd VDHL\nlib in a.vhd\nlib nope a");
  Good("mid").Ldx("lib mid a.vhd\nlib in all");
  Good("top").Ldx("\nlib mid all").Tew("P FILES\n1 'n.edn");
  repo.Core("bad_v1_00_a").Qvr("PORT p").Ldx("");
  repo.Core("odd_v1_00_a").Qvr("OPTION A");
  const MessageRecorder messages;
  const KelDiagnosticLog log;
  KelLibrary library;
  library.SetRepositoryPath(repo.Path().c_str());
  EXPECT_EQ(Dump(log.Take()), "odd.qvr:1:9+0 error bad-statement: missing '=' after the name\n");
  const std::unique_ptr<KelIP> top(library.CreateIP("top"));
  StringList list;
  EXPECT_FALSE(top->ListSynthesisSources(list));
  const std::string in = " @ mid.ldx:2:0+0 taken in from here @ top.ldx:2:0+0 taken in from here\n";
  EXPECT_EQ(Dump(log.Take()),
            "in.ldx:1:14+4 error unknown-language: unknown language 'VDHL'; the source is left out "
            "| did you mean VHDL?" +
                in + "in.ldx:3:5+4 error unknown-library: there is no core 'nope'" + in);
  EXPECT_FALSE(top->ListNetlists(list));
  EXPECT_EQ(Dump(log.Take()), "top.tew:2:3+6 error bad-row: quote is not closed\n");
  EXPECT_EQ(library.CreateIP("bad"), nullptr);
  EXPECT_EQ(Dump(log.Take()), "bad.qvr:1:7+0 error bad-statement: missing '=' after the name\n");
  library.GetLocation("nope");
  EXPECT_EQ(Dump(log.Take()),
            " error failed: Unable to get location for IP nope\nCannot find IP index entry for "
            "nope\n");
  fs::remove(repo / "ipmods/in_v1_00_a/data/in_v2_1_0.ldx");
  EXPECT_FALSE(top->ListSynthesisSources(list));
  EXPECT_EQ(Dump(log.Take()), "in.ldx error missing-order: the file does not exist" + in);
}

}  // namespace
