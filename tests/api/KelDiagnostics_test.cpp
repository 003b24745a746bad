#include <gtest/gtest.h>

#include <string>

#include "CommandLine.h"
#include "RepositoryBuilder.h"

// How the command shows what is wrong, whatever it is.
namespace {

const std::string kKel = KEL_COMMAND;
const std::string kFile = "ipmods/x_v1_00_a/data/x_v2_1_0.qvr";

CommandResult Kel(const RepositoryBuilder& repo, const std::string& arguments) {
  return RunCommand("cd " + repo.Path() + " && COLUMNS=60 '" + kKel + "' -L . " + arguments);
}

std::string Check(const RepositoryBuilder& repo, const std::string& arguments) {
  return Kel(repo, "check --relative-to . -W no-missing-order " + arguments).output;
}

// Columns count cells: a wide character is two, a tab or a control character one. An excerpt shows
// tabs and control characters wider, and is cut around the place.
TEST(KelDiagnostics, PutsMarksBelowTheWord) {
  const std::string ends =
      ": warning[list-ends]: missing ',' before VEC; the rest of the line is "
      "ignored\n";
  const std::string head = "PORT q =\t\"\xC3\xBC\xE5\xAE\xBD\x7F\xFF\", DIR = O ";
  const std::string longHead = "PORT q = \"" + std::string(60, 'x') + "\", DIR = O ";
  const std::string rows[][3] = {
      {head + "VEC = [1:0]", ":1:27",
       "  1 | PORT q =        \"\xC3\xBC\xE5\xAE\xBD\\x7f\\xff\", DIR = O VEC = [1:0]\n"
       "    |                                        ^^^\n"},
      {longHead + "VEC = [1:0]", ":1:82",
       "  1 | ..." + std::string(29, 'x') + "\", DIR = O VEC = [1:0]\n    | " +
           std::string(43, ' ') + "^^^\n"},
      {longHead + "VEC = [1:0], DESC = \"" + std::string(60, 'y') + "\"", ":1:82",
       "  1 | ...xx\", DIR = O VEC = [1:0], DESC = \"yyyyyyyyyyyyyy...\n"
       "    |                 ^^^\n"}};
  for (const auto& [line, at, excerpt] : rows) {
    RepositoryBuilder repo;
    repo.Core("x_v1_00_a").Qvr(line);
    EXPECT_EQ(Check(repo, ""), kFile + at + ends + "1 core, 0 errors, 1 warning\n");
    const std::string shown = Check(repo, "--excerpts");
    EXPECT_EQ(shown.substr(0, shown.find("  help: write ")), kFile + at + ends + excerpt);
  }
}

// No name of a file is taken for a part of a text. Other cores' netlists of one table are told
// apart.
TEST(KelDiagnostics, TakesNamesAsTheyAre) {
  RepositoryBuilder repo;
  const std::string core = "E line 7, x/ipmods/x_v1_00_a/";
  repo.File(core + "data/x_v2_1_0.qvr", "OPTION STYLE = BLACKBOX\n\nPORT p");
  repo.File(core + "data/x_v2_1_0.tew", "FILES\ny:n.edn\nx:n.edn");
  repo.File(core + "netlist/n.edn", "");
  repo.File("E line 7, x/ipmods/y_v1_00_a/data/y_v2_1_0.qvr", "OPTION STYLE = none");
  const std::string data = core + "data/x_v2_1_0.";
  EXPECT_EQ(RunCommand("cd " + repo.Path() + " && '" + kKel +
                       "' -L 'E line 7, x' check x --relative-to .")
                .output,
            data + "qvr:3:7: error[bad-statement]: missing '=' after the name\n" + data +
                "tew:2:1: error[missing-netlist]: netlist does not exist: "
                "y_v1_00_a/netlist/n.edn\n1 core, 2 errors, 0 warnings\n");
}

TEST(KelDiagnostics, ObeysItsOptions) {
  RepositoryBuilder repo;
  repo.Core("x_v1_00_a").Qvr("PORT p = '', DIR = I\nPORT p = '', DIR = O\nPORT q");
  struct Row {
    const char* arguments;
    int status;
    const char* severities[3];  // of the second line, the third, and the counts
  };
  const Row rows[] = {
      {"", 1, {":2:6: warning[", ":3:7: error[", ", 1 error, 1 warning\n"}},
      {"-W error", 1, {":2:6: error[", ":3:7: error[", ", 2 errors, 0 warnings\n"}},
      {"-W no-bad-statement -Wno-duplicate-name", 0, {"1 core", "1 core", ", 0 errors, 0 warn"}},
      {"-W no-bad-statment", 2, {"", "", ""}},
      {"--format json",
       1,
       {"\"column\": 6,\n      \"length\": 1,", "\"hint\": null", "\"notes\": 0"}},
      {"--json",
       1,
       {"\"related\": [\n        {\n          \"file\": \"ipmods/x", "\"line\": 1",
        "\"code\": \"bad-statement\""}},
      {"--excerpts",
       1,
       {"  2 | PORT p = '', DIR = O\n    |      ^\n",
        "qvr:1:6: note: first declared here\n  1 | PORT p = '', DIR = I\n    |      ^\n", ""}},
      {"--color always", 1, {": \x1B[1;33mwarning[duplicate-name]: \x1B[0mPORT 'p'", "", ""}},
      {"--relative-to ipmods", 1, {"\nx_v1_00_a/data/x", "", ""}}};
  for (const Row& row : rows) {
    SCOPED_TRACE(row.arguments);
    const std::string arguments = row.arguments;
    const bool isPlaced = arguments.find("--relative-to") != std::string::npos;
    const CommandResult result =
        Kel(repo, "check -W no-missing-order " + arguments + (isPlaced ? "" : " --relative-to ."));
    EXPECT_EQ(result.status, row.status);
    for (const char* const part : row.severities) {
      EXPECT_NE(("\n" + result.output).find(part), std::string::npos) << result.output;
    }
  }
  EXPECT_NE(Kel(repo, "check -W no-bad-statment").errors.find("did you mean no-bad-statement?"),
            std::string::npos);
}

// A finding is the same one when a line comes in above it.
TEST(KelDiagnostics, FingerprintsWithoutLines) {
  const auto fingerprints = [](const std::string& above) {
    RepositoryBuilder repo;
    repo.Core("x_v1_00_a").Qvr(above + "PORT q = b r\nPORT q = b r\nPORT q = b r");
    return Kel(repo, "check --format sarif | grep kelFinding").output;
  };
  EXPECT_EQ(fingerprints("# above\n"), fingerprints(""));
}

// Every verb tells what is wrong in the same words as a check, and from where the file was read.
TEST(KelDiagnostics, TellsARootCauseOnce) {
  RepositoryBuilder repo;
  repo.Core("x_v1_00_a").Qvr("OPTION HDL = VHDL").Ldx("\nlib y all");
  repo.Core("y_v1_00_a").Qvr("OPTION HDL = VHDL").Ldx("lib nowhere all");
  const std::string cause = Check(repo, "-W no-empty-order y");
  const CommandResult result = Kel(repo, "sources x --for synthesis --relative-to .");
  EXPECT_EQ(result.status, 1);
  EXPECT_EQ(result.errors, cause.substr(0, cause.find('\n') + 1) +
                               "note: taken in from ipmods/x_v1_00_a/data/x_v2_1_0.ldx:2\n");
}

}  // namespace
