#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "CommandLine.h"
#include "RepositoryBuilder.h"

namespace {

const std::string kKel = KEL_COMMAND;

// What `kel check` finds, with paths from `ipmods` on.
std::string Check(const RepositoryBuilder& repo, const std::string& arguments, int status) {
  const CommandResult result =
      RunCommand("'" + kKel + "' check -L " + repo.Path() + " " + arguments);
  EXPECT_EQ(result.status, status);
  EXPECT_EQ(result.errors, arguments == "nosuch" ? "kel: note: there is no core to check\n" : "");
  std::string output = result.output;
  const std::string root = repo / "ipmods/";
  for (std::size_t at; (at = output.find(root)) != std::string::npos;)
    output.erase(at, root.size());
  return output;
}

RepositoryBuilder::CoreBuilder Good(RepositoryBuilder& repo, const std::string& name) {
  return repo.Core(name + "_v1_00_a")
      .Qvr("OPTION STYLE = MIX\nPARAMETER P = 1")
      .Ldx("lib " + name + " a.vhd")
      .File("hdl/vhdl/a.vhd", "")
      .Tew("P FILES\n1 n.edn\n2 n.edn")
      .File("netlist/n.edn", "");
}

// One core for each fault, and one that includes most of them.
TEST(KelCheck, NamesEachFaultOnceAtItsLine) {
  RepositoryBuilder repo;
  const auto qvr = [&](const char* name, const char* text) { Good(repo, name).Qvr(text); };
  const auto ldx = [&](const char* name, const char* text) { Good(repo, name).Ldx(text); };
  const auto tew = [&](const char* name, const char* text) { Good(repo, name).Tew(text); };
  Good(repo, "good");
  qvr("q1", "OPTION A = b\nOPTION C");
  qvr("q2", "\nPORT a = \"b");
  qvr("q3", "OPTION a:b = c");
  repo.Core("q4_v1_00_a");
  ldx("l1", "lib l1 a.vhd\nlib");
  ldx("l2", "lib l2 a.vhd\nlib nowhere all\n");
  ldx("l3", "\nlib nowhere a.vhd");
  ldx("l4", "lib l4 a.v");
  ldx("l5", "lib l5 a.vhd\nlib l5 a.vhd");
  ldx("l6", "lib l6 a.vhd VDHL");
  ldx("l7", "vlgincdir l7 nothing");
  ldx("l8", "lib l8 a.vhd\nlib l8 b.vhd\nsimlib good c/d");
  repo.Core("l9_v1_00_a").Qvr("");
  ldx("la", "lib lb all");
  ldx("lb", "lib la all");
  tew("t1", "P FILES\n1 n.edn\n2");
  tew("t2", "P FILES\n1 n.edn\n2 m.edn, n.edn");
  tew("t3", "Q FILES\n1 n.edn");
  tew("t4", "FILES\nnowhere:n.edn");
  ldx("top", "lib good all\nlib l5 all\nlib l6 all\nlib l8 all\nlib l1 all");
  const std::string expected =
      "l1_v1_00_a/data/l1_v2_1_0.ldx:2: error: unparsable library entry: lib\n"
      "l2_v1_00_a/data/l2_v2_1_0.ldx:2: error: Unable to analyse library nowhere: Cannot find IP "
      "index entry for nowhere\n"
      "l3_v1_00_a/data/l3_v2_1_0.ldx:2: error: Unable to determine location for library nowhere, "
      "file a.vhd: Cannot find IP key for nowhere\n"
      "l4_v1_00_a/data/l4_v2_1_0.ldx:1: error: File a.v declared to be VHDL\n"
      "l5_v1_00_a/data/l5_v2_1_0.ldx: warning: File l5_v1_00_a:a.vhd is listed "
      "already\n"
      "l6_v1_00_a/data/l6_v2_1_0.ldx:1: error: Unknown HDL language specified: VDHL\n"
      "l7_v1_00_a/data/l7_v2_1_0.ldx:1: error: The include directory nothing for library l7 does "
      "not exist\n"
      "l8_v1_00_a/data/l8_v2_1_0.ldx:2: error: source does not exist: l8_v1_00_a/hdl/vhdl/b.vhd\n"
      "l8_v1_00_a/data/l8_v2_1_0.ldx:3: error: source does not exist: "
      "good_v1_00_a/hdl/vhdl/c/d.vhd\n"
      "l9_v1_00_a/data/l9_v2_1_0.ldx: error: does not exist\n"
      "la_v1_00_a/data/la_v2_1_0.ldx:1: error: Unable to analyse library lb: Circular LDX "
      "definition for lb_v1_00_a\n"
      "lb_v1_00_a/data/lb_v2_1_0.ldx:1: error: Unable to analyse library la: Circular LDX "
      "definition for la_v1_00_a\n"
      "q1_v1_00_a/data/q1_v2_1_0.qvr:2: error: unparsable OPTION: OPTION C\n"
      "q2_v1_00_a/data/q2_v2_1_0.qvr:2: error: unparsable PORT: PORT a = \"b\n"
      "q3_v1_00_a/data/q3_v2_1_0.qvr:1: error: unparsable OPTION: OPTION a:b = c\n"
      "q4_v1_00_a/data/q4_v2_1_0.qvr: error: does not exist\n"
      "t1_v1_00_a/data/t1_v2_1_0.tew:3: error: unparsable file entry: 2\n"
      "t2_v1_00_a/data/t2_v2_1_0.tew:3: error: netlist does not exist: t2_v1_00_a/netlist/m.edn\n"
      "t3_v1_00_a/data/t3_v2_1_0.tew:1: error: unparsable header: Q FILES\n"
      "t4_v1_00_a/data/t4_v2_1_0.tew: error: Unable to list netlists for IP t4_v1_00_a: Cannot "
      "find IP key for nowhere\n"
      "21 cores, 19 errors, 1 warning\n";
  EXPECT_EQ(Check(repo, "", 1), expected);
  EXPECT_EQ(Check(repo, "good 'z*'", 0), "1 core, 0 errors, 0 warnings\n");
  const std::string json = Check(repo, "l4 --json | tr -d ' \n'", 0);
  EXPECT_EQ(json,
            "{\"format_version\":1,\"cores\":1,\"errors\":1,\"warnings\":0,\"findings\":[{\"file\":"
            "\"l4_v1_00_a/data/l4_v2_1_0.ldx\",\"line\":1,\"severity\":\"error\",\"text\":"
            "\"Filea.vdeclaredtobeVHDL\"}]}");
}

// What the library takes as it stands.
TEST(KelCheck, WarnsOfWhatNobodyMeant) {
  RepositoryBuilder repo;
  Good(repo, "good");
  repo.File("ipmods/near_v2_0_a/data/near_v2_1_0.qvr", "");
  repo.File("ipmods/notes/readme", "");
  Good(repo, "x")
      .Ldx("")
      .Tew("P FILES\n1 n.edn n.edn\n1 n.edn m.edn")
      .Qvr(
          "// PORT\nPROT a = b\nOPTIONS c = d\nport e = f\nEND e\nOPTION STYLE = mix\n"
          "OPTION HDL = VDHL, Verilog\nOPTION HDL = none\nOPTION STYLE = none\n"
          "BUS_INTERFACE BUS = B, TYPE = X Y\nPARAMETER P = 1, DESC = (a, (b) c) , D = [1, 2],\n"
          "PORT p = '', DIR = I, VEC = [(P - 1):0], BUS = B:C, IO_IF = B\nPARAMETER P = 2\n"
          "PORT p = P");
  const auto at = [](const std::string& end) { return "x_v1_00_a/data/x_v2_1_0." + end + ": "; };
  const std::string ignored = "warning: begins with no keyword, near which is ";
  const std::string over = "warning: the list is over in front of ";
  const std::string comma = ", with no comma to go on\n";
  const std::string undeclared = "which is not declared\n";
  const std::string again = " is declared already, and the first one counts\n";
  EXPECT_EQ(Check(repo, "", 1),
            "near_v2_0_a: warning: is no core, since its name is no key such as abc_v1_00_a\n" +
                at("ldx") + "warning: lists no source\n" + at("qvr:2") + ignored +
                "PORT, and is ignored: PROT a = b\n" + at("qvr:3") + ignored +
                "OPTION, and is ignored: OPTIONS c = d\n" + at("qvr:4") + ignored +
                "PORT, and is ignored: port e = f\n" + at("qvr:7") +
                "warning: the HDL 'VDHL, Verilog' is none of VHDL, Verilog, MIXED, BOTH\n" +
                at("qvr:10") + over + "'Y'" + comma + at("qvr:11") +
                "warning: ends in a comma, and no statement goes on in the next line\n" +
                at("qvr:12") + "warning: PORT p belongs to the interface B, " + undeclared +
                at("qvr:12") + "warning: PORT p belongs to the interface C, " + undeclared +
                at("qvr:13") + "warning: PARAMETER P" + again + at("qvr:14") + "warning: PORT p" +
                again + at("tew:3") + over + "'m.edn'" + comma +
                "2 cores, 0 errors, 13 warnings\n");
}

// Which line lists a file, and which file that is.
TEST(KelCheck, FindsTheLinesOfMissingFiles) {
  RepositoryBuilder repo;
  Good(repo, "lib").Ldx("lib lib a.vhd\nlib lib s//m.vhd\nlib lib x,y");
  Good(repo, "top")
      .Ldx("lib top m.vhd\nlib lib all\nlib lib m.vhd\nlib gone g.vhd")
      .File("hdl/vhdl/m.vhd", "");
  repo.Core("gone_v1_00_a").Qvr("OPTION STYLE = HLD");
  Good(repo, "net").Tew("FILES\nn.edn\nm.edn, n.edn\ntop:k.edn").File("netlist/m.edn/x", "");
  Good(repo, "dir").Ldx("vlgincdir dir hdl/vhdl/a.vhd\nlib dir a.vhd");
  EXPECT_EQ(Check(repo, "", 1),
            "dir_v1_00_a/data/dir_v2_1_0.ldx: error: include directory is none: "
            "dir_v1_00_a/hdl/vhdl/a.vhd\n"
            "gone_v1_00_a/data/gone_v2_1_0.qvr:1: warning: the STYLE 'HLD' is none of HDL, "
            "BLACKBOX, MIX\n"
            "lib_v1_00_a/data/lib_v2_1_0.ldx:2: error: source does not exist: "
            "lib_v1_00_a/hdl/vhdl/s/m.vhd\n"
            "lib_v1_00_a/data/lib_v2_1_0.ldx:3: error: source does not exist: "
            "lib_v1_00_a/hdl/vhdl/x,y.vhd\n"
            "net_v1_00_a/data/net_v2_1_0.tew:3: error: netlist does not exist: "
            "net_v1_00_a/netlist/m.edn\n"
            "net_v1_00_a/data/net_v2_1_0.tew:4: error: netlist does not exist: "
            "top_v1_00_a/netlist/k.edn\n"
            "top_v1_00_a/data/top_v2_1_0.ldx:3: error: source does not exist: "
            "lib_v1_00_a/hdl/vhdl/m.vhd\n"
            "top_v1_00_a/data/top_v2_1_0.ldx:4: error: source does not exist: "
            "gone_v1_00_a/hdl/vhdl/g.vhd\n"
            "5 cores, 7 errors, 1 warning\n");
  const CommandResult relative = RunCommand("cd " + repo.Path() + "/.. && '" + kKel +
                                            "' check -L $(basename " + repo.Path() + ") '[n]e[t]'");
  EXPECT_EQ(relative.output.substr(0, repo.Path().size()), repo.Path());
  EXPECT_EQ(Check(repo, "nosuch", 1), "0 cores, 0 errors, 0 warnings\n");
}

// A corrupt core changes no other core's answer.
TEST(KelCheck, IsTheSameForAllOthers) {
  RepositoryBuilder repo;
  for (int i = 0; i < 500; ++i) Good(repo, "c" + std::to_string(i));
  const std::string kel = "'" + kKel + "' -L " + repo.Path() + " ";
  const auto ask = [&] {
    return RunCommand(kel + "list; " + kel + "which c1 c499; " + kel +
                      "sources c250 --for synthesis")
        .output;
  };
  EXPECT_EQ(Check(repo, "", 0), "500 cores, 0 errors, 0 warnings\n");
  const std::string before = ask();
  Good(repo, "bad").Qvr("OPTION").Qvr("OPTION A = (").Ldx("lib").Tew("'");
  EXPECT_EQ(ask(), before);
  EXPECT_EQ(Check(repo, "", 1),
            "bad_v1_00_a/data/bad_v2_1_0.qvr:1: error: unparsable OPTION: OPTION A = (\n"
            "501 cores, 1 error, 0 warnings\n");
}

}  // namespace
