#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <map>
#include <memory>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "MessageRecorder.h"
#include "RepositoryBuilder.h"
#include "ReviewedText.h"
#include "Tarvo_KelChecker.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;

class Checker : public testing::Test {
 protected:
  // A core without a fault, of which a test writes some file anew.
  RepositoryBuilder::CoreBuilder Good(const std::string& name) {
    return repo.Core(name + "_v1_00_a")
        .Qvr("OPTION STYLE = MIX\nPARAMETER P = 1")
        .Ldx("lib " + name + " a.vhd")
        .File("hdl/vhdl/a.vhd", "")
        .Tew("P FILES\n1 n.edn\n2 n.edn")
        .File("netlist/n.edn", "");
  }

  // A path as "l5.ldx", or below `ipmods`.
  std::string Shortened(const StringBase& path) const {
    const std::string file = Replaced(path.GetText(), repo / "ipmods/", "");
    const std::size_t data = file.find("/data/");
    if (data == std::string::npos) return file;
    return Replaced(file.substr(data + 6), "_v2_1_0", "");
  }
  // A place as "l5.ldx:2:8+5".
  std::string Dump(const KelPlace& place) const {
    if (place.line == 0) return Shortened(place.file);
    return Shortened(place.file) + ":" + std::to_string(place.line) + ":" +
           std::to_string(place.column) + "+" + std::to_string(place.length);
  }
  std::string Dump(const std::vector<KelDiagnostic>& found) const {
    std::string text;
    for (const KelDiagnostic& one : found) {
      const char* const severities[] = {"note ", "", "error "};
      text += Dump(one.place) + " " + severities[one.severity] + one.code.GetText() + ": " +
              one.text.GetText();
      if (one.hint.GetLength() > 0) text += std::string(" | ") + one.hint.GetText();
      for (const KelRelatedPlace& other : one.related) {
        text += " @ " + Dump(other.place) + " " + other.text.GetText();
      }
      text += "\n";
    }
    return Replaced(text, repo / "ipmods/", "");
  }

  RepositoryBuilder repo;
};

// tests/data/findings.txt has the files, each behind a line "== NAME", and below each line of them
// what is found there. A file named as "l1.ldx" replaces that of a good core; any other name is a
// path below `ipmods`. What is found elsewhere stands at the end. n1.qvr begins with a byte order
// mark.
struct Input {
  std::string name;
  std::vector<std::string> lines;  // the first one names the file
};

std::vector<Input> ReadInputs() {
  std::ifstream reviewed(KEL_TEST_DATA "/findings.txt");
  std::vector<Input> inputs;
  for (std::string line; std::getline(reviewed, line);) {
    if (line.rfind("== ", 0) == 0) inputs.push_back({line.substr(3), {}});
    if (line.rfind(">>> ", 0) != 0) inputs.at(inputs.size() - 1).lines.push_back(line);
  }
  return inputs;
}

class Findings : public Checker {
 protected:
  Findings() {
    for (const Input& input : inputs) Write(input);
    library.SetRepositoryPath(repo.Path().c_str());
    recorder.Take();
  }
  void Write(const Input& input) {
    std::string text;
    for (std::size_t i = 1; i < input.lines.size(); ++i) text += input.lines[i] + "\n";
    if (input.name.find('/') != std::string::npos) return repo.File("ipmods/" + input.name, text);
    const std::size_t dot = input.name.find('.');
    const std::string core = input.name.substr(0, dot), location = "ipmods/" + core + "_v1_00_a";
    if (!fs::exists(repo / location)) Good(core);
    repo.File(location + "/data/" + core + "_v2_1_0" + input.name.substr(dot), text);
  }
  // The inputs with what is found; each finding goes to its line.
  std::string Annotated(const std::vector<KelDiagnostic>& found) const {
    std::map<std::pair<std::string, std::size_t>, std::string> byPlace;
    for (const KelDiagnostic& one : found) {
      byPlace[{Shortened(one.place.file), one.place.line}] += ">>> " + Dump({one});
    }
    std::string text;
    for (const auto& [name, lines] : inputs) {
      for (std::size_t i = 0; i < lines.size(); ++i) {
        text += lines[i] + "\n" + std::exchange(byPlace[{Shortened(name.c_str()), i}], "");
      }
    }
    for (const auto& [place, rest] : byPlace) text += rest;
    return text;
  }

  const std::vector<Input> inputs = ReadInputs();
  MessageRecorder recorder;
  KelLibrary library;
};

TEST_F(Findings, AreAsReviewed) {
  const std::vector<KelDiagnostic> found = KelChecker(library).CheckLibrary();
  EXPECT_TRUE(recorder.Take().empty());
  EXPECT_TRUE(std::is_sorted(found.begin(), found.end(), [](const auto& one, const auto& other) {
    const auto place = [](const KelPlace& at) { return std::tie(at.file, at.line, at.column); };
    return place(one.place) < place(other.place);
  }));
  ExpectReviewed("findings.txt", Annotated(found));
}

// What comes from included cores is found as well, and of several cores each thing once.
TEST_F(Findings, AreThoseOfTheCoresAskedFor) {
  const KelChecker checker(library);
  EXPECT_EQ(Dump(checker.CheckCore("p2")),
            "p2.tew:1:1+1 error unknown-parameter: the core has no parameter 'Z'\n");
  const std::string conflict = Dump(checker.CheckCore("u2"));
  EXPECT_NE(conflict.find("u1.ldx:2:5+9 version-conflict: "), std::string::npos);
  EXPECT_EQ(Dump(checker.CheckCores({"u1", "u2", "u3"})), conflict);
  EXPECT_EQ(Dump(checker.CheckCores({"u1", "u4", "nope"})),
            " error unknown-library: there is no core 'nope'\n");
}

// However cores include each other, each file is read once in an analysis. Whoever asks the library
// meanwhile gets its answers, and its messages.
TEST_F(Checker, LeavesTheLibraryAsItIs) {
  for (const char* name : {"a", "b", "c", "d", "e", "f", "g", "h"}) {
    Good(name).Ldx(
        "lib a all\nlib b all\nlib c all\nlib d all\nlib e all\nlib f all\nlib g all\nlib h all");
  }
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

// A log has each fault once, however many messages follow from it, with the lines that lead to it.
TEST_F(Checker, LogsWhatAnOperationMeets) {
  Good("in").Ldx("lib in a.vhd VDHL\nlib in a.vhd\nlib nope a");
  Good("mid").Ldx("lib mid a.vhd\nlib in all");
  Good("top").Ldx("\nlib mid all").Tew("P FILES\n1 'n.edn");
  repo.Core("bad_v1_00_a").Qvr("PORT p").Ldx("");
  repo.Core("odd_v1_00_a").Qvr("OPTION A");
  const MessageRecorder messages;
  const KelDiagnosticLog log;
  std::string report;
  const auto tell = [&](const char* call) {
    report += std::string(call) + "\n" + Dump(log.Take());
  };
  KelLibrary library;
  library.SetRepositoryPath(repo.Path().c_str());
  tell("SetRepositoryPath");
  const std::unique_ptr<KelIP> top(library.CreateIP("top"));
  StringList list;
  EXPECT_FALSE(top->ListSynthesisSources(list));
  tell("ListSynthesisSources");
  fs::remove(repo / "ipmods/in_v1_00_a/data/in_v2_1_0.ldx");
  EXPECT_FALSE(top->ListSynthesisSources(list));
  tell("ListSynthesisSources without an included order");
  EXPECT_FALSE(top->ListNetlists(list));
  tell("ListNetlists");
  EXPECT_EQ(library.CreateIP("bad"), nullptr);
  tell("CreateIP");
  library.GetLocation("nope");
  tell("GetLocation of an unknown core");
  ExpectReviewed("log.txt", report);
}

}  // namespace
