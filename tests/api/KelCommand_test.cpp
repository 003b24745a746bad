#include <gtest/gtest.h>

#include <string>

#include "CommandLine.h"
#include "RepositoryBuilder.h"

namespace {

const std::string kKel = KEL_COMMAND;
const std::string kExamples = KEL_EXAMPLES;

CommandResult Kel(const std::string& arguments) {
  return RunCommand("cd '" + kExamples + "' && '" + kKel + "' " + arguments);
}

std::string Line(const std::string& name, const std::string& version, const std::string& suffix,
                 const std::string& repository) {
  const std::string key = name + suffix;
  return key + "\t" + name + "\t" + version + "\t" + kExamples + "/" + repository + "/ipmods/" +
         key + "\n";
}

TEST(KelWhich, WritesOneLineForEachKey) {
  const CommandResult result =
      Kel("-L repository which word_fifo pulse_counter_V1_01_B pulse_counter");
  EXPECT_EQ(result.status, 0);
  EXPECT_EQ(result.output, Line("word_fifo", "1.00.a", "_v1_00_a", "repository") +
                               Line("pulse_counter", "1.01.b", "_v1_01_b", "repository") +
                               Line("pulse_counter", "2.00.a", "_v2_00_a", "repository"));
  EXPECT_EQ(result.errors, "");
}

TEST(KelWhich, TakesTheFirstRepository) {
  const std::string overlaid = Line("pulse_counter", "2.00.a", "_v2_00_a", "overlay");
  EXPECT_EQ(Kel("-L overlay -L repository which pulse_counter").output, overlaid);
  EXPECT_EQ(Kel("which pulse_counter --library 'overlay;repository'").output, overlaid);
  EXPECT_EQ(Kel("-L repository -L overlay which pulse_counter").output,
            Line("pulse_counter", "2.00.a", "_v2_00_a", "repository"));
}

TEST(KelWhich, TellsBadInputByItsStatus) {
  const RepositoryBuilder empty;
  struct Row {
    std::string arguments;
    int status;
    std::string errors;  // how they begin
    bool answers;
  };
  const Row rows[] = {
      {"-L repository which nope word_fifo", 1,
       "kel: error: Unable to get location for IP nope\n  Cannot find IP index entry for nope\n",
       true},
      {"-L nowhere which word_fifo", 3,
       "kel: error: Unable to set repository path to nowhere\n  Invalid path directory nowhere\n",
       false},
      {"-L '" + empty.Path() + "' -L repository which word_fifo", 0,
       empty.Path() +
           ": warning[not-a-repository]: this is no repository, it has no subdirectory ipmods\n",
       true},
      {"-L repository which", 2, "kel: error: KEY is required\n", false},
      {"wich word_fifo", 2, "kel: error: unknown verb 'wich'; did you mean which?", false},
      {"-L '' which word_fifo", 2, "kel: error: -L needs", false},
      {"which word_fifo", 2, "kel: error: -L DIR is required", false},
      {"-L repository", 2, "kel: error: a verb is required: ", false},
      {"-L repository which --nonsense word_fifo", 2,
       "kel: error: unexpected argument '--nonsense'", false},
      {"-L repository which word_fifo >/dev/full", 1,
       "kel: error: Unable to write to standard output\n", false}};
  for (const Row& row : rows) {
    SCOPED_TRACE(row.arguments);
    const CommandResult result = Kel(row.arguments);
    EXPECT_EQ(result.status, row.status);
    EXPECT_EQ(result.errors.substr(0, row.errors.size()), row.errors);
    EXPECT_EQ(result.output,
              row.answers ? Line("word_fifo", "1.00.a", "_v1_00_a", "repository") : "");
  }
}

TEST(KelList, ListsTheNewestOrAllVersions) {
  RepositoryBuilder repo;
  repo.Core("b_v2_00_a").Qvr("OPTION DESC = two");
  repo.Core("b_v10_00_a").Qvr("OPTION HDL = VHDL");
  repo.Core("b_v20_00_a");
  repo.Core("a_v1_00_a").Qvr("OPTION STYLE");
  repo.Core("c_v1_00_a").Qvr("OPTION STYLE = MIX");
  const std::string at = repo / "ipmods/";
  const std::string newest = "b_v10_00_a\tHDL\tVHDL\t" + at + "b_v10_00_a\t\n";
  const std::string last = "c_v1_00_a\tMIX\t\t" + at + "c_v1_00_a\t\n";
  const CommandResult result = Kel("list -L " + repo.Path());
  EXPECT_EQ(result.status, 1);
  EXPECT_EQ(result.output, newest + last);
  EXPECT_EQ(result.errors,
            at + "a_v1_00_a/data/a_v2_1_0.qvr:1:13: error[bad-statement]: missing '=' "
                 "after the name\n");
  EXPECT_EQ(Kel("list --all -L " + repo.Path()).output,
            newest + "b_v2_00_a\tHDL\t\t" + at + "b_v2_00_a\ttwo\n" + last);
}

TEST(KelShow, ShowsEachSectionAndNameOnce) {
  RepositoryBuilder repo;
  repo.Core("b_v2_00_a")
      .Qvr(
          "OPTION A = \x1B[1m\nOPTION A = 2\nOPTION NAME = other\nOPTION EMPTY = ''\n"
          "BUS_INTERFACE BUS = REGS\nIO_INTERFACE IO_IF = PADS, DESC = Pins\n"
          "PARAMETER W = 8, DESC = \"In bits\"\nPARAMETER W = 9\nPARAMETER N = '', TYPE = NON_HDL\n"
          "PORT p = X, DIR = I, VEC = [W-1:0], BUS = REGS:GONE, IO_IF = PADS");
  const std::string options =
      "NAME\tb\nVERSION\t2.00.a\nA\t\\x1b[1m\nEMPTY\t\nIMP_NETLIST\tFALSE\nRUN_TRAMFOLD\tFALSE\n"
      "STYLE\tHDL\nUSAGE_LEVEL\tADVANCED_USER\n";
  const std::string ports = "p\tI\t[W-1:0]\tREGS,GONE,PADS\t\n";
  const CommandResult all = Kel("show b -L " + repo.Path());
  const std::string place = "# place: name, value\nname\tb\nversion\t2.00.a\nlocation\t" +
                            (repo / "ipmods/b_v2_00_a") + "\nrepository\t" + repo.Path() +
                            "\nhides\t\nother_versions\t\n";
  EXPECT_EQ(all.output, place + "# options: name, value\n" + options +
                            "# parameters: name, value, default_value, generic, description\n"
                            "W\t8\t8\tgeneric\tIn bits\nN\t\t\t\t\n"
                            "# ports: name, direction, vector, interfaces, description\n" +
                            ports +
                            "# interfaces: name, kind, parameters, ports, description\n"
                            "REGS\tbus\t\tp\t\nPADS\tio\t\tp\tPins\n");
  EXPECT_EQ(all.errors, "");
  EXPECT_EQ(Kel("show b --section ports -L " + repo.Path()).output, ports);
  EXPECT_EQ(Kel("show b --section nope -L " + repo.Path()).status, 2);
  EXPECT_EQ(Kel("show nope -L " + repo.Path()).status, 1);
}

TEST(KelShow, WritesJsonOfAnyBytes) {
  RepositoryBuilder repo;
  repo.Core("b_v2_00_a").Qvr("PORT p\xFF = \"q\\\", DIR = O");
  EXPECT_EQ(
      Kel("show b --json --section ports -L " + repo.Path() + " | tr -d ' \n'").output,
      R"({"format_version":1,"key":"b_v2_00_a","ports":[{"name":"p�","direction":"O",)"
      R"("vector":"","default":"q\\","interfaces":[],"properties":{"NAME":"p�",)"
      R"("DEFAULT":"q\\","DIR":"O","ASSIGNMENT":"OPTIONAL","ENABLE":"SINGLE","INITIALVAL":"GND",)"
      R"("ISVALID":"TRUE","PERMIT":"ADVANCED_USER"}}]})");
}

// The paths that a call writes, those of one repository shortened.
std::string Paths(const std::string& arguments, int status = 0) {
  const CommandResult result = Kel("-L repository " + arguments);
  EXPECT_EQ(result.status, status) << arguments;
  std::string paths = result.output + result.errors;
  const std::string root = kExamples + "/repository/ipmods/";
  for (std::size_t at; (at = paths.find(root)) != std::string::npos;) paths.erase(at, root.size());
  return paths;
}

TEST(KelSources, ListsThemInOrder) {
  const std::string own = "tone_gen_v1_00_a/hdl/";
  EXPECT_EQ(Paths("sources tone_gen --for synthesis"),
            own + "verilog/phase_acc.v\n" + own + "vhdl/tone_gen.vhd\n");
  EXPECT_EQ(
      Paths("sources --for simulation tone_gen"),
      own + "vhdl/phase_acc.vhd\n" + own + "vhdl/tone_gen.vhd\n" + own + "vhdl/tone_gen_tb.vhd\n");
  EXPECT_EQ(Paths("sources crc_unit --for synthesis"),
            "kel: note: crc_unit_v1_00_a has no sources because its STYLE is 'BLACKBOX'\n");
  EXPECT_NE(
      Paths("sources tone_gen --for synthesis --format ghdl")
          .find("kel: note: the format ghdl is for VHDL only and leaves out 1 of 2 sources\n"),
      std::string::npos);
  Paths("sources tone_gen", 2);
  Paths("sources tone_gen --for layout", 2);
  Paths("sources nope --for synthesis", 1);
}

TEST(KelNetlists, ListsThoseThatApply) {
  const std::string own = "crc_unit_v1_00_a/netlist/crc_unit_w";
  EXPECT_EQ(Paths("netlists crc_unit"), own + "8_small.edif\n");
  EXPECT_EQ(Paths("netlists crc_unit --set WIDTH=16 --set MODE=FAST"), own + "16_fast.edif\n");
  EXPECT_EQ(Paths("netlists crc_unit --set MODE==x").substr(0, 29),
            "kel: note: no netlist applies");
  EXPECT_EQ(Paths("netlists word_fifo"),
            "kel: note: word_fifo_v1_00_a has no netlists because its STYLE is 'HDL'\n");
  EXPECT_EQ(
      Paths("netlists crc_unit --set mode=FAST", 1),
      "kel: warning: Unable to set IP crc_unit_v1_00_a parameter mode property VALUE to FAST\n"
      "  Cannot find Parameter mode\n");
  const std::string table = Paths("netlists crc_unit --table --set MODE=FAST");
  EXPECT_NE(table.find("*\tFAST\t8\t" + own + "8_fast.edif\n\tFAST\t16\t"), std::string::npos);
  Paths("netlists crc_unit --set MODE", 2);
  Paths("netlists crc_unit --set =FAST", 2);
}

TEST(Kel, SaysWhatItIsAskedToSay) {
  const std::string which = "-L repository which nope ";
  EXPECT_EQ(Kel(which + "--quiet").errors, "");
  EXPECT_EQ(Kel(which + "--quiet").status, 1);
  EXPECT_EQ(Kel(which + "--color always").errors.substr(0, 24), "kel: \x1B[1;31merror: \x1B[0mU");
  EXPECT_EQ(Kel(which).errors.find('\x1B'), std::string::npos);
  EXPECT_EQ(Kel(which + "--trace").errors.substr(0, 11), "kel: trace:");
  const std::string list = "'" + kKel + "' -L '" + kExamples + "/repository' list";
  EXPECT_EQ(RunCommand("{ sleep 0.1; " + list + "; echo $? >&2; } | true").errors, "0\n");
}

TEST(Kel, SuggestsWhatThereIs) {
  const char* const rows[][2] = {
      {"show puls_counter",
       "kel: note: no core is named puls_counter; did you mean pulse_counter?\n"},
      {"which WORD_FIFO", "; did you mean word_fifo?\n"},
      {"sources math_pack_v2_00_a --for synthesis",
       "kel: note: the versions of this core are math_pack_v1_00_a\n"},
      {"list 'x*'", "kel: note: no core matches 'x*'\n"}};
  for (const auto& [arguments, note] : rows) {
    const CommandResult result = Kel(std::string("-L repository ") + arguments);
    EXPECT_EQ(result.status, 1) << arguments;
    EXPECT_NE(result.errors.find(note), std::string::npos) << result.errors;
  }
  RepositoryBuilder repo;
  repo.Core("odd_V1_00_A").Qvr("").Ldx("lib odd a.vhd");
  repo.Core("brok_v1_00_a").Qvr("PORT p");
  repo.Core("broc_v1_00_a").Qvr("");
  const CommandResult broken = Kel("show brok -L " + repo.Path());
  EXPECT_EQ(broken.errors.find("did you mean"), std::string::npos);
  EXPECT_EQ(broken.errors.rfind(repo / "ipmods/brok_v1_00_a/data/brok_v2_1_0.qvr:1:", 0), 0U);
  EXPECT_EQ(Kel("list '[bo][rd]*[cd]' -L " + repo.Path()).output.substr(0, 12), "broc_v1_00_a");
  EXPECT_NE(
      Kel("sources odd --for synthesis --json -L " + repo.Path()).output.find("\"odd_v1_00_a\""),
      std::string::npos);
  const CommandResult place = Kel("-L overlay -L repository show pulse_counter --section place");
  const std::string hidden = "hides\t" + kExamples + "/repository/ipmods/pulse_counter_v2_00_a\n";
  EXPECT_NE(
      place.output.find(hidden + "other_versions\tpulse_counter_v1_00_a,pulse_counter_v1_01_b"),
      std::string::npos);
  const CommandResult above = Kel("-L .. list");
  EXPECT_EQ(above.status, 3);
  EXPECT_EQ(
      above.errors,
      "..: warning[not-a-repository]: this is no repository, it has no subdirectory ipmods\n");
  EXPECT_NE(Kel("-L repository/ipmods list")
                .errors.find("; did you mean " + kExamples + "/repository?\n"),
            std::string::npos);
  EXPECT_NE(Kel("-L . list").errors.find("/overlay or " + kExamples + "/repository?\n"),
            std::string::npos);
}

TEST(Kel, ShowsHelpAndVersion) {
  EXPECT_EQ(Kel("--help").status, 0);
  EXPECT_EQ(Kel("help").output, Kel("--help").output);
  EXPECT_EQ(Kel("help which").output, Kel("which --help").output);
  EXPECT_NE(Kel("which --help").output.find("KEY"), std::string::npos);
  EXPECT_EQ(Kel("--version").output.substr(0, 4), "kel ");
  const std::string one = Kel("help list-ends").output;
  EXPECT_EQ(one.substr(0, 22), "list-ends (warning): l");
  EXPECT_NE(Kel("help diagnostics").output.find(one), std::string::npos);
  EXPECT_EQ(Kel("help list-end").errors.substr(0, 62),
            "kel: error: no help for 'list-end'; did you mean list-ends?\nRu");
}

}  // namespace
