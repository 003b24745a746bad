// Analyse orders over random inclusions, against the rule alone: there each core is read anew
// wherever it is included, and its whole order taken over source by source. The library must tell
// the same, although it reads a core once where nobody can tell.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <random>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "Tarvo_LDXParser.h"

namespace {

using namespace Tarvo;

struct Entry {
  bool forSide[2];  // synthesis and simulation
  int library;
  std::string file;  // or empty for the whole library
};
using Entries = std::vector<Entry>;

struct Order {
  using Sources = std::vector<std::pair<std::string, std::vector<std::string>>>;

  Sources sources[2];  // by library
  std::set<std::string> keys[2];
  std::vector<std::string> directories;  // their libraries
};

std::string KeyOf(int core) { return "c" + std::to_string(core) + "_v1_00_a"; }

// Some cores have one, and some the same.
bool HasDirectory(int core) { return core % 2 == 1; }
std::string DirectoryOf(int core) { return "d" + std::to_string(core % 3); }

// How the file's name is written once its location is known.
std::string Written(std::string file) {
  if (const auto at = file.find("//"); at != std::string::npos) file.erase(at, 1);
  return file;
}

// False if the key is there.
bool Add(Order& order, int side, const std::string& library, const std::string& name,
         const std::string& file) {
  if (!order.keys[side].insert(library + " " + name).second) return false;
  Order::Sources& sources = order.sources[side];
  auto place = std::find_if(sources.begin(), sources.end(),
                            [&](const auto& known) { return known.first == library; });
  if (place == sources.end()) place = sources.insert(place, {library, {}});
  place->second.push_back(file);
  return true;
}

class Rule {
 public:
  explicit Rule(const std::vector<Entries>& theCores) : cores(theCores) {}

  Order Read(int core) {
    Order order;
    if (HasDirectory(core)) order.directories = {DirectoryOf(core)};
    for (const Entry& entry : cores[static_cast<std::size_t>(core)]) {
      if (entry.file.empty()) {
        Append(order, core, entry.library);
        continue;
      }
      for (const int side : {0, 1}) {
        const std::string library = KeyOf(entry.library);
        if (!entry.forSide[side]) continue;
        if (Add(order, side, library, entry.file, Written(entry.file))) continue;
        Tell("warning s/Tarvo_LDXParser: ", core, library, entry.file, "", side);
      }
    }
    return order;
  }

  // Warnings, and traces of what an included core has in common with the one that includes it.
  std::vector<std::string> told;

 private:
  void Append(Order& order, int core, int included) {
    const Order taken = Read(included);
    for (const int side : {0, 1}) {
      for (const auto& [library, files] : taken.sources[side]) {
        for (const std::string& file : files) {
          if (Add(order, side, library, file, file)) continue;
          Tell("trace: ", core, library, file, " included from " + KeyOf(included), side);
        }
      }
    }
    for (const std::string& directory : taken.directories) {
      const auto& known = order.directories;
      if (std::count(known.begin(), known.end(), directory) > 0) continue;
      order.directories.push_back(directory);
    }
  }

  void Tell(const char* kind, int core, const std::string& library, const std::string& file,
            const std::string& from, int side) {
    told.push_back(kind + KeyOf(core) + " - File " + library + ":" +
                   file.substr(file.rfind('/') + 1) + from + " already exists in " +
                   (side == 0 ? "synthesis" : "simulation") + " library\n");
  }

  const std::vector<Entries>& cores;
};

class Inclusions : public testing::Test, protected IndexedRepository {
 protected:
  int Below(int limit) { return std::uniform_int_distribution<int>(0, limit - 1)(random); }

  // Cores that include earlier ones. Few names, so that they meet; in some rounds odd ones too,
  // which have two keys.
  std::vector<Entries> MakeCores(bool withOdd) {
    std::vector<Entries> cores(static_cast<std::size_t>(2 + Below(7)));
    for (int core = 0; core < static_cast<int>(cores.size()); ++core) {
      for (int line = Below(7); line > 0; --line) {
        const bool sides[][2] = {{true, true}, {true, true}, {true, false}, {false, true}};
        const auto& [synthesis, simulation] = sides[Below(4)];
        const int library = Below(core + 1);
        const char* const files[] = {"f", "g", "s/f", "s//f"};
        const bool isWhole = library != core && Below(3) > 0;
        cores[static_cast<std::size_t>(core)].push_back(
            {{synthesis, simulation},
             library,
             isWhole ? "" : std::string(files[withOdd ? 2 + Below(2) : Below(3)]) + ".vhd"});
      }
    }
    return cores;
  }

  void Write(int core, const Entries& entries) {
    const char* const keywords[][2] = {{"", "simlib "}, {"synlib ", "lib "}};
    std::string ldx = HasDirectory(core) ? "vlgincdir " + DirectoryOf(core) + " data\n" : "";
    for (const Entry& entry : entries) {
      ldx += keywords[entry.forSide[0]][entry.forSide[1]] + KeyOf(entry.library) + " " +
             (entry.file.empty() ? "all" : entry.file) + "\n";
    }
    repo.Core(KeyOf(core)).Ldx(ldx);
    Add(KeyOf(core));
  }

  std::string PathsOf(const Order::Sources& sources) {
    std::string paths;
    for (const auto& [library, files] : sources) {
      for (const std::string& file : files) {
        paths.append(paths.empty() ? "" : ", ").append(library + "/hdl/vhdl/").append(file);
      }
    }
    return paths;
  }

  void Expect(const LDXParser& parser, const Order& order, bool withOdd) {
    EXPECT_EQ(Shorten(parser.ListSynthesisAnalyseOrder()), PathsOf(order.sources[0]));
    EXPECT_EQ(Shorten(parser.ListSimulationAnalyseOrder()), PathsOf(order.sources[1]));
    StringList directories;
    for (const std::string& each : order.directories) directories.emplace_back(each.c_str());
    EXPECT_EQ(parser.ListVerilogIncludeLibraryKeys(), directories);
    if (withOdd) return;  // a source of an odd name does not find its library
    for (const StringBase& source : parser.ListSynthesisAnalyseOrder()) {
      const std::string text = Shorten(source.GetText());
      EXPECT_EQ(parser.GetFileLibrary(Port::FileName(source)).GetKey().View(),
                text.substr(0, text.find('/')));
    }
  }

  std::mt19937 random{1};
};

TEST_F(Inclusions, TellTheSameAsTheRule) {
  const auto isOfRule = [](const std::string& text) {
    return text.find("already exists") != std::string::npos;
  };
  const auto isTrace = [](const std::string& text) { return text.find("trace: ") == 0; };
  for (int round = 0; round < 150; ++round) {
    SCOPED_TRACE(round);
    index.ClearIP();
    const bool withOdd = round % 2 == 0;
    const std::vector<Entries> cores = MakeCores(withOdd);
    for (std::size_t i = 0; i < cores.size(); ++i) Write(static_cast<int>(i), cores[i]);
    const int top = static_cast<int>(cores.size()) - 1;
    Rule rule(cores);
    const Order order = rule.Read(top);
    for (const auto what : {MessageRecorder::MessagesAndTraces, MessageRecorder::Messages}) {
      MessageRecorder recorder(what);
      const LDXParser parser(index, Kel_Key(StringBase(KeyOf(top).c_str())), Kel_Key(), "VHDL");
      std::vector<std::string> told = recorder.Take();
      told.erase(std::remove_if(told.begin(), told.end(), std::not_fn(isOfRule)), told.end());
      EXPECT_EQ(told, rule.told);
      Expect(parser, order, withOdd);
      std::vector<std::string>& rest = rule.told;
      rest.erase(std::remove_if(rest.begin(), rest.end(), isTrace), rest.end());
    }
  }
}

}  // namespace
