// What keys, the index and a walk cost. Times differ from machine to machine; compare the rows of
// one run. `versions/s` of the walk is to stay the same from 1,000 to 50,000 versions, and the
// long list is one core with all its versions, added newest last, which is the worst order.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "Port_FileName.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Key;
using Tarvo::StringBase;

// About 140 lines and 10 KB: six options, some parameters, many ports.
std::string Description() {
  std::string text =
      "# a generated core\nOPTION DESC = Generated core for measurements\nOPTION HDL = VHDL\n"
      "OPTION STYLE = MIX\nOPTION IP_GROUP = Measurement\nOPTION IPTYPE = BLOCK\n"
      "OPTION CORE_STATE = ACTIVE\n\nBUS_INTERFACE BUS = REGS, BUS_TYPE = SLAVE\n";
  for (int i = 0; i < 30; ++i) {
    const std::string number = std::to_string(i);
    text += "PARAMETER WIDTH_" + number + " = 8, DT = integer, RANGE = (2:32), DESC = \"Width\"\n";
  }
  for (int i = 0; i < 100; ++i) {
    const std::string number = std::to_string(i);
    text += "PORT data_" + number + " = DATA_" + number +
            ",\tDIR = I, VEC = [31:0], BUS = REGS, DESC = \"Data\" # port\n";
  }
  return text;
}

// A repository of that many cores of one version each, for the life of the object, with or without
// descriptions.
class Repository {
 public:
  explicit Repository(std::int64_t versions, bool described = false) {
    std::string pattern = fs::temp_directory_path() / "kel-bench-XXXXXX";
    if (!::mkdtemp(pattern.data())) std::abort();
    root = pattern;
    const std::string text = Description();
    for (std::int64_t i = 0; i < versions; ++i) {
      const std::string core = "core" + std::to_string(i);
      const fs::path data = root / "ipmods" / (core + "_v1_00_a") / "data";
      fs::create_directories(data);
      if (described) std::ofstream(data / (core + "_v2_1_0.qvr")) << text;
    }
  }
  ~Repository() { fs::remove_all(root); }
  Repository(const Repository&) = delete;
  Repository& operator=(const Repository&) = delete;

  StringBase Path() const { return root.c_str(); }
  fs::path Versions() const { return root / "ipmods"; }

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
  const Repository repository(state.range(0));
  Tarvo::KelLibrary library;
  for (auto _ : state) benchmark::DoNotOptimize(library.SetRepositoryPath(repository.Path()));
  CountVersions(state);
}
BENCHMARK(Walk)->Arg(1000)->Arg(10000)->Arg(50000)->Unit(benchmark::kMillisecond);

// The same with a description for each version, and beside it what reading those files costs at
// least: the directory listed, each file opened, read and its line ends counted.
void WalkDescribed(benchmark::State& state) {
  const Repository repository(state.range(0), true);
  Tarvo::KelLibrary library;
  for (auto _ : state) benchmark::DoNotOptimize(library.SetRepositoryPath(repository.Path()));
  CountVersions(state);
}
BENCHMARK(WalkDescribed)->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond);

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
  const Repository repository(state.range(0), true);
  for (auto _ : state) {
    std::ptrdiff_t lines = 0;
    for (const fs::directory_entry& entry : fs::directory_iterator(repository.Versions())) {
      const std::string key = entry.path().filename();
      lines += CountLines(entry.path() / "data" / (key.substr(0, key.find('_')) + "_v2_1_0.qvr"));
    }
    benchmark::DoNotOptimize(lines);
  }
  CountVersions(state);
}
BENCHMARK(ReadPlainly)->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond);

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
