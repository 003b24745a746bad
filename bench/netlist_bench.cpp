// What a netlist table costs: opening it with its core description, and asking it. Times differ
// from machine to machine; compare the rows of one run.

#include <benchmark/benchmark.h>

#include <cstdint>
#include <filesystem>
#include <string>

#include "Port_FileName.h"
#include "Scratch.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_TEWParser.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Index;
using Tarvo::QVRParser;
using Tarvo::StringBase;
using Tarvo::TEWParser;

// A core with that many parameters, all of which are columns of its table of one row.
fs::path WideTable(std::int64_t columns) {
  return Scratch::Prepare("wide-" + std::to_string(columns), [&](const fs::path& repository) {
    std::string description;
    std::string header;
    std::string row;
    for (std::int64_t i = 0; i < columns; ++i) {
      const std::string name = "WIDTH_" + std::to_string(i) + " ";
      description += "PARAMETER " + name + "= 8, DT = integer, RANGE = (2:32)\n";
      header += name;
      row += "8 ";
    }
    Scratch::WriteDataFile(repository, "core", "qvr", description);
    Scratch::WriteDataFile(repository, "core", "tew", header + "FILES\n" + row + "core.edn\n");
  });
}

// A core with that many netlists, which apply whatever its parameters are.
fs::path LongTable(std::int64_t rows) {
  return Scratch::Prepare("long-" + std::to_string(rows), [&](const fs::path& repository) {
    std::string table = "FILES\n";
    for (std::int64_t i = 0; i < rows; ++i) table += "part_" + std::to_string(i) + ".edn\n";
    Scratch::WriteDataFile(repository, "core", "qvr", "OPTION STYLE = BLACKBOX\n");
    Scratch::WriteDataFile(repository, "core", "tew", table);
  });
}

// The one core of a repository.
struct Core {
  explicit Core(const fs::path& repository) {
    Port::FileName location;
    location.SetHead((repository / "ipmods/core_v1_00_a").c_str());
    index.AddIP(key, location);
  }

  const Tarvo::Kel_Key key = Tarvo::Kel_Key("core_v1_00_a");
  Kel_Index index;
};

void Open(benchmark::State& state, const fs::path& repository) {
  const Core core(repository);
  for ([[maybe_unused]] const auto _ : state) {
    const QVRParser description(core.index, core.key);
    const TEWParser table(core.index, core.key, &description);
  }
}

template <class Question>
void Ask(benchmark::State& state, const fs::path& repository, const Question& question) {
  const Core core(repository);
  const QVRParser description(core.index, core.key);
  const TEWParser table(core.index, core.key, &description);
  for ([[maybe_unused]] const auto _ : state) question(table);
}

void OpenColumns(benchmark::State& state) { Open(state, WideTable(state.range(0))); }
BENCHMARK(OpenColumns)->Arg(10000)->Unit(benchmark::kMillisecond);

void AskColumns(benchmark::State& state) {
  Ask(state, WideTable(state.range(0)),
      [](const TEWParser& table) { benchmark::DoNotOptimize(table.ListFiles()); });
}
BENCHMARK(AskColumns)->Arg(10000)->Unit(benchmark::kMillisecond);

void OpenNetlists(benchmark::State& state) { Open(state, LongTable(state.range(0))); }
BENCHMARK(OpenNetlists)->Arg(5000)->Unit(benchmark::kMillisecond);

void AskNetlists(benchmark::State& state) {
  Ask(state, LongTable(state.range(0)), [](const TEWParser& table) {
    for (const StringBase& netlist : table.ListFiles()) {
      benchmark::DoNotOptimize(table.GetFileLibrary(Port::FileName(netlist)));
    }
  });
}
BENCHMARK(AskNetlists)->Arg(5000)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
