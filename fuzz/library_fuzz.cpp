// Makes a small repository of the input and asks everything of it. The input is cut at the byte
// 0xFF: the first piece names a third core's directory, the others are the data files of two cores.

#include <cstdint>
#include <filesystem>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "Law.h"
#include "Port_MsgManData.h"
#include "Questions.h"
#include "RepositoryBuilder.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

namespace fs = std::filesystem;
using namespace Questions;
using Tarvo::KelLibrary;

const char* const kFiles[] = {
    "ipmods/abc_v1_00_a/data/abc_v2_1_0.qvr", "ipmods/abc_v1_00_a/data/abc_v2_1_0.ldx",
    "ipmods/abc_v1_00_a/data/abc_v2_1_0.tew", "ipmods/def_v2_00_b/data/def_v2_1_0.qvr",
    "ipmods/def_v2_00_b/data/def_v2_1_0.ldx", "ipmods/def_v2_00_b/data/def_v2_1_0.tew"};

unsigned messages = 0;

std::vector<std::string_view> Cut(std::string_view input) {
  std::vector<std::string_view> pieces;
  for (std::size_t end = 0; end != std::string_view::npos;) {
    end = input.find('\xFF');
    pieces.push_back(input.substr(0, end));
    input.remove_prefix(end == std::string_view::npos ? input.size() : end + 1);
  }
  return pieces;
}

// What the input before left is exchanged, so that directories need not be made anew.
void MakeRepository(RepositoryBuilder& repo, const std::vector<std::string_view>& pieces) {
  static fs::path third;
  std::error_code error;
  if (!third.empty()) fs::remove(third, error);
  std::string name(pieces.front().substr(0, 255));
  for (char& c : name) c = c == '/' ? '_' : c;
  third = fs::path(repo / "ipmods/x").replace_filename(name);
  fs::create_directory(third, error);
  for (std::size_t i = 0; i < std::size(kFiles); ++i) {
    if (i + 1 < pieces.size()) {
      repo.File(kFiles[i], std::string(pieces[i + 1]));
    } else {
      fs::remove(repo / kFiles[i], error);
    }
  }
}

// What an operation that may fail gave. One that fails says so.
template <class Operation>
bool Asked(const Operation& operation) {
  const unsigned before = messages;
  const bool answered = operation();
  Law(answered || messages > before, "a failure is told");
  return answered;
}

void AskElements(const KelIP& ip) {
  StringList names;
  StringList properties;
  StringBase value;
  for (const Kind& kind : kKinds) {
    Law((ip.*kind.list)(names), "all elements of a kind can be listed");
    for (const StringBase& name : names) {
      Law((ip.*kind.listProperties)(name, properties), "a listed name can be asked for");
      for (const StringBase& property : properties) {
        Law((ip.*kind.get)(name, property, value), "a listed property can be asked for");
      }
    }
  }
  for (const Members& members : kMembers) {
    Law((ip.*members.interfaces)(names), "all interfaces can be listed");
    for (const StringBase& name : names) {
      Law((ip.*members.list)(name, properties), "a declared interface has its members");
    }
  }
}

void AskSources(const KelIP& ip, std::string_view input) {
  StringList sources;
  StringList list;
  StringBase value;
  for (const auto question : {&KelIP::ListSynthesisSources, &KelIP::ListSimulationSources}) {
    if (!(ip.*question)(sources)) return;  // in silence for a core of netlists
    for (const StringBase& source : sources) {
      const bool told = ip.ListSourceProperties(source, list);
      Law(told || !TellsLibraries(input), "a listed source has properties");
      for (const StringBase& property : list) {
        const bool mayLack = property == KelIP::KEL_HDL_LANGUAGE_PROPERTY;  // by its extension
        Law(ip.GetSourceProperty(source, property, value) || mayLack, "they can be asked for");
      }
    }
  }
  Law(ip.ListSynthesisLibraries(list) && ip.ListSimulationLibraries(list),
      "what has sources has libraries");
  Law(ip.ListVerilogIncludeLibraries(list), "what has sources lists include libraries");
  for (const StringBase& library : list) {
    Law(ip.GetVerilogIncludeLocation(library, value), "an include library has a directory");
  }
}

void AskNetlists(const KelIP& ip) {
  StringList netlists;
  StringList list;
  StringBase value;
  if (!ip.ListNetlists(netlists)) return;  // in silence for a core of sources
  Law(ip.ListNetlistLibraries(list), "what has netlists has libraries");
  for (const StringBase& netlist : netlists) {
    Law(ip.ListNetlistProperties(netlist, list), "a listed netlist has properties");
    for (const StringBase& property : list) {
      Law(ip.GetNetlistProperty(netlist, property, value), "they can be asked for");
    }
  }
}

void AskCore(const KelLibrary& library, const StringBase& key, std::string_view input) {
  StringList list;
  StringBase value;
  Law(library.GetLocation(key).GetLength() > 0 && library.GetName(key).GetLength() > 0 &&
          library.GetVersion(key).GetLength() > 0 && library.GetLatestIPKey(key).GetLength() > 0,
      "a listed core has a place, a name, a version and a newest version");
  Law(library.ListIPProperties(key, list), "a listed core has options");
  for (const StringBase& option : list) {
    Law(library.GetIPProperty(key, option, value), "they can be asked for");
  }
  std::unique_ptr<KelIP> ip;
  Asked([&] {
    ip.reset(library.CreateIP(key));
    return ip != nullptr;
  });
  if (!ip) return;
  Law(ip->GetKey() == key && ip->GetLocation() == library.GetLocation(key),
      "an instance is that of its key");
  Law(ip->ListIPProperties(list), "an instance has options");
  for (const StringBase& option : list) ip->GetIPProperty(option, value);
  AskElements(*ip);
  AskSources(*ip, input);
  AskNetlists(*ip);
  Law(ip->ListParameters(list), "parameters can be listed");
  for (const StringBase& parameter : list) {
    Law(ip->SetParameterProperty(parameter, "VALUE", "1"), "a listed parameter can be set");
  }
  AskNetlists(*ip);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static RepositoryBuilder repo;
  static const bool made = fs::create_directories(repo / "ipmods/abc_v1_00_a/include");
  Law(made, "there is a directory to work in");
  Port_MsgManData::setHandler([](const Port_Message&) { ++messages; });
  const std::string_view input(reinterpret_cast<const char*>(data), size);
  MakeRepository(repo, Cut(input));
  KelLibrary library;
  Asked([&] { return library.SetRepositoryPath(repo.Path().c_str()); });
  StringList keys;
  Law(library.ListAllIPKeys(keys), "keys can be listed");
  for (const StringBase& key : keys) AskCore(library, key, input);
  return 0;
}
