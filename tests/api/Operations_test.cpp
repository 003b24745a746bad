// Every guarded operation of a library and its instances: what it answers, what it says when there
// is no answer, and what it says while memory fails. tests/data/operations.txt holds all of it.

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "Questions.h"
#include "RepositoryBuilder.h"
#include "ReviewedText.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Questions;
using namespace Tarvo;
using Kind = AllocationFault::Kind;

// Names that don't fit into a string object, so that every operation allocates.
const char kStatements[] =
    "OPTION AN_OPTION_WITH_A_LONG_NAME = a value of some length\n"
    "BUS_INTERFACE BUS = A_BUS_WITH_A_LONG_NAME\nIO_INTERFACE IO_IF = AN_IO_WITH_A_LONG_NAME\n"
    "PARAMETER A_PARAMETER_WITH_A_LONG_NAME = the_value_of_a_parameter, "
    "BUS = A_BUS_WITH_A_LONG_NAME, IO_IF = AN_IO_WITH_A_LONG_NAME\n"
    "PORT A_PORT_WITH_A_LONG_NAME = the_default_of_a_port, BUS = A_BUS_WITH_A_LONG_NAME, "
    "IO_IF = AN_IO_WITH_A_LONG_NAME\n";
const char kAnalyseOrder[] =
    "lib a_core_with_a_long_name a_source_with_a_long_name.vhd\nlib other all\n"
    "vlgincdir an_include_library_with_a_long_name data";
const char kNetlists[] =
    "A_PARAMETER_WITH_A_LONG_NAME FILES\nthe_value_of_a_parameter a_netlist_with_a_long_name.edn\n"
    "another other:n.edn, m.edn rest";
const StringBase kOption = "AN_OPTION_WITH_A_LONG_NAME";
const StringBase kParameter = "A_PARAMETER_WITH_A_LONG_NAME";
const StringBase kPort = "A_PORT_WITH_A_LONG_NAME";
const StringBase kBus = "A_BUS_WITH_A_LONG_NAME";
const StringBase kIo = "AN_IO_WITH_A_LONG_NAME";
const StringBase kLibrary = "an_include_library_with_a_long_name";
const StringBase kLong = "a text that is too long for a string object";

// The names of an element and of one of its properties, for each of kKinds; and for kMembers.
const StringBase kElements[][2] = {{kParameter, "VALUE"},
                                   {kParameter, "VALUE"},
                                   {kPort, "DEFAULT"},
                                   {kBus, "NAME"},
                                   {kIo, "NAME"}};
const StringBase kInterfaces[] = {kBus, kBus, kIo, kIo};

// Outputs as text.
struct Text {
  static std::string Of(const StringBase& text) { return text.GetText(); }
  static std::string Of(const Kel_Key& key) { return key.GetKey().GetText(); }
  static std::string Of(unsigned number) { return std::to_string(number); }
  static std::string Of(const KelPlace& at) { return Join(at.file, at.line, at.column, at.length); }
  static std::string Of(const KelStatement& one) { return Join(one.kind, one.name, one.place); }
  static std::string Of(const KelSource& one) { return Join(one.path, one.place); }
  static std::string Of(const KelIncludeDirectory& one) { return Join(one.path, one.place); }
  static std::string Of(const KelInclude& one) { return Join(one.library, one.place); }
  static std::string Of(const KelNetlist& one) { return Join(one.path, one.library); }
  static std::string Of(const KelNetlistRow& one) {
    const StringBase applies = one.applies ? "applies" : "-";
    return Join(one.values, one.netlists, one.ignored, applies, one.place);
  }
  static std::string Of(const KelNetlistTable& table) {
    return Of(table.parameters) + Of(table.rows);
  }
  template <class Element>
  static std::string Of(const std::vector<Element>& list) {
    std::string text;
    for (const Element& one : list) text += "<" + Of(one) + ">";
    return text;
  }

 private:
  template <class... Parts>
  static std::string Join(const Parts&... parts) {
    return ((Of(parts) + " ") + ...);
  }
};

// What is asked, and for what the library is.
struct Subject {
  KelLibrary& library;
  KelIP& ip;
  StringBase path;
  StringBase key;
};

// An operation, run while one allocation fails; none for -1. It gives what it left behind.
struct Operation {
  std::string name;
  std::function<std::string(const Subject& subject, int count, Kind kind)> run;
};

template <class Output, class Call>
Operation Make(const std::string& name, const Output& old, const Call& call) {
  return {name, [=](const Subject& subject, int count, Kind kind) {
            Output output = old;
            bool done = false;
            {
              const AllocationFault fault(count, kind);
              done = call(subject, output);
            }
            std::string text = Text::Of(output);
            if (text == Text::Of(old)) text = "untouched";
            if (text.empty()) text = "cleared";
            return (done ? "true " : "false ") + text;
          }};
}

// A question to the instance.
template <class Question, class Output, class... Arguments>
Operation Ask(const std::string& name, Question question, const Output& old,
              const Arguments&... arguments) {
  return Make(name, old, [=](auto& subject, auto& output) {
    return (subject.ip.*question)(arguments..., output);
  });
}

using Operations = std::vector<Operation>;
const StringBase kOldText = "old";
const StringList kOldList = {"old"};

Operations OfLibraries() {
  using Query = StringBase (KelLibrary::*)(const StringBase&) const;
  const std::pair<const char*, Query> queries[] = {{"GetLocation", &KelLibrary::GetLocation},
                                                   {"GetLatestIPKey", &KelLibrary::GetLatestIPKey},
                                                   {"GetName", &KelLibrary::GetName},
                                                   {"GetVersion", &KelLibrary::GetVersion}};
  Operations all = {
      Make("SetRepositoryPath", kOldText,
           [](auto& to, auto&) { return to.library.SetRepositoryPath(to.path); }),
      Make("RefreshLibrary", kOldText, [](auto& to, auto&) { return to.library.RefreshLibrary(); }),
      Make("GetIPProperty of the library", kOldText,
           [](auto& to, auto& value) { return to.library.GetIPProperty(to.key, kOption, value); }),
      Make("ListIPProperties of the library", kOldList,
           [](auto& to, auto& list) { return to.library.ListIPProperties(to.key, list); }),
      Make("CreateIP", kOldText, [](auto& to, auto&) {
        return std::unique_ptr<KelIP>(to.library.CreateIP(to.key)) != nullptr;
      })};
  for (const auto& [name, query] : queries) {
    all.push_back(Make(name, kOldText, [query = query](auto& to, auto& value) {
      value = (to.library.*query)(to.key);
      return value.GetLength() > 0;
    }));
  }
  return all;
}

Operations OfElements() {
  Operations all = {Ask("GetIPProperty", &KelIP::GetIPProperty, kOldText, kOption),
                    Ask("ListIPProperties", &KelIP::ListIPProperties, kOldList),
                    Make("SetParameterProperty", kOldText, [](auto& to, auto&) {
                      return to.ip.SetParameterProperty(kParameter, "VALUE", kLong);
                    })};
  for (std::size_t i = 0; i < std::size(kKinds); ++i) {
    const auto& kind = kKinds[i];
    const auto& [element, property] = kElements[i];
    const std::string of = std::string(" of ") + kind.name;
    all.push_back(Ask(kind.name, kind.list, kOldList));
    all.push_back(Ask("properties" + of, kind.listProperties, kOldList, element));
    all.push_back(Ask("property" + of, kind.get, kOldText, element, property));
  }
  for (std::size_t i = 0; i < std::size(kMembers); ++i) {
    all.push_back(Ask(kMembers[i].name, kMembers[i].list, kOldList, kInterfaces[i]));
  }
  return all;
}

// Those that read further files, at a location for what stands there.
Operations OfFiles(const std::string& at) {
  const StringBase source = (at + "/hdl/vhdl/a_source_with_a_long_name.vhd").c_str();
  const StringBase netlist = (at + "/netlist/a_netlist_with_a_long_name.edn").c_str();
  const std::vector<KelSource> oldSources(1);
  const StringBase head = "FILENAME_HEAD", library = "LIBRARY";
  return {Ask("ListSynthesisSources", &KelIP::ListSynthesisSources, kOldList),
          Ask("ListSimulationSources", &KelIP::ListSimulationSources, kOldList),
          Ask("ListSynthesisLibraries", &KelIP::ListSynthesisLibraries, kOldList),
          Ask("ListSimulationLibraries", &KelIP::ListSimulationLibraries, kOldList),
          Ask("ListVerilogIncludeLibraries", &KelIP::ListVerilogIncludeLibraries, kOldList),
          Ask("GetVerilogIncludeLocation", &KelIP::GetVerilogIncludeLocation, kOldText, kLibrary),
          Ask("GetSourceProperty", &KelIP::GetSourceProperty, kOldText, source, head),
          Ask("ListSourceProperties", &KelIP::ListSourceProperties, kOldList, source),
          Ask("ListNetlists", &KelIP::ListNetlists, kOldList),
          Ask("ListNetlistLibraries", &KelIP::ListNetlistLibraries, kOldList),
          Ask("GetNetlistProperty", &KelIP::GetNetlistProperty, kOldText, netlist, library),
          Ask("ListNetlistProperties", &KelIP::ListNetlistProperties, kOldList, netlist),
          Ask("GetStatements", &KelIP::GetStatements, std::vector<KelStatement>(1)),
          Ask("GetSynthesisSources", &KelIP::GetSynthesisSources, oldSources),
          Ask("GetSimulationSources", &KelIP::GetSimulationSources, oldSources),
          Ask("GetVerilogIncludeDirectories", &KelIP::GetVerilogIncludeDirectories,
              std::vector<KelIncludeDirectory>(1)),
          Ask("GetIncludes", &KelIP::GetIncludes, std::vector<KelInclude>(1)),
          Ask("GetNetlistTable", &KelIP::GetNetlistTable, KelNetlistTable{kOldList, {}})};
}

class GuardedOperations : public testing::Test {
 protected:
  GuardedOperations() {
    MakeFull("OPTION STYLE = MIX\n");
    repo.Core("other_v2_00_a").Qvr("").Ldx("simlib other b.vhd");
    repo.Core("none_v1_00_a").Qvr("OPTION STYLE = MIX");
    EXPECT_TRUE(library.SetRepositoryPath(repo.Path().c_str()));
    none.reset(library.CreateIP("none"));
  }
  void MakeFull(const std::string& style) {
    repo.Core("a_core_with_a_long_name_v1_00_a")
        .Qvr(style + kStatements)
        .Ldx(kAnalyseOrder)
        .Tew(kNetlists);
  }
  StringBase At(const std::string& name) const { return (repo / name).c_str(); }

  // A core that answers everything, its further files read, and one that has none of it.
  Subject Full() {
    full.reset(library.CreateIP("a_core_with_a_long_name"));
    StringList list;
    full->ListNetlists(list);
    full->ListSynthesisSources(list);
    return {library, *full, At(""), "a_core_with_a_long_name"};
  }
  Subject None() { return {library, *none, At("no%s"), "No%s_V1_00_A"}; }

  // What an operation left behind and the message that it issued.
  std::string Run(const Operation& operation, const Subject& subject, int count = -1,
                  Kind kind = AllocationFault::BadAlloc) {
    std::string text = operation.run(subject, count, kind);
    for (const std::string& message : recorder.Take()) {
      text += "  " + Replaced(message, "\n", "\\n");
    }
    text = Replaced(text, repo.Path(), "$");
    return Replaced(text, "a_core_with_a_long_name", "CORE");
  }
  void Describe(const Operation& operation);
  void DescribeFaults(const Operation& operation, const std::string& answer, Kind kind);
  void DescribeStyle(const std::string& options);

  RepositoryBuilder repo;
  MessageRecorder recorder;
  KelLibrary library;
  std::unique_ptr<KelIP> full;
  std::unique_ptr<KelIP> none;
  const Operations ofFiles = OfFiles(repo / "ipmods/a_core_with_a_long_name_v1_00_a");
  std::string report;
};

// Each allocation of the operation fails once. It answers as ever when asked again.
void GuardedOperations::DescribeFaults(const Operation& operation, const std::string& answer,
                                       Kind kind) {
  const char* const names[] = {"memory:   ", "unknown:  ", "fatal:    "};
  std::set<std::string> different;
  const Subject subject = Full();
  for (int count = 0;; ++count) {
    const std::string result = Run(operation, subject, count, kind);
    if (!AllocationFault::Fired()) break;
    EXPECT_NE(result, answer) << operation.name << " " << count;
    EXPECT_EQ(Run(operation, subject), answer) << operation.name << " " << count;
    different.insert(result);
  }
  for (const std::string& result : different) report += "    " + (names[kind] + result) + "\n";
}

void GuardedOperations::Describe(const Operation& operation) {
  const std::string answer = Run(operation, Full());
  report += operation.name + "\n    full:     " + answer + "\n";
  report += "    none:     " + Run(operation, None()) + "\n";
  for (const auto kind : {AllocationFault::BadAlloc, AllocationFault::FatalException,
                          AllocationFault::SomethingElse}) {
    DescribeFaults(operation, answer, kind);
  }
}

// The operations that a core with these options has no answer for, in silence.
void GuardedOperations::DescribeStyle(const std::string& options) {
  MakeFull(options);
  report += Replaced(options, "\n", "; ") + "silent:";
  for (const Operation& operation : ofFiles) {
    if (Run(operation, Full()) == "false cleared") report += " " + operation.name;
  }
  report += "\n";
}

TEST_F(GuardedOperations, AnswerAndReportAsReviewed) {
  for (const Operation& operation : OfLibraries()) Describe(operation);
  for (const Operation& operation : OfElements()) Describe(operation);
  for (const Operation& operation : ofFiles) Describe(operation);
  for (const char* const options :
       {"", "OPTION STYLE = HDL\n", "OPTION STYLE = hdl\n", "OPTION style = BLACKBOX\n",
        "OPTION STYLE = BlackBox\n", "OPTION STYLE = Mix\nOPTION STYLE = HDL\n",
        "OPTION STYLE = OTHER\n", "OPTION STYLE = ''\n"}) {
    DescribeStyle(options);
  }
  ExpectReviewed("operations.txt", report);
}

}  // namespace
