// What keys, the index and a walk cost. Times differ from machine to machine; compare the rows of
// one run.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <sys/resource.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <optional>
#include <string>
#include <vector>

#include "Port_FileName.h"
#include "Scratch.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Key;
using Tarvo::KelLibrary;
using Tarvo::StringBase;

std::string CoreName(std::int64_t number) { return "core" + std::to_string(number); }

// A repository of that many described cores of one version each.
fs::path Described(std::int64_t versions) {
  return Scratch::Prepare("described-" + std::to_string(versions), [&](const fs::path& repository) {
    const std::string text = Scratch::Description();
    for (std::int64_t i = 0; i < versions; ++i) {
      Scratch::WriteDataFile(repository, CoreName(i), "qvr", text);
    }
  });
}

// The same without descriptions: directories alone.
fs::path Bare(std::int64_t versions) {
  return Scratch::Prepare("bare-" + std::to_string(versions), [&](const fs::path& repository) {
    for (std::int64_t i = 0; i < versions; ++i) {
      fs::create_directories(repository / "ipmods" / (CoreName(i) + "_v1_00_a"));
    }
  });
}

void CountVersions(benchmark::State& state) {
  state.counters["versions/s"] = benchmark::Counter(static_cast<double>(state.range(0)),
                                                    benchmark::Counter::kIsIterationInvariantRate);
}

void MakeKey(benchmark::State& state) {
  const StringBase text = "pulse_counter_v1_00_a";
  for ([[maybe_unused]] const auto _ : state) benchmark::DoNotOptimize(Kel_Key(text));
}
BENCHMARK(MakeKey);

// The walk of a program that begins: into an empty library. Letting go of it is not measured.
void MeasureWalk(benchmark::State& state, const fs::path& repository) {
  const StringBase path = repository.c_str();
  std::optional<KelLibrary> library;
  for ([[maybe_unused]] const auto _ : state) {
    library.emplace();
    benchmark::DoNotOptimize(library->SetRepositoryPath(path));
    state.PauseTiming();
    library.reset();
    state.ResumeTiming();
  }
  CountVersions(state);
}

void Walk(benchmark::State& state) { MeasureWalk(state, Described(state.range(0))); }
BENCHMARK(Walk)->Arg(1000)->Arg(10000)->Arg(50000)->Unit(benchmark::kMillisecond);

void WalkBare(benchmark::State& state) { MeasureWalk(state, Bare(state.range(0))); }
BENCHMARK(WalkBare)->Arg(1000)->Arg(10000)->Arg(50000)->Unit(benchmark::kMillisecond);

// What reading the described versions costs at least: the directory listed, each file opened, read
// and its line ends counted.
std::ptrdiff_t CountLines(const std::string& name) {
  std::array<char, 65536> buffer;
  std::ptrdiff_t lines = 0;
  const int file = ::open(name.c_str(), O_RDONLY | O_CLOEXEC);
  for (ssize_t size; (size = ::read(file, buffer.data(), buffer.size())) > 0;) {
    lines += std::count(buffer.data(), buffer.data() + size, '\n');
  }
  ::close(file);
  return lines;
}

void ReadPlainly(benchmark::State& state) {
  const fs::path versions = Described(state.range(0)) / "ipmods";
  for ([[maybe_unused]] const auto _ : state) {
    std::ptrdiff_t lines = 0;
    for (const fs::directory_entry& entry : fs::directory_iterator(versions)) {
      const std::string key = entry.path().filename();
      lines += CountLines(entry.path() / "data" / (key.substr(0, key.find('_')) + "_v2_1_0.qvr"));
    }
    benchmark::DoNotOptimize(lines);
  }
  CountVersions(state);
}
BENCHMARK(ReadPlainly)->Arg(1000)->Arg(10000)->Arg(50000)->Unit(benchmark::kMillisecond);

// The process's memory in KiB: now, and the most that it ever had.
double ResidentNow() {
  std::ifstream status("/proc/self/statm");
  double pages = 0;
  status >> pages >> pages;
  return pages * static_cast<double>(::sysconf(_SC_PAGESIZE)) / 1024;
}

double ResidentMost() {
  rusage usage = {};
  ::getrusage(RUSAGE_SELF, &usage);
  return static_cast<double>(usage.ru_maxrss);
}

// One walk, in a process that has done nothing else: only so is the peak that of the walk.
void Memory(benchmark::State& state) {
  const StringBase path = Described(state.range(0)).c_str();
  KelLibrary library;
  const double before = ResidentNow();
  for ([[maybe_unused]] const auto _ : state) library.SetRepositoryPath(path);
  const double after = ResidentNow();
  state.counters["KiB/version"] = (after - before) / static_cast<double>(state.range(0));
  state.counters["MiB above the end"] = (ResidentMost() - after) / 1024;
}
BENCHMARK(Memory)->Arg(50000)->Iterations(1)->Unit(benchmark::kMillisecond);

// The index alone: `shape` gives the text of the i-th key.
void Add(benchmark::State& state, std::string (*shape)(int)) {
  std::vector<Kel_Key> keys;
  keys.reserve(static_cast<std::size_t>(state.range(0)));
  for (int i = 0; i < state.range(0); ++i) keys.emplace_back(StringBase(shape(i).c_str()));
  Port::FileName location;
  location.SetHead("/");
  for ([[maybe_unused]] const auto _ : state) {
    Tarvo::Kel_Index index;
    for (const Kel_Key& key : keys) index.AddIP(key, location);
  }
  CountVersions(state);
}

std::string ManyCores(int i) { return CoreName(i) + "_v1_00_a"; }
std::string NewestLast(int i) { return "core_v" + std::to_string(i) + "_00_a"; }
std::string NewestFirst(int i) { return NewestLast(1'000'000 - i); }

BENCHMARK_CAPTURE(Add, many_cores, ManyCores)->Arg(5000)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Add, newest_last, NewestLast)->Arg(5000)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Add, newest_first, NewestFirst)->Arg(5000)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
