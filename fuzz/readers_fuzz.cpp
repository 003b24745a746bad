// Gives the input to a reader as its file. The first byte chooses the reader, by its number modulo
// five.

#include <algorithm>
#include <cstdint>
#include <memory>
#include <set>
#include <string>
#include <string_view>

#include "Law.h"
#include "Port_FileName.h"
#include "Port_MsgManData.h"
#include "Questions.h"
#include "RepositoryBuilder.h"
#include "Tarvo_AppException.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_LDXParser.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_TEWParser.h"
#include "Tarvo_TokenReader.h"

namespace {

using namespace Questions;
using Port::FileName;
using Tarvo::AppException;
using Tarvo::FileScanner;
using Tarvo::Kel_Index;
using Tarvo::Kel_Key;
using Tarvo::OptionScanner;

// Two cores to refer to, by the names that the dictionary has.
class Cores {
 public:
  Cores() {
    for (const char* const name : {"abc_v1_00_a", "def_v2_00_b"}) {
      const auto core = repo.Core(name)
                            .Qvr("OPTION HDL = MIXED\nPARAMETER P = 1\nPARAMETER Q = 2\n")
                            .Ldx("lib " + std::string(name) + " one.vhd\nlib abc_v1_00_a two\n");
      FileName location;
      location.SetHead(core.Location().c_str());
      index.AddIP(Kel_Key(name), location);
    }
  }

  FileName Write(std::string_view content) {
    repo.File("file", std::string(content));
    return FileName((repo / "file").c_str());
  }

  Kel_Index index;

 private:
  RepositoryBuilder repo;
};

// The result of what may throw an exception of ours, and nothing else; null then.
template <class Make>
auto Made(const Make& make) -> decltype(make()) {
  try {
    return make();
  } catch (const AppException&) {
    return nullptr;
  }
}

void CheckTokens(std::string_view line) {
  for (const auto groups : {Tarvo::TokenReader::WithGroups, Tarvo::TokenReader::WithoutGroups}) {
    std::string joined;
    for (Tarvo::TokenReader tokens(line, " ,=()[]\"'", groups); !tokens.GetRest().empty();) {
      joined += tokens.GetToken();
      tokens.Step();
    }
    Law(joined == line, "tokens join to their line");
    std::string_view field;
    for (Tarvo::TokenReader tokens(line, " ,=()[]\"'", groups); tokens.ReadField(field);) {
      Law(line.find(field) != std::string_view::npos, "a field is a part of its line");
    }
  }
}

void ReadLines(Cores& cores, std::string_view content) {
  FileScanner views(cores.Write(content));
  FileScanner copies = views;
  std::string_view line;
  StringBase copy;
  unsigned number = 0;
  unsigned copyNumber = 0;
  unsigned count = 0;
  while (views.GetNextLine(line, number)) {
    ++count;
    Law(copies.GetNextLine(copy, copyNumber) && copy.View() == line && copyNumber == number,
        "a view is what a copy is");
    Law(number == count, "each line has its number");
    Law(line.find_first_of("#\t\n") == std::string_view::npos, "a line is clean");
    Law(line.empty() || (line.front() != ' ' && line.back() != ' '), "a line is trimmed");
    CheckTokens(line);
  }
  Law(!copies.GetNextLine(copy) && copy.GetLength() == 0 && number == count + 1, "the end is told");
  views.GoToStart();
  Law(views.GetNextLine(line, number) == (count > 0), "lines can be walked again");
}

// Where the two readers of descriptions tell an option's statement apart from other lines, or cut
// it, in different ways.
bool ReadDifferently(std::string_view content) {
  if (content.find(':') != std::string_view::npos) return true;
  for (std::size_t at = 0; (at = content.find("OPTION", at)) != std::string_view::npos;) {
    at += std::string_view("OPTION").size();
    if (at < content.size() && content[at] != ' ' && content[at] != '\t') return true;
  }
  return false;
}

void ReadDescription(Cores& cores, std::string_view content) {
  const FileName file = cores.Write(content);
  const auto options =
      Made([&] { return std::make_unique<OptionScanner>(Kel_Key("abc_v1_00_a"), file); });
  const auto parser = Made([&] { return std::make_unique<QVRParser>(file); });
  if (!parser) return;
  for (const Kind& kind : kKinds) {
    for (const StringBase& name : (*parser.*kind.parserList)()) {
      for (const StringBase& property : (*parser.*kind.parserListProperties)(name)) {
        (*parser.*kind.parserGet)(name, property);  // throws nothing
      }
    }
  }
  StringList names;
  for (const StringBase& option : parser->ListOptions()) {
    parser->GetOptionValue(option);
    names.push_back(option);
  }
  if (ReadDifferently(content)) return;
  Law(options != nullptr, "what the description's parser takes, the scanner of options takes");
  StringList scanned = {"NAME", "VERSION"};
  scanned.insert(scanned.end(), names.begin(), names.end());
  StringList stated;
  for (const auto& [name, value] : options->GetOptions()) stated.push_back(name);
  Law(stated == scanned, "both find the same options");
}

void ReadOrder(Cores& cores, std::string_view content) {
  const Kel_Key key("abc_v1_00_a");
  if (content.empty()) return;
  const FileName file = cores.Write(content.substr(1));
  const char* const languages[] = {"VHDL", "Verilog", "MIXED", "BOTH"};
  const StringBase language = languages[static_cast<unsigned char>(content.front()) % 4];
  const auto order = Made([&] {
    return std::make_unique<Tarvo::LDXParser>(file, cores.index, key, Kel_Key(), language);
  });
  if (!order) return;
  for (const auto& [sources, libraries] :
       {std::pair{order->ListSynthesisAnalyseOrder(), order->ListSynthesisLibraries()},
        {order->ListSimulationAnalyseOrder(), order->ListSimulationLibraries()}}) {
    Law(sources.empty() == libraries.empty(), "there are libraries where there are sources");
    Law(std::set<StringBase>(libraries.begin(), libraries.end()).size() == libraries.size(),
        "a library stands once");
    for (const StringBase& source : sources) {
      const Kel_Key library = order->GetFileLibrary(FileName(source));
      Law(library.IsValid() || !TellsLibraries(content), "a listed source finds its library");
    }
  }
  for (const StringBase& library : order->ListVerilogIncludeLibraryKeys()) {
    order->GetVerilogIncludeLocation(library);
  }
}

void ReadBlackBoxes(Cores& cores, std::string_view content) {
  const Kel_Key key("abc_v1_00_a");
  const FileName file = cores.Write(content);
  QVRParser parser(cores.index, key);
  const auto table =
      Made([&] { return std::make_unique<Tarvo::TEWParser>(file, cores.index, key, &parser); });
  if (!table) return;
  for (const char* const value : {"1", "2", "3"}) {
    parser.SetParameterProperty("P", "VALUE", value);
    const StringList files = table->ListFiles();
    Law(files.empty() == table->ListLibraries().empty(), "netlists have libraries");
    for (const StringBase& netlist : files) {
      Law(table->GetFileLibrary(FileName(netlist)).IsValid(), "a netlist finds its library");
    }
  }
}

void ReadKey(Cores&, std::string_view content) {
  const Kel_Key key{StringBase(content)};
  const Kel_Key again(key.GetKey());
  Law(again == key && again.IsValid() == key.IsValid(), "a key reads its own text");
  Law(!(key < again) && !(key > again), "a key is no newer than itself");
  if (!key.IsValid()) return;
  Law(key.GetName().GetLength() > 0 && key.GetRevision().GetLength() == 1, "a version is whole");
  Law(key.GetKey().View().substr(0, key.GetName().GetLength()) == key.GetName().View(),
      "a key begins with its name");
}

constexpr void (*kReaders[])(Cores&, std::string_view) = {ReadLines, ReadDescription, ReadOrder,
                                                          ReadBlackBoxes, ReadKey};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static Cores cores;
  Port_MsgManData::setHandler([](const Port_Message&) {});
  if (size == 0) return 0;
  const std::string_view content(reinterpret_cast<const char*>(data) + 1, size - 1);
  kReaders[data[0] % std::size(kReaders)](cores, content);
  return 0;
}
