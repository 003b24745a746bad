// What a large core description costs: opening it, and asking for every property of every record or
// for the members of every interface, beside cutting the same lines once with the same tokenizer.
// Times differ from machine to machine; compare the rows of one run. The argument is the number of
// ports; there are two parameters for every five of them.

#include <benchmark/benchmark.h>

#include <boost/tokenizer.hpp>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>

#include "Port_FileName.h"
#include "Scratch.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_QVRParser.h"

namespace {

using Tarvo::QVRParser;
using Tarvo::StringBase;
using Tarvo::StringList;

// A description with that many ports.
Port::FileName Description(std::int64_t ports) {
  const std::string name = "ports-" + std::to_string(ports) + ".qvr";
  return Port::FileName(
      Scratch::Prepare(name, [&](const std::filesystem::path& unfinished) {
        std::ofstream file(unfinished);
        file << "OPTION STYLE = HDL\nBUS_INTERFACE BUS = REGS, BUS_TYPE = SLAVE\n";
        for (std::int64_t i = 0; i < ports * 2 / 5; ++i) {
          file << "PARAMETER WIDTH_" << i
               << " = 8, DT = integer, RANGE = (2:32), DESC = \"Width\"\n";
        }
        for (std::int64_t i = 0; i < ports; ++i) {
          file << "PORT data_" << i << " = DATA_" << i
               << ", DIR = I, VEC = [31:0], BUS = REGS, DESC = \"Data of a lane\"\n";
        }
      }).c_str());
}

// A description with that many bus interfaces, each of which has a port and a parameter of its own,
// shares one with its neighbour, and has the clock as all others have it.
Port::FileName InterfaceDescription(std::int64_t interfaces) {
  const std::string name = "interfaces-" + std::to_string(interfaces) + ".qvr";
  return Port::FileName(Scratch::Prepare(name, [&](const std::filesystem::path& unfinished) {
                          std::ofstream file(unfinished);
                          std::string all;
                          for (std::int64_t i = 0; i < interfaces; ++i) {
                            file << "BUS_INTERFACE BUS = REGS_" << i << ", BUS_TYPE = SLAVE\n"
                                 << "PARAMETER WIDTH_" << i << " = 8, BUS = REGS_" << i << ":REGS_"
                                 << i + 1 << "\n"
                                 << "PORT data_" << i << " = DATA, DIR = I, BUS = REGS_" << i
                                 << "\n";
                            all += ":REGS_" + std::to_string(i);
                          }
                          file << "PORT clk = CLK, DIR = I, BUS = " << all << "\n";
                        }).c_str());
}

// With 7142 ports, a description has 10,000 statements.
void Sizes(benchmark::internal::Benchmark* benchmark) {
  for (const std::int64_t ports : {100, 1000, 5000, 7142}) benchmark->Arg(ports);
}

void CutLines(benchmark::State& state) {
  const Port::FileName description = Description(state.range(0));
  const boost::char_separator<char> separator("", " ,=()[]\"'", boost::drop_empty_tokens);
  for ([[maybe_unused]] const auto _ : state) {
    Tarvo::FileScanner lines(description);
    StringBase line;
    std::size_t tokens = 0;
    while (lines.GetNextLine(line)) {
      const std::string text(line.View());
      for (const std::string& token : boost::tokenizer(text, separator)) tokens += token.size();
    }
    benchmark::DoNotOptimize(tokens);
  }
}
BENCHMARK(CutLines)->Apply(Sizes)->Unit(benchmark::kMillisecond);

void Open(benchmark::State& state) {
  const Port::FileName description = Description(state.range(0));
  for ([[maybe_unused]] const auto _ : state) benchmark::DoNotOptimize(QVRParser(description));
}
BENCHMARK(Open)->Apply(Sizes)->Unit(benchmark::kMillisecond);

void AskEverything(benchmark::State& state) {
  const Port::FileName description = Description(state.range(0));
  const QVRParser parser(description);
  for ([[maybe_unused]] const auto _ : state) {
    for (const StringBase& port : parser.ListPorts()) {
      for (const StringBase& property : parser.ListPortProperties(port)) {
        benchmark::DoNotOptimize(parser.GetPortProperty(port, property));
      }
    }
    for (const StringBase& parameter : parser.ListParameters()) {
      for (const StringBase& property : parser.ListParameterProperties(parameter)) {
        benchmark::DoNotOptimize(parser.GetParameterProperty(parameter, property));
      }
    }
  }
}
BENCHMARK(AskEverything)->Arg(100)->Arg(1000)->Arg(5000)->Unit(benchmark::kMillisecond);

void OpenInterfaces(benchmark::State& state) {
  const Port::FileName description = InterfaceDescription(state.range(0));
  for ([[maybe_unused]] const auto _ : state) benchmark::DoNotOptimize(QVRParser(description));
}
BENCHMARK(OpenInterfaces)->Arg(2000)->Unit(benchmark::kMillisecond);

void AskMembers(benchmark::State& state) {
  const QVRParser parser(InterfaceDescription(state.range(0)));
  for ([[maybe_unused]] const auto _ : state) {
    for (const StringBase& interface : parser.ListBusInterfaces()) {
      benchmark::DoNotOptimize(parser.ListBusInterfaceParameters(interface));
      benchmark::DoNotOptimize(parser.ListBusInterfacePorts(interface));
    }
  }
}
BENCHMARK(AskMembers)->Arg(2000)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
