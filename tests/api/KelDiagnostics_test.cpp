// How the command shows what is wrong, whatever it is: tests/data/diagnostics.txt has what it
// writes.

#include <gtest/gtest.h>

#include <string>

#include "CommandLine.h"
#include "RepositoryBuilder.h"
#include "ReviewedText.h"

namespace {

const std::string kKel = KEL_COMMAND;

class KelDiagnostics : public testing::Test {
 protected:
  CommandResult Kel(const std::string& arguments) const {
    return RunCommand("cd " + repo.Path() + " && COLUMNS=60 '" + kKel + "' " + arguments);
  }
  // Writes down a call with all that came of it.
  void Tell(const std::string& arguments) {
    const CommandResult result = Kel(arguments);
    report += "$ kel " + arguments + " -> " + std::to_string(result.status) + "\n" +
              Replaced(result.output, "\x1B", "\\e") + result.errors;
  }

  RepositoryBuilder repo;
  std::string report;
};

TEST_F(KelDiagnostics, AreShownAsReviewed) {
  // Columns count cells: a wide character is two, a tab or a control character one. An excerpt
  // shows tabs and control characters wider, and is cut around the place.
  const std::string wide = "PORT q =\t\"\xC3\xBC\xE5\xAE\xBD\x7F\xFF\", DIR = O ";
  const std::string start = "PORT q = \"" + std::string(60, 'x') + "\", DIR = O ";
  for (const std::string& line : {wide + "VEC = [1:0]", start + "VEC = [1:0]",
                                  start + "VEC = [1:0], DESC = \"" + std::string(60, 'y') + "\""}) {
    repo.Core("x_v1_00_a").Qvr(line);
    Tell("-L . check --relative-to . -W no-missing-order --excerpts");
  }
  repo.Core("x_v1_00_a").Qvr("PORT p = '', DIR = I\nPORT p = '', DIR = O\nPORT q");
  for (const char* const options :
       {".", ". -W error", ". -W no-bad-statement -Wno-duplicate-name", ". -W no-bad-statment",
        ". --format json", ". --json", ". --excerpts", ". --color always", "ipmods"}) {
    Tell("-L . check -W no-missing-order --relative-to " + std::string(options));
  }
  // Every verb tells what is wrong in the same words as a check, and from where the file was read.
  repo.Core("x_v1_00_a").Qvr("OPTION HDL = VHDL").Ldx("\nlib y all");
  repo.Core("y_v1_00_a").Qvr("OPTION HDL = VHDL").Ldx("lib nowhere all");
  Tell("-L . check y --relative-to .");
  Tell("-L . sources x --for synthesis --relative-to .");
  // No name of a file is taken for a part of a text. Netlists of other cores are told apart.
  repo.File("E line 7, x/ipmods/x_v1_00_a/data/x_v2_1_0.qvr", "OPTION STYLE = BLACKBOX\n\nPORT p");
  repo.File("E line 7, x/ipmods/x_v1_00_a/data/x_v2_1_0.tew", "FILES\ny:n.edn\nx:n.edn");
  repo.File("E line 7, x/ipmods/x_v1_00_a/netlist/n.edn", "");
  repo.File("E line 7, x/ipmods/y_v1_00_a/data/y_v2_1_0.qvr", "OPTION STYLE = none");
  Tell("-L 'E line 7, x' check x --relative-to .");
  ExpectReviewed("diagnostics.txt", report);
}

// A finding is the same one when a line comes in above it.
TEST_F(KelDiagnostics, FingerprintsWithoutLines) {
  const auto fingerprints = [this](const std::string& above) {
    repo.Core("x_v1_00_a").Qvr(above + "PORT q = b r\nPORT q = b r\nPORT q = b r");
    return Kel("-L . check --format sarif | grep kelFinding").output;
  };
  EXPECT_EQ(fingerprints("# above\n"), fingerprints(""));
}

}  // namespace
