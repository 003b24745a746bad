// What keys, the index and a walk cost. Times differ from machine to machine; compare the rows of
// one run. `versions/s` of the walk is to stay the same from 1,000 to 50,000 versions, and the
// long list is one core with all its versions, added newest last, which is the worst order.

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <filesystem>
#include <string>

#include "Port_FileName.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Key;
using Tarvo::StringBase;

// A repository of that many cores of one version each, for the life of the object.
class Repository {
 public:
  explicit Repository(int versions) {
    std::string pattern = fs::temp_directory_path() / "kel-bench-XXXXXX";
    if (!::mkdtemp(pattern.data())) std::abort();
    root = pattern;
    for (int i = 0; i < versions; ++i) {
      fs::create_directories(root / "ipmods" / ("core" + std::to_string(i) + "_v1_00_a"));
    }
  }
  ~Repository() { fs::remove_all(root); }
  Repository(const Repository&) = delete;
  Repository& operator=(const Repository&) = delete;

  StringBase Path() const { return root.c_str(); }

 private:
  fs::path root;
};

void CountVersions(benchmark::State& state) {
  state.counters["versions/s"] = benchmark::Counter(static_cast<double>(state.range(0)),
                                                    benchmark::Counter::kIsIterationInvariantRate);
}

void MakeKey(benchmark::State& state) {
  const StringBase text = "pulse_counter_v1_00_a";
  for (auto _ : state) benchmark::DoNotOptimize(Kel_Key(text));
}
BENCHMARK(MakeKey);

void Walk(benchmark::State& state) {
  const Repository repository(static_cast<int>(state.range(0)));
  Tarvo::KelLibrary library;
  for (auto _ : state) benchmark::DoNotOptimize(library.SetRepositoryPath(repository.Path()));
  CountVersions(state);
}
BENCHMARK(Walk)->Arg(1000)->Arg(10000)->Arg(50000)->Unit(benchmark::kMillisecond);

// The index alone: `shape` gives the text of the i-th key.
void Add(benchmark::State& state, std::string (*shape)(int)) {
  std::vector<Kel_Key> keys;
  for (int i = 0; i < state.range(0); ++i) keys.emplace_back(StringBase(shape(i).c_str()));
  Port::FileName location;
  location.SetHead("/");
  for (auto _ : state) {
    Tarvo::Kel_Index index;
    for (const Kel_Key& key : keys) index.AddIP(key, location);
  }
  CountVersions(state);
}
BENCHMARK_CAPTURE(Add, many_cores, [](int i) { return "core" + std::to_string(i) + "_v1_00_a"; })
    ->Arg(1000)
    ->Arg(10000)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Add, long_list, [](int i) { return "core_v" + std::to_string(i) + "_00_a"; })
    ->Arg(1000)
    ->Arg(10000)
    ->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
