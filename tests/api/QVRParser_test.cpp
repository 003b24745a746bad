#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

#include "MessageRecorder.h"
#include "RepositoryBuilder.h"
#include "Tarvo_AppException.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_QVRParser.h"

namespace {

using namespace Tarvo;
using testing::ElementsAre;
using testing::IsEmpty;

QVRParser Parse(const std::string& description) {
  RepositoryBuilder directory;
  directory.File("any name", description);
  return QVRParser(Port::FileName((directory / "any name").c_str()));
}

std::string Join(const StringList& names) {
  std::string text;
  for (const StringBase& name : names) text += (text.empty() ? "" : " ") + std::string(name);
  return text;
}

// The queries of one kind of record.
struct Kind {
  const char* noun;
  StringList (QVRParser::*list)() const;
  StringList (QVRParser::*listProperties)(const StringBase&) const;
  StringBase (QVRParser::*get)(const StringBase&, const StringBase&) const;
};
const Kind kParameter{"Parameter", &QVRParser::ListParameters, &QVRParser::ListParameterProperties,
                      &QVRParser::GetParameterProperty};
const Kind kGeneric{"Generic", &QVRParser::ListGenerics, &QVRParser::ListGenericProperties,
                    &QVRParser::GetGenericProperty};
const Kind kBus{"Bus Interface", &QVRParser::ListBusInterfaces,
                &QVRParser::ListBusInterfaceProperties, &QVRParser::GetBusInterfaceProperty};
const Kind kIo{"I/O Interface", &QVRParser::ListIoInterfaces, &QVRParser::ListIoInterfaceProperties,
               &QVRParser::GetIoInterfaceProperty};
const Kind kPort{"Port", &QVRParser::ListPorts, &QVRParser::ListPortProperties,
                 &QVRParser::GetPortProperty};
const Kind kKinds[] = {kParameter, kGeneric, kBus, kIo, kPort};

// All properties of a record with their values, each asked for by its listed name.
std::string Dump(const QVRParser& parser, const Kind& kind, const StringBase& name) {
  std::string text;
  for (const StringBase& property : (parser.*kind.listProperties)(name)) {
    text += " " + std::string(property) + "=" + (parser.*kind.get)(name, property).GetText();
  }
  return text;
}

// A line for each option, record, and interface with its members.
std::set<std::string> Dump(const QVRParser& parser) {
  std::set<std::string> lines;
  for (const StringBase& option : parser.ListOptions()) {
    lines.insert("option " + std::string(option) + "=" + parser.GetOptionValue(option).GetText());
  }
  for (const Kind& kind : kKinds) {
    lines.insert(std::string(kind.noun) + "s: " + Join((parser.*kind.list)()));
    for (const StringBase& name : (parser.*kind.list)()) {
      lines.insert(std::string(kind.noun) + " " + name.GetText() + Dump(parser, kind, name));
    }
  }
  for (const StringBase& bus : parser.ListBusInterfaces()) {
    lines.insert("members of " + std::string(bus) + ": " +
                 Join(parser.ListBusInterfaceParameters(bus)) + ", " +
                 Join(parser.ListBusInterfacePorts(bus)));
  }
  return lines;
}

// What an operation throws: its level and text.
template <class Operation>
std::string Thrown(const Operation& operation) {
  try {
    operation();
    return "nothing";
  } catch (const AppException& exception) {
    return std::to_string(exception.level) + " " + exception.what();
  }
}

const std::string kFree = " ASSIGNMENT=OPTIONAL ISVALID=TRUE PERMIT=ADVANCED_USER";
const std::string kTyped = kFree + " TYPE=HDL";

TEST(QVRParser, ReadsRecords) {
  struct Row {
    const Kind& kind;
    const char* line;
    const char* names;
    std::string properties;  // of the first
  };
  const std::string port = " ASSIGNMENT=OPTIONAL ENABLE=SINGLE";
  const std::string portEnd = " ISVALID=TRUE PERMIT=ADVANCED_USER";
  const Row rows[] = {
      {kParameter, "PARAMETER a = 1, DESC = x", "a",
       " NAME=a VALUE=1 DEFAULT_VALUE=1 DESC=x" + kTyped},
      {kParameter, "PARAMETER a = '', ISVALID = FALSE, TYPE = NON_HDL", "a",
       " NAME=a VALUE= DEFAULT_VALUE= ISVALID=FALSE TYPE=NON_HDL ASSIGNMENT=OPTIONAL "
       "PERMIT=ADVANCED_USER"},
      {kParameter, "PARAMETER a = 1, VALUE = 2, D = 3, D = 4, isvalid = x", "a",
       " NAME=a VALUE=1 DEFAULT_VALUE=1 VALUE=1 D=3 D=3 isvalid=x" + kTyped},
      {kParameter, "PARAMETER a = 1\nPARAMETER A = 2\nPARAMETER a = 3\nparameter b = 1", "a A a",
       " NAME=a VALUE=1 DEFAULT_VALUE=1" + kTyped},
      {kGeneric, "PARAMETER a = 1, TYPE = HDL\nPARAMETER b = 1", "a b",
       " NAME=a VALUE=1 DEFAULT_VALUE=1 TYPE=HDL" + kFree},
      {kGeneric, "PARAMETER a = 1, TYPE = NON_HDL", "", ""},
      {kGeneric, "PARAMETER a = 1, type = Non_Hdl, TYPE = HDL", "", ""},
      {kGeneric, "PARAMETER a = 1, TYPE = HDL, TYPE = NON_HDL", "", ""},
      {kGeneric, "PARAMETER TYPE = NON_HDL", "TYPE",
       " NAME=TYPE VALUE=NON_HDL DEFAULT_VALUE=NON_HDL" + kTyped},
      {kPort, "PORT p = \"\", DIR = O", "p",
       " NAME=p DEFAULT= DIR=O" + port + " INITIALVAL=GND" + portEnd},
      {kPort, "PORT p = q, VEC = [7:0], SIGIS = Interrupt", "p",
       " NAME=p DEFAULT=q VEC=[7:0] SIGIS=Interrupt" + port +
           " ENDIAN=BIG INITIALVAL=GND INTERRUPT_PRIORITY=MEDIUM" + portEnd},
      {kPort, "PORT p = q, VEC = \"\", VEC = [1:0], SIGIS = CLK, SIGIS = INTERRUPT", "p",
       " NAME=p DEFAULT=q VEC= VEC= SIGIS=CLK SIGIS=CLK" + port + " INITIALVAL=GND" + portEnd},
      {kPort, "PORT p = q, vec = [1:0], sigis = INTERRUPT, ENDIAN = LITTLE", "p",
       " NAME=p DEFAULT=q vec=[1:0] sigis=INTERRUPT ENDIAN=LITTLE" + port + " INITIALVAL=GND" +
           portEnd},
      {kBus, "BUS_INTERFACE TYPE = SLAVE, Bus = B0, ISVALID = ''", "B0",
       " TYPE=SLAVE NAME=B0 Bus=B0 ISVALID= SHARES_ADDR=ALL"},
      {kBus, "BUS_INTERFACE BUS = '', BUS = B", "B",
       " NAME= BUS= NAME= BUS= ISVALID=TRUE SHARES_ADDR=ALL"},
      {kIo, "IO_INTERFACE IO_IF = I0", "I0", " NAME=I0 IO_IF=I0 ISVALID=TRUE"},
      {kIo, "IO_INTERFACE IO_IF = ''", "", " NAME= IO_IF= ISVALID=TRUE"},
      {kPort, "port p = 1\nPORT\nPORTS p = 1\nEND x\n# PORT p = 1\n", "", ""}};
  MessageRecorder recorder;
  for (const Row& row : rows) {
    const QVRParser parser = Parse(row.line);
    const StringList names = (parser.*row.kind.list)();
    EXPECT_EQ(Join(names), row.names) << row.line;
    EXPECT_EQ(names.empty() ? "" : Dump(parser, row.kind, names[0]), row.properties) << row.line;
  }
  EXPECT_THAT(recorder.Take(), IsEmpty());
}

TEST(QVRParser, ListsOptionsAndTheirDefaults) {
  EXPECT_EQ(Join(Parse("").ListOptions()), "IMP_NETLIST RUN_TRAMFOLD STYLE USAGE_LEVEL");
  const QVRParser parser = Parse("OPTION STYLE = MIX\nOPTION a:b = , c\nOPTION E = \"\"\nOPTION:x");
  EXPECT_EQ(Join(parser.ListOptions()), "STYLE a:b E IMP_NETLIST RUN_TRAMFOLD USAGE_LEVEL");
  const char* const values[][2] = {{"STYLE", "MIX"},         {"style", "HDL"},
                                   {"a:b", ", c"},           {"E", ""},
                                   {"Imp_Netlist", "FALSE"}, {"USAGE_LEVEL", "ADVANCED_USER"}};
  for (const auto& [option, value] : values) EXPECT_EQ(parser.GetOptionValue(option), value);
  EXPECT_EQ(Thrown([&] { parser.GetOptionValue("e%s"); }), "0 Cannot find option e%s\n");
}

// Those that nothing here reads would change unseen.
TEST(QVRParser, ExportsItsWords) {
  using Q = QVRParser;
  EXPECT_EQ(Join({Q::QVR_FALSE, Q::QVR_PROPERTY_VERSION, Q::QVR_IO_IF_ROLE_NAME,
                  Q::QVR_OPTION_IMP_NETLIST, Q::QVR_OPTION_RUN_TRAMFOLD, Q::QVR_OPTION_STYLE,
                  Q::QVR_OPTION_STYLE_HDL, Q::QVR_OPTION_USAGE_LEVEL}),
            "FALSE VERSION IO_IS IMP_NETLIST RUN_TRAMFOLD STYLE HDL USAGE_LEVEL");
}

// The first bad statement is reported and ends all reading, whatever its kind.
TEST(QVRParser, RefusesBadStatements) {
  const char* const lines[] = {
      "OPTION A",        "PARAMETER a = \"abc",  "BUS_INTERFACE BUS_TYPE = SLAVE",
      "PORT a = 1, b",   "IO_INTERFACE IO_IF =", "BUS_INTERFACE BUS = A, bus = A",
      "PARAMETER a = (", "IO_INTERFACE BUS = A"};
  for (const char* line : lines) {
    MessageRecorder recorder;
    const std::string thrown =
        Thrown([&] { Parse("OPTION A = b\n\n\t" + std::string(line) + " # x\nPORT a"); });
    const std::string keyword = std::string(line).substr(0, std::string(line).find(' '));
    const auto messages = recorder.Take();
    ASSERT_EQ(messages.size(), 1U) << line;
    const std::string name = thrown.substr(14);
    EXPECT_EQ(thrown, "1 Invalid QVR " + name);
    EXPECT_EQ(messages[0], "error s/Tarvo_QVRParser: QVR unparsable " + keyword + ": " +
                               name.substr(0, name.size() - 1) + " line 3, " + line + "\n");
  }
}

TEST(QVRParser, FindsTheDescriptionOfAVersion) {
  RepositoryBuilder repo;
  Port::FileName location;
  location.SetHead(repo.Core("abc_v1_00_a").Qvr("PORT a = 1").Location().c_str());
  Kel_Index index;
  const Kel_Key key(StringBase("abc_v1_00_a"));
  index.AddIP(key, location);
  MessageRecorder recorder(MessageRecorder::MessagesAndTraces);
  EXPECT_EQ(Join(QVRParser(index, key).ListPorts()), "a");
  const std::string file = repo / "ipmods/abc_v1_00_a/data/abc_v2_1_0.qvr\n";
  EXPECT_THAT(recorder.Take(),
              ElementsAre("trace:   Parsing QVR File " + file, "trace: Opening File " + file,
                          "trace: Closed File " + file, "trace:   Parse successful\n"));
  EXPECT_EQ(Thrown([&] { QVRParser(index, Kel_Key(StringBase("xyz"))); }),
            "0 Cannot find IP index entry for xyz\n");
  EXPECT_EQ(Thrown([&] { QVRParser(Port::FileName("/no/file")); }),
            "1 Cannot read file /no/file\n");
}

// Beyond what is listed, only an applicable default answers, by its name in other letter case.
TEST(QVRParser, AnswersForNothingElse) {
  const QVRParser parser = Parse(
      "PARAMETER x = 1, TYPE = NON_HDL, Desc = d\nPARAMETER y = 1\n"
      "BUS_INTERFACE BUS = x, isvalid = n\nIO_INTERFACE IO_IF = x, SHARES_ADDR = z\n"
      "PORT x = '', ENDIAN = e, SIGIS = INTERRUPT\nPORT y = 1, VEC = v, INTERRUPT_PRIORITY = p");
  std::set<StringBase> universe = {"x", ""};
  const auto add = [&](const StringBase& name) {
    StringBase lower = name;
    lower.MakeLower();
    universe.insert({name, lower});
  };
  for (const Kind& kind : kKinds) {
    for (const StringBase& name : (parser.*kind.list)()) {
      for (const StringBase& property : (parser.*kind.listProperties)(name)) add(property);
    }
  }
  const auto unlisted = [&](const Kind& kind, const StringBase& record) {
    const StringList listed = (parser.*kind.listProperties)(record);
    std::string names;
    for (const StringBase& name : universe) {
      if (std::find(listed.begin(), listed.end(), name) != listed.end()) continue;
      const std::string thrown = Thrown([&] { (parser.*kind.get)(record, name); });
      if (thrown == "nothing") {
        names += std::string(name) + " ";
      } else {
        EXPECT_EQ(thrown, std::string("0 Cannot find ") + kind.noun + " " + record.GetText() +
                              " Property " + name.GetText() + "\n");
      }
    }
    return names;
  };
  EXPECT_EQ(unlisted(kParameter, "x"), "assignment isvalid permit type ");
  EXPECT_EQ(unlisted(kGeneric, "y"), "assignment isvalid permit type ");
  EXPECT_EQ(unlisted(kBus, "x"), "shares_addr ");
  EXPECT_EQ(parser.GetBusInterfaceProperty("x", "isvalid"), "n");
  EXPECT_EQ(unlisted(kIo, "x"), "isvalid ");
  EXPECT_EQ(unlisted(kPort, "x"),
            "assignment enable initialval interrupt_priority isvalid permit ");
  EXPECT_EQ(unlisted(kPort, "y"), "assignment enable endian initialval isvalid permit ");
  EXPECT_EQ(parser.GetParameterProperty("x", "type"), "HDL");
  for (const Kind& kind : kKinds) {
    const std::string none = std::string("0 Cannot find ") + kind.noun + " X\n";
    EXPECT_EQ(Thrown([&] { (parser.*kind.get)("X", "NAME"); }), none);
    EXPECT_EQ(Thrown([&] { (parser.*kind.listProperties)("X"); }), none);
  }
}

TEST(QVRParser, FindsTheMembersOfInterfaces) {
  const QVRParser parser = Parse(
      "BUS_INTERFACE BUS = B0\nBUS_INTERFACE BUS = B1\nIO_INTERFACE IO_IF = B0\n"
      "PARAMETER a = 1, BUS = B0:B1:B0, TYPE = NON_HDL\nPARAMETER b = 1, bus = B0\n"
      "PARAMETER c = 1, BUS = b0, BUS = :B1, BUS = B1\nPARAMETER a = 2, BUS = B1\nPARAMETER d = 1, "
      "IO_IF = "
      "B0, TYPE = NON_HDL\n"
      "PORT p = 1, BUS = B2, IO_IF = B0\nPORT q = 1, BUS = \"B0 \"\nPORT r = 1, BUS = B0");
  EXPECT_EQ(Join(parser.ListBusInterfaceParameters("B0")), "a");
  EXPECT_EQ(Join(parser.ListBusInterfacePorts("B0")), "r");
  EXPECT_EQ(Join(parser.ListBusInterfaceParameters("B1")), "a c a");
  EXPECT_EQ(Join(parser.ListBusInterfacePorts("B1")), "");
  EXPECT_EQ(Join(parser.ListIoInterfaceParameters("B0")), "d");
  EXPECT_EQ(Join(parser.ListIoInterfacePorts("B0")), "p");
  const std::string none = "0 Cannot find Bus Interface B2\n";
  EXPECT_EQ(Thrown([&] { parser.ListBusInterfaceParameters("B2"); }), none);
  EXPECT_EQ(Thrown([&] { parser.ListBusInterfacePorts("B2"); }), none);
  const std::string noneIo = "0 Cannot find I/O Interface B1\n";
  EXPECT_EQ(Thrown([&] { parser.ListIoInterfaceParameters("B1"); }), noneIo);
  EXPECT_EQ(Thrown([&] { parser.ListIoInterfacePorts("B1"); }), noneIo);
}

// A set property changes the lines that it must, and no other.
TEST(QVRParser, SetsPropertiesOfOneKindAlone) {
  using Lines = std::vector<std::string>;
  struct Row {
    void (QVRParser::*set)(const StringBase&, const StringBase&, const StringBase&);
    const char *name, *property, *value;
    Lines gone, come;
  };
  const std::string value = " NAME=a VALUE=1 DEFAULT_VALUE=1";
  const std::string a = "Parameter a" + value, generic = "Generic a" + value;
  const std::string n = "Parameter n NAME=n VALUE= DEFAULT_VALUE= VALUE= TYPE=",
                    typed = "NON_HDL" + kFree;
  const auto parameters = &QVRParser::SetParameterProperty;
  const auto generics = &QVRParser::SetGenericProperty;
  const Row rows[] = {
      {parameters,
       "a",
       "VALUE",
       "5",
       {a + kTyped},
       {"Parameter a NAME=a VALUE=5 DEFAULT_VALUE=1" + kTyped}},
      {generics,
       "a",
       "VALUE",
       "",
       {generic + kTyped},
       {"Generic a NAME=a VALUE= DEFAULT_VALUE=1" + kTyped}},
      {parameters,
       "n",
       "VALUE",
       "5",
       {n + typed},
       {"Parameter n NAME=n VALUE=5 DEFAULT_VALUE= VALUE=5 TYPE=" + typed}},
      {parameters, "a", "value", "1", {a + kTyped}, {a + " value=1" + kTyped}},
      {parameters, "a", "NEW", "1", {a + kTyped}, {a + " NEW=1" + kTyped}},
      {parameters, "a", "TYPE", "NON_HDL", {a + kTyped}, {a + " TYPE=NON_HDL" + kFree}},
      {parameters, "n", "TYPE", "HDL", {n + typed}, {n + "HDL" + kFree}},
      {parameters,
       "a",
       "BUS",
       "B0",
       {"members of B0: , p", a + kTyped},
       {"members of B0: a, p", a + " BUS=B0" + kTyped}},
      {generics, "a", "BUS", "B0", {generic + kTyped}, {generic + " BUS=B0" + kTyped}}};
  for (const Row& row : rows) {
    QVRParser parser = Parse(
        "OPTION a = 1\nBUS_INTERFACE BUS = B0\nPARAMETER a = 1\nPARAMETER n = '', VALUE = 3, TYPE "
        "= NON_HDL\n"
        "PARAMETER a = 3\nPORT p = 1, BUS = B0");
    const std::set<std::string> before = Dump(parser);
    (parser.*row.set)(row.name, row.property, row.value);
    const std::set<std::string> after = Dump(parser);
    Lines gone, come;
    std::set_difference(before.begin(), before.end(), after.begin(), after.end(),
                        std::back_inserter(gone));
    std::set_difference(after.begin(), after.end(), before.begin(), before.end(),
                        std::back_inserter(come));
    EXPECT_THAT(gone, testing::UnorderedElementsAreArray(row.gone)) << row.property;
    EXPECT_THAT(come, testing::UnorderedElementsAreArray(row.come)) << row.property;
  }
  QVRParser parser = Parse("PARAMETER n = 1, TYPE = NON_HDL");
  EXPECT_EQ(Thrown([&] { parser.SetGenericProperty("n", "VALUE", "2"); }),
            "0 Cannot find Generic n\n");
  EXPECT_EQ(Thrown([&] { parser.SetParameterProperty("N", "VALUE", "2"); }),
            "0 Cannot find Parameter N\n");
}

}  // namespace
