// Work of a fixed size, whose instructions scripts/check-instructions.py counts: a walk, a request
// for the ports of one core, every question to another one but those for its sources, an
// analyse order, and one that very many ways lead through. Nothing here may depend on time or
// place.

#include <cstddef>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>
#include <utility>

#include "Scratch.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using Tarvo::KelIP;
using Tarvo::KelLibrary;
using Tarvo::StringBase;
using Tarvo::StringList;

constexpr int kCores = 100;
constexpr int kPorts = 200;
constexpr int kLadder = 60;  // cores in it
constexpr int kInterfaces = 40;
constexpr int kNetlists = 40;

std::string CoreName(int number) { return "core_" + std::to_string(number); }

std::string Description() {
  std::string text = "# a generated core\nOPTION DESC = Generated core\nOPTION HDL = VHDL\n";
  for (int i = 0; i < kPorts; ++i) {
    const std::string number = std::to_string(i);
    text.append("PARAMETER WIDTH_").append(number).append(" = 8, DT = integer, RANGE = (2:32)\n");
    text.append("PORT data_").append(number).append(" = DATA_").append(number);
    text += ", DIR = I, VEC = [31:0] # a lane\n";
  }
  return text;
}

// Each core includes up to two others in front of its own ten files.
std::string Order(int number) {
  std::string text;
  for (int other = 2 * number + 1; other <= 2 * number + 2 && other < kCores; ++other) {
    text += "lib " + CoreName(other) + "_v1_00_a all\n";
  }
  for (int i = 0; i < 10; ++i) {
    text += "lib " + CoreName(number) + "_v1_00_a source_" + std::to_string(i) + "\n";
  }
  return text;
}

// With namesakes, records of several interfaces, and one with many properties.
std::string AskedDescription() {
  std::string text = "OPTION STYLE = BLACKBOX\nOPTION DESC = Generated core\n";
  for (int i = 0; i < kInterfaces; ++i) {
    const std::string number = std::to_string(i);
    const std::string next = std::to_string(i + 1);
    text.append("BUS_INTERFACE BUS = REGS_").append(number).append(", BUS_TYPE = SLAVE\n");
    text.append("IO_INTERFACE IO_IF = LEDS_").append(number).append(", IO_TYPE = GPIO\n");
    text.append("PARAMETER WIDTH_").append(number).append(" = 8, BUS = REGS_").append(number);
    text.append(":REGS_").append(next).append("\nPARAMETER HINT = 1, TYPE = NON_HDL\n");
    text.append("PORT data_").append(number).append(" = DATA, VEC = [31:0], BUS = REGS_");
    text.append(number).append(", IO_IF = LEDS_").append(number).append("\n");
  }
  text += "PORT clk = CLK";
  for (int i = 0; i < kInterfaces; ++i) text.append(", KEY_").append(std::to_string(i)) += " = 1";
  return text + "\n";
}

std::string AskedTable() {
  std::string text = "WIDTH_0 WIDTH_1 FILES\n";
  for (int i = 0; i < kNetlists; ++i) {
    text.append(i % 2 == 0 ? "8 8 part_" : "8 16 part_").append(std::to_string(i)) += ".edn\n";
  }
  return text;
}

// Two cores a layer, each of which includes both of the next one.
std::string LadderOrder(int number) {
  std::string text = "lib " + CoreName(number) + "_v1_00_a source\n";
  const int next = number - number % 2 + 2;
  for (int other = next; next < kLadder && other < next + 2; ++other) {
    text += "lib " + CoreName(other) + "_v1_00_a all\n";
  }
  return text;
}

using List = bool (KelIP::*)(StringList&) const;
using ListOf = bool (KelIP::*)(const StringBase&, StringList&) const;
using Get = bool (KelIP::*)(const StringBase&, const StringBase&, StringBase&) const;

struct Kind {
  List list;
  ListOf properties;
  Get get;
};
const Kind kKinds[] = {
    {&KelIP::ListParameters, &KelIP::ListParameterProperties, &KelIP::GetParameterProperty},
    {&KelIP::ListGenerics, &KelIP::ListGenericProperties, &KelIP::GetGenericProperty},
    {&KelIP::ListPorts, &KelIP::ListPortProperties, &KelIP::GetPortProperty},
    {&KelIP::ListBusInterfaces, &KelIP::ListBusInterfaceProperties,
     &KelIP::GetBusInterfaceProperty},
    {&KelIP::ListIOInterfaces, &KelIP::ListIOInterfaceProperties, &KelIP::GetIOInterfaceProperty},
    {&KelIP::ListNetlists, &KelIP::ListNetlistProperties, &KelIP::GetNetlistProperty}};

const std::pair<List, ListOf> kMembers[] = {
    {&KelIP::ListBusInterfaces, &KelIP::ListBusInterfaceParameters},
    {&KelIP::ListBusInterfaces, &KelIP::ListBusInterfacePorts},
    {&KelIP::ListIOInterfaces, &KelIP::ListIOInterfaceParameters},
    {&KelIP::ListIOInterfaces, &KelIP::ListIOInterfacePorts}};

void Require(bool holds) {
  if (!holds) std::abort();
}

}  // namespace

// Outside of the namespace and never inlined, so that they are found by name where the instructions
// are counted.

[[gnu::noinline]] void FixedWalk(KelLibrary& library, const StringBase& path) {
  Require(library.SetRepositoryPath(path));
}

[[gnu::noinline]] std::unique_ptr<KelIP> FixedRequest(const KelLibrary& library) {
  std::unique_ptr<KelIP> core(library.CreateIP("core_0"));
  StringList ports;
  StringList properties;
  StringBase value;
  Require(core && core->ListPorts(ports) && ports.size() == kPorts);
  for (const StringBase& port : ports) {
    Require(core->ListPortProperties(port, properties));
    for (const StringBase& property : properties) {
      Require(core->GetPortProperty(port, property, value));
    }
  }
  return core;
}

[[gnu::noinline]] void FixedQuestions(const KelIP& core) {
  StringList names;
  StringList answers;
  StringBase value;
  for (const Kind& kind : kKinds) {
    Require((core.*kind.list)(names) && names.size() >= kNetlists / 2);
    for (const StringBase& name : names) {
      Require((core.*kind.properties)(name, answers));
      for (const StringBase& property : answers) Require((core.*kind.get)(name, property, value));
    }
  }
  for (const auto& [interfaces, members] : kMembers) {
    Require((core.*interfaces)(names));
    for (const StringBase& name : names) Require((core.*members)(name, answers));
  }
  Require(core.ListIPProperties(names));
  for (const StringBase& name : names) Require(core.GetIPProperty(name, value));
}

[[gnu::noinline]] void FixedOrder(const KelIP& core) {
  StringList sources;
  Require(core.ListSynthesisSources(sources) && sources.size() == std::size_t{kCores} * 10);
}

[[gnu::noinline]] void FixedLadder(const KelIP& core) {
  StringList sources;
  // All but the one beside the first core.
  Require(core.ListSynthesisSources(sources) && sources.size() == std::size_t{kLadder} - 1);
}

int main() {
  const auto repository = Scratch::Prepare("fixed", [](const std::filesystem::path& directory) {
    const std::string description = Description();
    for (int i = 0; i < kCores; ++i) {
      Scratch::WriteDataFile(directory, CoreName(i), "qvr", description);
      Scratch::WriteDataFile(directory, CoreName(i), "ldx", Order(i));
    }
  });
  const auto asked = Scratch::Prepare("asked", [](const std::filesystem::path& directory) {
    Scratch::WriteDataFile(directory, "core", "qvr", AskedDescription());
    Scratch::WriteDataFile(directory, "core", "tew", AskedTable());
  });
  KelLibrary library;
  FixedWalk(library, repository.c_str());
  FixedOrder(*FixedRequest(library));
  Require(library.SetRepositoryPath(asked.c_str()));
  const std::unique_ptr<KelIP> core(library.CreateIP("core"));
  FixedQuestions(*core);
  const auto ladder = Scratch::Prepare("ladder", [](const std::filesystem::path& directory) {
    for (int i = 0; i < kLadder; ++i) {
      Scratch::WriteDataFile(directory, CoreName(i), "qvr", "OPTION HDL = VHDL\n");
      Scratch::WriteDataFile(directory, CoreName(i), "ldx", LadderOrder(i));
    }
  });
  KelLibrary ladderLibrary;
  Require(ladderLibrary.SetRepositoryPath(ladder.c_str()));
  FixedLadder(*std::unique_ptr<KelIP>(ladderLibrary.CreateIP("core_0")));
}
