// What a deep analyse order costs, beside scanning the same files line by line. Times differ from
// machine to machine; compare the rows of one run.

#include <benchmark/benchmark.h>

#include <cstdint>
#include <filesystem>
#include <string>

#include "Port_FileName.h"
#include "Scratch.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_LDXParser.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Index;
using Tarvo::Kel_Key;
using Tarvo::LDXParser;
using Tarvo::StringBase;

constexpr std::int64_t kFilesOfCore = 10;

std::string CoreName(std::int64_t number) { return "core" + std::to_string(number); }

std::string Include(std::int64_t core) { return "lib " + CoreName(core) + "_v1_00_a all\n"; }

std::string OwnFiles(std::int64_t core) {
  std::string lines;
  for (std::int64_t i = 0; i < kFilesOfCore; ++i) {
    lines += "lib " + CoreName(core) + "_v1_00_a source" + std::to_string(i) + ".vhd\n";
  }
  return lines;
}

void WriteCore(const fs::path& repository, std::int64_t core, const std::string& order) {
  Scratch::WriteDataFile(repository, CoreName(core), "qvr", "OPTION HDL = VHDL\n");
  Scratch::WriteDataFile(repository, CoreName(core), "ldx", order);
}

// A tree in which each core includes up to `width` others in front of its own files: the core of
// number n those from n * width + 1 on. A width of 1 makes a chain.
fs::path Tree(std::int64_t cores, std::int64_t width) {
  const std::string name = "tree-" + std::to_string(cores) + "-" + std::to_string(width);
  return Scratch::Prepare(name, [&](const fs::path& repository) {
    for (std::int64_t core = 0; core < cores; ++core) {
      std::string lines;
      for (std::int64_t i = core * width + 1; i <= core * width + width && i < cores; ++i) {
        lines += Include(i);
      }
      WriteCore(repository, core, lines + OwnFiles(core));
    }
  });
}

// Two cores a layer, each of which includes both of the next one, so that a further layer doubles
// the ways.
fs::path Ladder(std::int64_t layers) {
  const std::string name = "ladder-" + std::to_string(layers);
  return Scratch::Prepare(name, [&](const fs::path& repository) {
    for (std::int64_t core = 0; core < 2 * layers; ++core) {
      const std::int64_t next = core - core % 2 + 2;
      const bool last = next == 2 * layers;
      WriteCore(repository, core, (last ? "" : Include(next) + Include(next + 1)) + OwnFiles(core));
    }
  });
}

// Fills the index with all versions of a repository.
void Fill(Kel_Index& index, const fs::path& repository) {
  for (const fs::directory_entry& entry : fs::directory_iterator(repository / "ipmods")) {
    Port::FileName location;
    location.SetHead(entry.path().c_str());
    index.AddIP(Kel_Key(StringBase(entry.path().filename().c_str())), location);
  }
}

void Analyse(benchmark::State& state, const fs::path& repository) {
  Kel_Index index;
  Fill(index, repository);
  const Kel_Key root("core0_v1_00_a");
  for ([[maybe_unused]] const auto _ : state)
    benchmark::DoNotOptimize(LDXParser(index, root, Kel_Key(), "VHDL"));
}

void AnalyseTree(benchmark::State& state) { Analyse(state, Tree(state.range(0), 13)); }
BENCHMARK(AnalyseTree)->Arg(500)->Arg(2000)->Arg(8000)->Unit(benchmark::kMillisecond);

void AnalyseChain(benchmark::State& state) { Analyse(state, Tree(state.range(0), 1)); }
BENCHMARK(AnalyseChain)->Arg(50)->Arg(250)->Arg(500)->Arg(1000)->Unit(benchmark::kMillisecond);

void AnalyseLadder(benchmark::State& state) { Analyse(state, Ladder(state.range(0))); }
BENCHMARK(AnalyseLadder)->Arg(25)->Arg(250)->Unit(benchmark::kMillisecond);

// The same files scanned line by line, each once.
void ScanTree(benchmark::State& state) {
  Kel_Index index;
  Fill(index, Tree(state.range(0), 13));
  std::vector<Port::FileName> files;
  for (std::int64_t core = 0; core < state.range(0); ++core) {
    const Kel_Key key(StringBase((CoreName(core) + "_v1_00_a").c_str()));
    files.push_back(
        Kel_Index::GetDataFile(index.GetIPLocation(key), key, Kel_Index::KEL_LDX_EXTENSION));
  }
  for ([[maybe_unused]] const auto _ : state) {
    std::size_t length = 0;
    for (const Port::FileName& file : files) {
      Tarvo::FileScanner lines(file);
      for (StringBase line; lines.GetNextLine(line);) length += line.GetLength();
    }
    benchmark::DoNotOptimize(length);
  }
}
BENCHMARK(ScanTree)->Arg(500)->Arg(2000)->Arg(8000)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
