// What checking a library costs, beside what its callers do anyway: opening each core and asking
// for both of its source lists.

#include <benchmark/benchmark.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <string>

#include "Scratch.h"
#include "Tarvo_KelChecker.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::KelIP;
using Tarvo::KelLibrary;
using Tarvo::StringBase;
using Tarvo::StringList;

constexpr int kCores = 1000;
constexpr int kSources = 10;

std::string CoreName(int number) { return "core" + std::to_string(number); }

// Each core takes in up to two others, ten sources of its own and a test bench.
std::string Order(int number) {
  std::string text;
  for (int other = 2 * number + 1; other <= 2 * number + 2 && other < kCores; ++other) {
    text += "lib " + CoreName(other) + "_v1_00_a all\n";
  }
  for (int i = 0; i < kSources; ++i) {
    text += "lib " + CoreName(number) + "_v1_00_a source_" + std::to_string(i) + "\n";
  }
  return text + "simlib " + CoreName(number) + "_v1_00_a bench\n";
}

void MakeEmpty(const fs::path& file) {
  fs::create_directories(file.parent_path());
  std::ofstream stream(file);
}

fs::path Repository() {
  return Scratch::Prepare("checked", [](const fs::path& repository) {
    const std::string description = Scratch::Description();
    for (int i = 0; i < kCores; ++i) {
      const std::string name = CoreName(i);
      const fs::path core = repository / "ipmods" / (name + "_v1_00_a");
      Scratch::WriteDataFile(repository, name, "qvr", description);
      Scratch::WriteDataFile(repository, name, "ldx", Order(i));
      Scratch::WriteDataFile(repository, name, "tew", "WIDTH_0 FILES\n8 a.edif\n16 b.edif\n");
      for (int j = 0; j < kSources; ++j) {
        MakeEmpty(core / "hdl/vhdl" / ("source_" + std::to_string(j) + ".vhd"));
      }
      MakeEmpty(core / "hdl/vhdl/bench.vhd");
      MakeEmpty(core / "netlist/a.edif");
      MakeEmpty(core / "netlist/b.edif");
    }
  });
}

void OpenAndList(benchmark::State& state) {
  KelLibrary library;
  library.SetRepositoryPath(Repository().c_str());
  StringList keys;
  library.ListAllIPKeys(keys);
  StringList sources;
  for ([[maybe_unused]] const auto _ : state) {
    for (const StringBase& key : keys) {
      const std::unique_ptr<KelIP> core(library.CreateIP(key));
      core->ListSynthesisSources(sources);
      core->ListSimulationSources(sources);
    }
  }
}
BENCHMARK(OpenAndList)->Unit(benchmark::kMillisecond);

void CheckLibrary(benchmark::State& state) {
  KelLibrary library;
  library.SetRepositoryPath(Repository().c_str());
  const Tarvo::KelChecker checker(library);
  for ([[maybe_unused]] const auto _ : state) {
    if (!checker.CheckLibrary().empty()) state.SkipWithError("the library has faults");
  }
}
BENCHMARK(CheckLibrary)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
