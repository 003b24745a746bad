// What a description answers beyond the cases of Readers_test.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <string>

#include "IndexedRepository.h"
#include "Outcome.h"
#include "Questions.h"
#include "RepositoryBuilder.h"
#include "Tarvo_QVRParser.h"

namespace {

using namespace Questions;

// Those that nothing here reads would change unseen.
TEST(QVRParser, ExportsItsWords) {
  using Q = QVRParser;
  EXPECT_EQ(Join({Q::QVR_FALSE, Q::QVR_PROPERTY_VERSION, Q::QVR_IO_IF_ROLE_NAME,
                  Q::QVR_OPTION_IMP_NETLIST, Q::QVR_OPTION_RUN_TRAMFOLD, Q::QVR_OPTION_STYLE,
                  Q::QVR_OPTION_STYLE_HDL, Q::QVR_OPTION_USAGE_LEVEL}),
            "FALSE, VERSION, IO_IS, IMP_NETLIST, RUN_TRAMFOLD, STYLE, HDL, USAGE_LEVEL");
}

// The properties of a record that are not listed, among those of all others and their names in
// small letters, but have a value. All else must be refused.
std::string Unlisted(const QVRParser& parser, const Kind& kind, const StringBase& record,
                     const std::set<StringBase>& properties) {
  const StringList listed = (parser.*kind.parserListProperties)(record);
  std::string text = std::string(kind.noun) + " " + record.GetText() + ":";
  for (const StringBase& property : properties) {
    if (std::find(listed.begin(), listed.end(), property) != listed.end()) continue;
    const std::string outcome = Outcome([&] { return (parser.*kind.parserGet)(record, property); });
    if (outcome != std::string("not found: Cannot find ") + kind.noun + " " + record.GetText() +
                       " Property " + property.GetText() + "\n") {
      text += std::string(" ") + property.GetText() + "=" + outcome;
    }
  }
  return text + "\n";
}

// Beyond what is listed, only an applicable default answers, by its name in other letter case.
TEST(QVRParser, AnswersForNothingElse) {
  RepositoryBuilder directory;
  directory.File("any name",
                 "PARAMETER x = 1, TYPE = NON_HDL, Desc = d\nPARAMETER y = 1\n"
                 "BUS_INTERFACE BUS = x, isvalid = n\nIO_INTERFACE IO_IF = x, SHARES_ADDR = z\n"
                 "PORT x = '', ENDIAN = e, SIGIS = INTERRUPT\n"
                 "PORT y = 1, VEC = v, INTERRUPT_PRIORITY = p\nOPTION a = 1");
  const QVRParser parser(Port::FileName((directory / "any name").c_str()));
  std::set<StringBase> properties = {"x", ""};
  std::string unlisted;
  const auto forEach = [&](const auto& work) {
    for (const Kind& kind : kKinds) {
      for (const StringBase& name : (parser.*kind.parserList)()) work(kind, name);
    }
  };
  forEach([&](const Kind& kind, const StringBase& name) {
    for (StringBase property : (parser.*kind.parserListProperties)(name)) {
      properties.insert(property);
      property.MakeLower();
      properties.insert(property);
    }
  });
  forEach([&](const Kind& kind, const StringBase& name) {
    unlisted += Unlisted(parser, kind, name, properties);
  });
  EXPECT_EQ(unlisted,
            "Parameter x: assignment=OPTIONAL isvalid=TRUE permit=ADVANCED_USER type=HDL\n"
            "Parameter y: assignment=OPTIONAL isvalid=TRUE permit=ADVANCED_USER type=HDL\n"
            "Generic y: assignment=OPTIONAL isvalid=TRUE permit=ADVANCED_USER type=HDL\n"
            "Port x: assignment=OPTIONAL enable=SINGLE initialval=GND interrupt_priority=MEDIUM "
            "isvalid=TRUE permit=ADVANCED_USER\n"
            "Port y: assignment=OPTIONAL enable=SINGLE endian=BIG initialval=GND isvalid=TRUE "
            "permit=ADVANCED_USER\n"
            "Bus Interface x: shares_addr=ALL\n"
            "I/O Interface x: isvalid=TRUE\n");
  for (const Kind& kind : kKinds) {
    const std::string none = std::string("not found: Cannot find ") + kind.noun + " X\n";
    EXPECT_EQ(Outcome([&] { return (parser.*kind.parserGet)("X", "NAME"); }), none);
    EXPECT_EQ(Outcome([&] { (parser.*kind.parserListProperties)("X"); }), none);
  }
  for (const Members& members : kMembers) {
    EXPECT_THAT(Outcome([&] { (parser.*members.parserList)("X"); }),
                testing::MatchesRegex("not found: Cannot find (Bus|I/O) Interface X\n"));
  }
  EXPECT_EQ(parser.GetOptionValue("Imp_Netlist"), "FALSE");
  EXPECT_EQ(Outcome([&] { return parser.GetOptionValue("A%s"); }),
            "not found: Cannot find option A%s\n");
}

}  // namespace
