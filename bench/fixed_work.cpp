// Work of a fixed size, whose instructions scripts/check-instructions.py counts: a walk, a request
// for everything of one core, and an analyse order. Nothing here may depend on time or place.

#include <cstddef>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>

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

[[gnu::noinline]] void FixedOrder(const KelIP& core) {
  StringList sources;
  Require(core.ListSynthesisSources(sources) && sources.size() == std::size_t{kCores} * 10);
}

int main() {
  const auto repository = Scratch::Prepare("fixed", [](const std::filesystem::path& directory) {
    const std::string description = Description();
    for (int i = 0; i < kCores; ++i) {
      Scratch::WriteDataFile(directory, CoreName(i), "qvr", description);
      Scratch::WriteDataFile(directory, CoreName(i), "ldx", Order(i));
    }
  });
  KelLibrary library;
  FixedWalk(library, repository.c_str());
  FixedOrder(*FixedRequest(library));
}
