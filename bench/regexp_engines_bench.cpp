// The measurement behind docs/decisions/0001-regular-expressions.md: what a version suffix costs
// with each engine, from making the object to one match, and on texts of a megabyte. Built only
// with -DKEL_BENCH_ENGINES=ON, since nothing else needs three engines.

#include <benchmark/benchmark.h>
#include <re2/re2.h>

#include <boost/regex.hpp>
#include <memory>
#include <stdexcept>
#include <string>

#define PCRE2_CODE_UNIT_WIDTH 8
#include <pcre2.h>

namespace {

const char* const kPattern = "[_][vV][0-9]+[_][0-9][0-9][_][a-zA-Z]$";

std::string Key() { return "pulse_counter_v1_00_a"; }

// Suffixes that all fail at the end: as many starts as a text can offer.
std::string ManyStarts() {
  std::string text;
  while (text.size() < (1U << 20U)) text += "_v1_00_a";
  return text + "_";
}

// One start and a run of digits that leads nowhere.
std::string ManyDigits() { return "_v" + std::string(1U << 20U, '1'); }

struct BoostRegex {
  boost::regex program{kPattern};
  bool Match(const std::string& text) const {
    boost::smatch match;
    return boost::regex_search(text, match, program);
  }
};

struct Pcre2 {
  struct Free {
    void operator()(pcre2_code* code) const { pcre2_code_free(code); }
    void operator()(pcre2_match_data* data) const { pcre2_match_data_free(data); }
  };
  std::unique_ptr<pcre2_code, Free> program;
  Pcre2() {
    int error = 0;
    PCRE2_SIZE offset = 0;
    program.reset(pcre2_compile(reinterpret_cast<PCRE2_SPTR>(kPattern), PCRE2_ZERO_TERMINATED,
                                PCRE2_DOLLAR_ENDONLY, &error, &offset, nullptr));
  }
  bool Match(const std::string& text) const {
    const std::unique_ptr<pcre2_match_data, Free> data(pcre2_match_data_create(1, nullptr));
    const int result = pcre2_match(program.get(), reinterpret_cast<PCRE2_SPTR>(text.data()),
                                   text.size(), 0, 0, data.get(), nullptr);
    if (result < PCRE2_ERROR_NOMATCH) throw std::runtime_error("a limit of the engine was reached");
    return result > 0;
  }
};

struct Re2 {
  re2::RE2 program{kPattern, re2::RE2::Latin1};
  bool Match(const std::string& text) const {
    re2::StringPiece match;
    return program.Match(text, 0, text.size(), re2::RE2::UNANCHORED, &match, 1);
  }
};

template <class Engine>
void MakeAndMatchKey(benchmark::State& state) {
  const std::string text = Key();
  for ([[maybe_unused]] const auto _ : state) benchmark::DoNotOptimize(Engine().Match(text));
}

template <class Engine>
void Match(benchmark::State& state, const std::string& text) {
  const Engine engine;
  try {
    for ([[maybe_unused]] const auto _ : state) benchmark::DoNotOptimize(engine.Match(text));
  } catch (const std::exception& error) {
    state.SkipWithError(error.what());
  }
}

template <class Engine>
void Register(const std::string& engine) {
  benchmark::RegisterBenchmark((engine + "/make+key").c_str(), MakeAndMatchKey<Engine>);
  benchmark::RegisterBenchmark((engine + "/key").c_str(), Match<Engine>, Key());
  benchmark::RegisterBenchmark((engine + "/1MiB starts").c_str(), Match<Engine>, ManyStarts());
  benchmark::RegisterBenchmark((engine + "/1MiB digits").c_str(), Match<Engine>, ManyDigits());
}

}  // namespace

int main(int argc, char** argv) {
  benchmark::Initialize(&argc, argv);
  Register<BoostRegex>("boost");
  Register<Pcre2>("pcre2");
  Register<Re2>("re2");
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
