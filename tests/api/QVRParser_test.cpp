// What a description answers beyond the cases of Readers_test.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <new>
#include <random>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "AllocationFault.h"
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

// What a description states, answered by looking from the front: options, and records by the
// numbers of kKinds.
struct Plain {
  using Pairs = std::vector<std::pair<std::string, std::string>>;
  using Records = std::vector<std::pair<std::string, Pairs>>;

  template <class Pair>
  static auto& First(std::vector<Pair>& pairs, const std::string& name) {
    return std::find_if(pairs.begin(), pairs.end(), [&](auto& pair) { return pair.first == name; })
        ->second;
  }
  static bool Names(const Pairs& properties, const std::string& key, const std::string& name) {
    return std::any_of(properties.begin(), properties.end(), [&](const auto& property) {
      return property.first == key &&
             (":" + property.second + ":").find(":" + name + ":") != std::string::npos;
    });
  }

  static std::string Line(const std::string& name, Pairs& pairs) {
    std::string text = "\n" + name;
    for (auto& [key, value] : pairs) text += " " + key + "=" + First(pairs, key);
    return text;
  }

  std::string Answers() {
    std::string text = Line("", options);
    for (Records& records : kinds) {
      for (auto& [name, own] : records) text += Line(name, First(records, name));
    }
    for (std::size_t i = 0; i < std::size(kMembers); ++i) {
      for (auto& [interface, unused] : kinds[3 + i / 2]) {
        text += "\n" + interface;
        for (auto& [name, properties] : kinds[i % 2 * 2]) {
          if (Names(properties, i < 2 ? "BUS" : "IO_IF", interface)) text += " " + name;
        }
      }
    }
    return text;
  }

  void Set(std::size_t kind, const std::string& name, const std::string& key,
           const std::string& value) {
    Pairs& properties = First(kinds[kind], name);
    properties.emplace_back(key, value);  // found if there is no other
    First(properties, key) = value;
    if (&First(properties, key) != &properties.back().second) properties.pop_back();
  }

  Pairs options;
  Records kinds[std::size(kKinds)];
};

std::string Answers(const QVRParser& parser) {
  std::string text = "\n";
  for (const StringBase& option : parser.ListOptions()) {
    text += std::string(" ") + option.GetText() + "=" + parser.GetOptionValue(option).GetText();
  }
  for (const Kind& kind : kKinds) {
    for (const StringBase& name : (parser.*kind.parserList)()) {
      text += std::string("\n") + name.GetText();
      for (const StringBase& key : (parser.*kind.parserListProperties)(name)) {
        text += std::string(" ") + key.GetText() + "=";
        text += (parser.*kind.parserGet)(name, key).GetText();
      }
    }
  }
  for (const Members& members : kMembers) {
    for (const StringBase& interface : (parser.*members.parserInterfaces)()) {
      text += std::string("\n") + interface.GetText();
      for (const StringBase& name : (parser.*members.parserList)(interface)) {
        text += std::string(" ") + name.GetText();
      }
    }
  }
  return text;
}

// Random statements, many of them namesakes, some with many properties, in which nothing is left to
// defaults.
class Drawn {
 public:
  Drawn() {
    for (int i = 0; i < 20; ++i) AddOption(Name());
    for (const char* const known : {"IMP_NETLIST", "RUN_TRAMFOLD", "STYLE", "USAGE_LEVEL"}) {
      AddOption(known);
    }
    for (int i = 0; i < 100; ++i) Add(std::vector<std::size_t>{0, 2, 3, 4}[Below(4)]);
  }

  std::size_t Below(std::size_t count) { return random() % count; }
  std::string Name() { return "a_name_of_some_length_" + std::to_string(Below(15)); }
  std::string Key() {
    const std::size_t number = Below(20);
    return number < 5 ? "BUS" : number < 8 ? "IO_IF" : "KEY_" + std::to_string(number);
  }
  std::string Value() {
    std::string value = Name();
    for (std::size_t i = Below(4); i > 0; --i) value += (i > 1 ? ":" : "::") + Name();
    return value;
  }

  std::string text;
  Plain plain;

 private:
  void AddOption(const std::string& name) {
    plain.options.emplace_back(name, Value());
    text += "OPTION " + name + " = " + plain.options.back().second + "\n";
  }
  void Add(std::size_t kind) {
    const bool isInterface = kind > 2;
    const std::string name = Name(), value = isInterface ? name : Value();
    const std::string key = kind == 3 ? "BUS" : "IO_IF";
    Plain::Pairs properties = {{"NAME", name}};
    if (kind == 0)
      properties.insert(properties.end(), {{"VALUE", value}, {"DEFAULT_VALUE", value}});
    if (kind != 0) properties.emplace_back(isInterface ? key : "DEFAULT", value);
    const std::size_t fixed = properties.size();
    for (std::size_t i = Below(4) == 0 ? 20 : Below(4); i > 0; --i) {
      properties.emplace_back(isInterface ? "KEY_" + std::to_string(i) : Key(), Value());
    }
    for (const char* const known :
         {"ASSIGNMENT", "ENABLE", "INITIALVAL", "ISVALID", "PERMIT", "SHARES_ADDR", "TYPE"}) {
      properties.emplace_back(known, "stated");
    }
    const char* const keywords[] = {"PARAMETER ", "", "PORT ", "BUS_INTERFACE ", "IO_INTERFACE "};
    text += keywords[kind] + (isInterface ? key : name) + " = " + value;
    for (std::size_t i = fixed; i < properties.size(); ++i) {
      text += ", " + properties[i].first + " = " + properties[i].second;
    }
    text += "\n";
    plain.kinds[kind].emplace_back(name, properties);
    if (kind == 0) plain.kinds[1].emplace_back(name, properties);
  }

  std::mt19937 random;
};

// Whatever is set, in copies too, and wherever memory runs out.
TEST(QVRParser, AnswersAsIfItLookedFromTheFront) {
  Drawn drawn;
  RepositoryBuilder directory;
  directory.File("drawn", drawn.text);
  std::vector<std::pair<QVRParser, Plain>> pairs = {
      {QVRParser(Port::FileName((directory / "drawn").c_str())), drawn.plain}};
  for (int step = 0; step < 60; ++step) {
    if (step % 20 == 10) pairs.push_back(pairs[drawn.Below(pairs.size())]);
    auto& [parser, plain] = pairs[drawn.Below(pairs.size())];
    const std::size_t kind = drawn.Below(4) == 0 ? 1 : 0;
    const std::string name = plain.kinds[kind][drawn.Below(plain.kinds[kind].size())].first;
    const StringBase record = name.c_str(), key = drawn.Key().c_str(),
                     value = drawn.Value().c_str();
    const auto set = kind == 0 ? &QVRParser::SetParameterProperty : &QVRParser::SetGenericProperty;
    bool isSet = false;
    for (int allocations = 0; !isSet; ++allocations) {
      try {
        const AllocationFault fault(allocations, AllocationFault::BadAlloc);
        (parser.*set)(record, key, value);
        isSet = true;
      } catch (const std::bad_alloc&) {
        ASSERT_EQ(Answers(parser), plain.Answers()) << step;
      }
    }
    plain.Set(kind, name, key.GetText(), value.GetText());
    ASSERT_EQ(Answers(parser), plain.Answers()) << step;
  }
  for (auto& [parser, plain] : pairs) EXPECT_EQ(Answers(parser), plain.Answers());
}

}  // namespace
