#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "RepositoryBuilder.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Tarvo;
using testing::ElementsAre;
using testing::IsEmpty;

// The paths that an operation may be asked for, and what it puts out.
struct Output {
  StringBase source;
  StringBase netlist;
  StringBase value = "old";
  StringList list = {"old"};

  // What an operation left behind, the one output that it has no use for taken out.
  std::string Text() const {
    std::string text = value == "old" ? "" : value.GetText();
    for (const StringBase& name : list) {
      if (name != "old") text += "<" + std::string(name) + ">";
    }
    return text;
  }
  bool IsOld() const { return value == "old" && list == StringList{"old"}; }
};

// Names that don't fit into a string object, so that every operation allocates.
const char kDescription[] =
    "OPTION STYLE = MIX\nOPTION AN_OPTION_WITH_A_LONG_NAME = a value of some length\n"
    "BUS_INTERFACE BUS = A_BUS_WITH_A_LONG_NAME\nIO_INTERFACE IO_IF = AN_IO_WITH_A_LONG_NAME\n"
    "PARAMETER A_PARAMETER_WITH_A_LONG_NAME = the_value_of_a_parameter, "
    "BUS = A_BUS_WITH_A_LONG_NAME, IO_IF = AN_IO_WITH_A_LONG_NAME\n"
    "PORT A_PORT_WITH_A_LONG_NAME = the_default_of_a_port, BUS = A_BUS_WITH_A_LONG_NAME, "
    "IO_IF = AN_IO_WITH_A_LONG_NAME\n";
const StringBase kOption = "AN_OPTION_WITH_A_LONG_NAME";
const StringBase kParameter = "A_PARAMETER_WITH_A_LONG_NAME";
const StringBase kBus = "A_BUS_WITH_A_LONG_NAME";
const StringBase kIo = "AN_IO_WITH_A_LONG_NAME";
const StringBase kPort = "A_PORT_WITH_A_LONG_NAME";
const StringBase kLong = "a text that is too long for a string object";
const StringBase kLibrary = "an_include_library_with_a_long_name";
const char kAnalyseOrder[] =
    "lib full_v1_00_a a_source_with_a_long_name.vhd\n"
    "vlgincdir an_include_library_with_a_long_name data";
const char kNetlists[] = "FILES\na_netlist_with_a_long_name.edn";

// One guarded operation: what it answers, how it reports a failure, how severe that is for an
// exception with a text, and what that text is for a core without any statement or further file.
// "@" stands for the instance's key and "$" for its location. Last, how the operation reports a
// failure of the one that it asks first.
struct Row {
  const char* operation;
  std::string answer;
  std::string failure;
  const char* severity;
  const char* reason;
  bool (*run)(KelIP& ip, Output& output);
  std::string inner = failure;
};

#define GET(operation, name, property) \
  [](KelIP& ip, Output& output) { return ip.operation(name, property, output.value); }
#define LIST(operation, ...) \
  [](KelIP& ip, Output& output) { return ip.operation(__VA_ARGS__ output.list); }

const std::string kSource = "$/hdl/vhdl/a_source_with_a_long_name.vhd";
const std::string kNetlist = "$/netlist/a_netlist_with_a_long_name.edn";
const char kNoOrder[] = "Invalid LDX $/data/none_v2_1_0.ldx\n";
const char kNoTable[] = "Cannot read file $/data/none_v2_1_0.tew\n";

std::string In(std::string text, const KelIP& ip) {
  for (std::size_t at; (at = text.find('@')) != std::string::npos;)
    text.replace(at, 1, ip.GetKey());
  for (std::size_t at; (at = text.find('$')) != std::string::npos;)
    text.replace(at, 1, ip.GetLocation());
  return text;
}
StringBase Path(const std::string& text, const KelIP& ip) {
  return StringBase(std::string_view(In(text, ip)));
}

const std::string kP = kParameter.GetText(), kB = kBus.GetText(), kI = kIo.GetText(),
                  kO = kPort.GetText();
const std::string kDefaults = "<ASSIGNMENT><ISVALID><PERMIT><TYPE>";
const std::string kValues = "<NAME><VALUE><DEFAULT_VALUE><BUS><IO_IF>" + kDefaults;

const Row kRows[] = {
    {"GetIPProperty", "a value of some length",
     "access property " + std::string(kOption) + " for IP @", "error",
     "Cannot find option AN_OPTION_WITH_A_LONG_NAME\n",
     [](KelIP& ip, Output& output) { return ip.GetIPProperty(kOption, output.value); }},
    {"ListIPProperties",
     "<NAME><VERSION><STYLE><AN_OPTION_WITH_A_LONG_NAME><IMP_NETLIST><RUN_TRAMFOLD><USAGE_LEVEL>",
     "list properties for IP @", "error", nullptr, LIST(ListIPProperties)},
    {"GetParameterProperty", "the_value_of_a_parameter",
     "get parameter " + kP + " property VALUE for IP @", "warning",
     "Cannot find Parameter A_PARAMETER_WITH_A_LONG_NAME\n",
     GET(GetParameterProperty, kParameter, "VALUE")},
    {"SetParameterProperty", "",
     "set IP @ parameter " + kP + " property VALUE to " + std::string(kLong), "warning",
     "Cannot find Parameter A_PARAMETER_WITH_A_LONG_NAME\n",
     [](KelIP& ip, Output&) { return ip.SetParameterProperty(kParameter, "VALUE", kLong); }},
    {"ListParameters", "<" + kP + ">", "list parameters for IP @", "error", nullptr,
     LIST(ListParameters)},
    {"ListParameterProperties", kValues, "list parameter properties for IP @", "error",
     "Cannot find Parameter A_PARAMETER_WITH_A_LONG_NAME\n",
     LIST(ListParameterProperties, kParameter, )},
    {"GetGenericProperty", "the_value_of_a_parameter",
     "get generic " + kP + " property VALUE for IP @", "warning",
     "Cannot find Generic A_PARAMETER_WITH_A_LONG_NAME\n",
     GET(GetGenericProperty, kParameter, "VALUE")},
    {"ListGenerics", "<" + kP + ">", "list generics for IP @", "error", nullptr,
     LIST(ListGenerics)},
    {"ListGenericProperties", kValues, "list generic properties for IP @", "error",
     "Cannot find Generic A_PARAMETER_WITH_A_LONG_NAME\n",
     LIST(ListGenericProperties, kParameter, )},
    {"GetPortProperty", "the_default_of_a_port", "get port " + kO + " property DEFAULT for IP @",
     "warning", "Cannot find Port A_PORT_WITH_A_LONG_NAME\n",
     GET(GetPortProperty, kPort, "DEFAULT")},
    {"ListPorts", "<" + kO + ">", "list ports for IP @", "error", nullptr, LIST(ListPorts)},
    {"ListPortProperties",
     "<NAME><DEFAULT><BUS><IO_IF><ASSIGNMENT><ENABLE><INITIALVAL><ISVALID><PERMIT>",
     "list port " + kO + " properties for IP @", "error",
     "Cannot find Port A_PORT_WITH_A_LONG_NAME\n", LIST(ListPortProperties, kPort, )},
    {"GetBusInterfaceProperty", kB, "get bus interface " + kB + " property NAME for IP @",
     "warning", "Cannot find Bus Interface A_BUS_WITH_A_LONG_NAME\n",
     GET(GetBusInterfaceProperty, kBus, "NAME")},
    {"ListBusInterfaces", "<" + kB + ">", "list bus interfaces for IP @", "error", nullptr,
     LIST(ListBusInterfaces)},
    {"ListBusInterfaceProperties", "<NAME><BUS><ISVALID><SHARES_ADDR>",
     "list bus interface " + kB + " properties for IP @", "error",
     "Cannot find Bus Interface A_BUS_WITH_A_LONG_NAME\n",
     LIST(ListBusInterfaceProperties, kBus, )},
    {"ListBusInterfaceParameters", "<" + kP + ">",
     "list bus interface " + kB + " parameters for IP @", "error",
     "Cannot find Bus Interface A_BUS_WITH_A_LONG_NAME\n",
     LIST(ListBusInterfaceParameters, kBus, )},
    {"ListBusInterfacePorts", "<" + kO + ">", "list bus interface " + kB + " ports for IP @",
     "error", "Cannot find Bus Interface A_BUS_WITH_A_LONG_NAME\n",
     LIST(ListBusInterfacePorts, kBus, )},
    {"GetIOInterfaceProperty", kI, "get I/O interface " + kI + " property NAME for IP @", "warning",
     "Cannot find I/O Interface AN_IO_WITH_A_LONG_NAME\n",
     GET(GetIOInterfaceProperty, kIo, "NAME")},
    {"ListIOInterfaces", "<" + kI + ">", "list I/O interfaces for IP @", "error", nullptr,
     LIST(ListIOInterfaces)},
    {"ListIOInterfaceProperties", "<NAME><IO_IF><ISVALID>",
     "list I/O interface " + kI + " properties for IP @", "error",
     "Cannot find I/O Interface AN_IO_WITH_A_LONG_NAME\n", LIST(ListIOInterfaceProperties, kIo, )},
    {"ListIOInterfaceParameters", "<" + kP + ">",
     "list I/O interface " + kI + " parameters for IP @", "error",
     "Cannot find I/O Interface AN_IO_WITH_A_LONG_NAME\n", LIST(ListIOInterfaceParameters, kIo, )},
    {"ListIOInterfacePorts", "<" + kO + ">", "list I/O interface " + kI + " ports for IP @",
     "error", "Cannot find I/O Interface AN_IO_WITH_A_LONG_NAME\n",
     LIST(ListIOInterfacePorts, kIo, )},
    {"ListSynthesisSources", "<" + kSource + ">", "list synthesis analyse order for IP @", "error",
     kNoOrder, LIST(ListSynthesisSources)},
    {"ListSimulationSources", "<" + kSource + ">", "list simulation analyse order for IP @",
     "error", kNoOrder, LIST(ListSimulationSources)},
    {"ListSynthesisLibraries", "<$>", "list synthesis libraries for IP @", "error", kNoOrder,
     LIST(ListSynthesisLibraries)},
    {"ListSimulationLibraries", "<$>", "list simulation libraries for IP @", "error", kNoOrder,
     LIST(ListSimulationLibraries)},
    {"ListVerilogIncludeLibraries", "<" + std::string(kLibrary) + ">",
     "list Verilog include libraries for IP @", "error", kNoOrder,
     LIST(ListVerilogIncludeLibraries)},
    {"GetVerilogIncludeLocation", "$/data",
     "locate Verilog include library " + std::string(kLibrary) + " for IP @", "error", kNoOrder,
     [](KelIP& ip, Output& output) {
       return ip.GetVerilogIncludeLocation(kLibrary, output.value);
     }},
    {"GetSourceProperty", "$/hdl/vhdl",
     "get property FILENAME_HEAD for source " + kSource + " in IP @", "error", kNoOrder,
     [](KelIP& ip, Output& output) {
       return ip.GetSourceProperty(output.source, "FILENAME_HEAD", output.value);
     }},
    {"ListSourceProperties", "<LIBRARY><LANGUAGE><FILENAME_HEAD><FILENAME_TAIL>",
     "list source " + kSource + " properties for IP @", "error", kNoOrder,
     LIST(ListSourceProperties, output.source, ),
     "get property LIBRARY for source " + kSource + " in IP @"},
    {"ListNetlists", "<" + kNetlist + ">", "list netlists for IP @", "error", kNoTable,
     LIST(ListNetlists)},
    {"ListNetlistLibraries", "<$>", "list netlist libraries for IP @", "error", kNoTable,
     LIST(ListNetlistLibraries)},
    {"GetNetlistProperty", "@", "get netlist " + kNetlist + " property LIBRARY for IP @", "error",
     kNoTable, GET(GetNetlistProperty, output.netlist, "LIBRARY")},
    {"ListNetlistProperties", "<LIBRARY>", "list netlist " + kNetlist + " properties for IP @",
     "error", kNoTable, LIST(ListNetlistProperties, output.netlist, ),
     "get netlist " + kNetlist + " property LIBRARY for IP @"}};

#undef GET
#undef LIST

class Instance : public testing::Test {
 protected:
  std::unique_ptr<KelIP> Open(const std::string& key) {
    return std::unique_ptr<KelIP>(library.CreateIP(key.c_str()));
  }
  void Walk() { ASSERT_TRUE(library.SetRepositoryPath(repo.Path().c_str())); }
  static Output Ready(const KelIP& ip) { return {Path(kSource, ip), Path(kNetlist, ip)}; }
  // The message of a failure up to its tail.
  static std::string Failure(const std::string& severity, const std::string& text,
                             const KelIP& ip) {
    return severity + " s/Tarvo_KelIP: Unable to " + In(text, ip);
  }

  RepositoryBuilder repo;
  MessageRecorder recorder;
  KelLibrary library;
};

TEST_F(Instance, AnswersAndReportsByItsRows) {
  repo.Core("full_v1_00_a").Qvr(kDescription).Ldx(kAnalyseOrder).Tew(kNetlists);
  repo.Core("none_v1_00_a").Qvr("OPTION STYLE = MIX");
  Walk();
  const auto full = Open("full"), none = Open("none");
  for (const Row& row : kRows) {
    SCOPED_TRACE(row.operation);
    Output answer = Ready(*full);
    EXPECT_TRUE(row.run(*full, answer));
    EXPECT_EQ(answer.Text(), In(row.answer, *full));
    EXPECT_THAT(recorder.Take(), IsEmpty());
    if (!row.reason) continue;
    Output output = Ready(*none);
    EXPECT_FALSE(row.run(*none, output));
    EXPECT_EQ(output.Text(), "");
    EXPECT_EQ(output.IsOld(), row.answer.empty());
    EXPECT_THAT(recorder.Take(), ElementsAre(Failure(row.severity, row.failure, *none) + "\n" +
                                             In(row.reason, *none) + "\n"));
  }
}

// Each operation with its n-th allocation failing, for every n until it succeeds. The parsers are
// there before.
TEST_F(Instance, LetsNothingEscape) {
  repo.Core("full_v1_00_a").Qvr(kDescription).Ldx(kAnalyseOrder).Tew(kNetlists);
  Walk();
  const struct {
    AllocationFault::Kind kind;
    const char* severity;  // instead of the row's
    const char* tail;
  } faults[] = {{AllocationFault::BadAlloc, nullptr, "\nstd::bad_alloc\n"},
                {AllocationFault::FatalException, nullptr, "\nout of order\n\n"},
                {AllocationFault::SomethingElse, "error", ", unknown exception\n"}};
  for (const Row& row : kRows) {
    SCOPED_TRACE(row.operation);
    for (const auto& [kind, severity, usualTail] : faults) {
      const auto ip = Open("full");
      StringList list;
      ASSERT_TRUE(ip->ListSynthesisSources(list) && ip->ListNetlists(list));
      const bool isEmpty = severity && row.operation == std::string("GetIPProperty");
      const std::string tail = isEmpty ? "\n\n" : usualTail;
      const auto message = [&, sure = severity ? severity : row.severity](const std::string& text) {
        return Failure(sure, text, *ip) + tail;
      };
      for (int count = 0;; ++count) {
        Output output = Ready(*ip);
        bool done = false;
        {
          const AllocationFault fault(count, kind);
          done = row.run(*ip, output);
        }
        EXPECT_EQ(done, !AllocationFault::Fired());
        if (!AllocationFault::Fired()) {
          EXPECT_EQ(output.Text(), In(row.answer, *ip));
          EXPECT_GT(count, 0);
          break;
        }
        EXPECT_EQ(output.Text(), "");
        EXPECT_EQ(output.IsOld(), row.answer.empty());
        EXPECT_THAT(recorder.Take(),
                    ElementsAre(testing::AnyOf(message(row.failure), message(row.inner))));
      }
    }
  }
}

TEST_F(Instance, IsMadeForTheVersionThatAKeyStandsFor) {
  repo.Core("abc_v1_00_a").Qvr("PORT a = 1");
  repo.Core("abc_V02_00_B").Qvr("OPTION EMPTY = ''\nOPTION NAME = other");
  Walk();
  auto old = Open("abc_v1_00_a"), ip = Open("abc");
  EXPECT_EQ(std::string(ip->GetKey()) + " " + ip->GetName().GetText() + " " +
                ip->GetVersion().GetText() + " " + ip->GetLocation().GetText(),
            "abc_v02_00_b abc 2.00.b " + (repo / "ipmods/abc_V02_00_B"));
  StringBase value;
  EXPECT_TRUE(ip->GetIPProperty("NAME", value));
  EXPECT_EQ(value, "abc");
  EXPECT_TRUE(ip->GetIPProperty("VERSION", value));
  EXPECT_EQ(value, "2.00.b");
  StringList names;
  EXPECT_TRUE(ip->ListIPProperties(names));
  EXPECT_THAT(names, ElementsAre("NAME", "VERSION", "EMPTY", "NAME", "IMP_NETLIST", "RUN_TRAMFOLD",
                                 "STYLE", "USAGE_LEVEL"));
  EXPECT_FALSE(ip->GetIPProperty("EMPTY", value));
  EXPECT_EQ(value, "");
  EXPECT_THAT(recorder.Take(), IsEmpty());
  EXPECT_FALSE(ip->GetIPProperty("name", value));
  EXPECT_THAT(recorder.Take(), ElementsAre("error s/Tarvo_KelIP: Unable to access property name "
                                           "for IP abc_v02_00_b\nCannot find option name\n\n"));

  // A refresh that finds another newest version changes no instance.
  repo.Core("abc_v3_00_a").Qvr("");
  std::filesystem::remove_all(repo / "ipmods/abc_v1_00_a");
  EXPECT_TRUE(library.RefreshLibrary());
  EXPECT_EQ(ip->GetKey(), "abc_v02_00_b");
  EXPECT_EQ(old->GetLocation(), (repo / "ipmods/abc_v1_00_a").c_str());
  StringList list;
  EXPECT_TRUE(old->ListPorts(list));
  EXPECT_THAT(list, ElementsAre("a"));
  EXPECT_EQ(Open("abc")->GetKey(), "abc_v3_00_a");
}

TEST_F(Instance, KeepsArgumentsThatLieInTheOutput) {
  repo.Core("abc_v1_00_a").Qvr("PORT p = 1, DIR = I");
  Walk();
  const auto ip = Open("abc");
  StringBase value = "p";
  EXPECT_TRUE(ip->GetPortProperty(value, "DIR", value));
  EXPECT_EQ(value, "I");
  StringList list = {"p", "q"};
  EXPECT_TRUE(ip->ListPortProperties(list[0], list));
  list = {"p", "q"};
  EXPECT_FALSE(ip->ListPortProperties(list[1], list));
  EXPECT_THAT(recorder.Take(), ElementsAre(testing::HasSubstr("list port q properties")));
}

TEST_F(Instance, IsNotMadeWithoutADescription) {
  repo.Core("none_v1_00_a");
  repo.Core("bad_v1_00_a").Qvr("PORT a");
  repo.Core("abc_v1_00_a").Qvr(kDescription);
  Walk();
  const std::string error = "error s/Tarvo_KelLibrary: Unable to create IP ";
  EXPECT_EQ(library.CreateIP("No_V1_00_A"), nullptr);
  EXPECT_EQ(library.CreateIP("none"), nullptr);
  EXPECT_EQ(library.CreateIP("bad"), nullptr);
  const std::string bad = repo / "ipmods/bad_v1_00_a/data/bad_v2_1_0.qvr";
  EXPECT_THAT(
      recorder.Take(),
      ElementsAre(error + "No_V1_00_A\nCannot find IP index entry for No_v1_00_a\n\n",
                  error + "none\nCannot read file " +
                      repo / "ipmods/none_v1_00_a/data/none_v2_1_0.qvr" + "\n\n",
                  "error s/Tarvo_QVRParser: QVR unparsable PORT: " + bad + " line 1, PORT a\n",
                  error + "bad\nInvalid QVR " + bad + "\n\n"));
  const struct {
    AllocationFault::Kind kind;
    std::string message;
  } faults[] = {{AllocationFault::BadAlloc, error + "abc\nstd::bad_alloc\n"},
                {AllocationFault::SomethingElse, error + "abc, unknown exception\n"},
                {AllocationFault::FatalException,
                 "fatal s/Tarvo_KelLibrary: Unable to create IP abc\nout of order\n\n"}};
  const StringBase key = "abc";
  for (const auto& [kind, message] : faults) {
    for (int count = 0;; ++count) {
      std::unique_ptr<KelIP> ip;
      {
        const AllocationFault fault(count, kind);
        ip.reset(library.CreateIP(key));
      }
      EXPECT_EQ(ip == nullptr, AllocationFault::Fired());
      if (!AllocationFault::Fired()) break;
      const auto messages = recorder.Take();
      ASSERT_FALSE(messages.empty());
      EXPECT_THAT(messages.back(), testing::StartsWith(message)) << count;
    }
  }
}

TEST_F(Instance, TracesItsMaking) {
  repo.Core("abc_v1_00_a").Qvr("");
  const auto relative = std::filesystem::relative(repo.Path());
  ASSERT_TRUE(library.SetRepositoryPath(relative.c_str()));
  const std::string where = std::filesystem::current_path() / relative / "ipmods/abc_v1_00_a";
  MessageRecorder traces(MessageRecorder::MessagesAndTraces);
  Open("abc");
  const auto entries = traces.Take();
  EXPECT_EQ(entries.front(),
            "trace: Constructing IP instance abc v1.00.a from path " + where + "\n");
  EXPECT_EQ(Open("abc")->GetLocation(), where.c_str());
  EXPECT_EQ(entries.back(), "trace: Finished constructing IP instance abc v1.00.a\n");
}

}  // namespace
