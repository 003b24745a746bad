// Every exported operation of a library and its instances, asked on every core of the sample
// repositories: tests/data/examples.txt has the answers.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <sstream>
#include <string>

#include "MessageRecorder.h"
#include "Questions.h"
#include "ReviewedText.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Key.h"

namespace {

using namespace Questions;
using namespace Tarvo;

class Examples : public testing::Test {
 protected:
  // The answer to a question that has one.
  template <class Output, class Question, class... Arguments>
  Output Ask(Question question, const Arguments&... arguments) const {
    Output answer;
    EXPECT_TRUE(((*ip).*question)(arguments..., answer));
    return answer;
  }
  template <class Question, class... Arguments>
  StringList List(Question question, const Arguments&... arguments) const {
    return Ask<StringList>(question, arguments...);
  }
  void Write(const std::string& what, const StringList& list) {
    report << "  " << what << ":";
    for (const StringBase& name : list) report << " " << name;
    report << "\n";
  }

  void DescribeAll();
  void DescribeCore(const StringBase& key);
  void DescribeOptions(const StringBase& key);
  void DescribeElements();
  void DescribeSources();
  void DescribeNetlists();

  const std::string root = std::string(KEL_EXAMPLES) + "/";
  KelLibrary library;
  std::unique_ptr<KelIP> ip;
  MessageRecorder recorder;
  std::ostringstream report;
};

void Examples::DescribeAll() {
  StringList keys;
  StringList properties;
  EXPECT_TRUE(library.ListAllIPKeys(keys) && library.ListAllIPProperties(properties));
  Write("keys", keys);
  Write("all core properties", properties);
  for (const StringBase& key : keys) DescribeCore(key);
  for (const Kind& kind : kKinds) {
    Write(std::string("all ") + kind.name + " properties", List(kind.listAll));
  }
  Write("all source properties", List(&KelIP::ListAllSourceProperties));
  Write("all netlist properties", List(&KelIP::ListAllNetlistProperties));
}

void Examples::DescribeCore(const StringBase& text) {
  ip.reset(library.CreateIP(text));
  ASSERT_TRUE(ip) << text;
  const Kel_Key key(ip->GetKey());
  EXPECT_EQ(ip->GetName(), library.GetName(text));
  EXPECT_EQ(ip->GetVersion(), library.GetVersion(text));
  EXPECT_EQ(ip->GetLocation(), library.GetLocation(text));
  report << ip->GetKey() << " " << key.GetName() << " " << key.GetVersion() << " "
         << key.GetMajorVersion() << " " << key.GetMinorVersion() << " " << key.GetRevision()
         << ", newest " << library.GetLatestIPKey(text) << ", at " << ip->GetLocation() << "\n";
  DescribeOptions(text);
  DescribeElements();
  DescribeSources();
  DescribeNetlists();
}

void Examples::DescribeOptions(const StringBase& key) {
  StringList names;
  EXPECT_TRUE(library.ListIPProperties(key, names));
  EXPECT_EQ(List(&KelIP::ListIPProperties), names);
  report << "  options:";
  for (const StringBase& name : names) {
    StringBase value;
    EXPECT_TRUE(library.GetIPProperty(key, name, value));
    EXPECT_EQ(Ask<StringBase>(&KelIP::GetIPProperty, name), value);
    report << " " << name << "=" << value << ";";
  }
  report << "\n";
}

void Examples::DescribeElements() {
  for (const Kind& kind : kKinds) {
    for (const StringBase& name : List(kind.list)) {
      report << "  " << kind.name << " " << name << ":";
      for (const StringBase& property : List(kind.listProperties, name)) {
        report << " " << property << "=" << Ask<StringBase>(kind.get, name, property) << ";";
      }
      report << "\n";
    }
  }
  for (const Members& members : kMembers) {
    for (const StringBase& interface : List(members.interfaces)) {
      Write(std::string(members.name) + " of " + interface.GetText(),
            List(members.list, interface));
    }
  }
}

void Examples::DescribeSources() {
  StringList sources;
  if (!ip->ListSynthesisSources(sources)) return;
  Write("synthesis", sources);
  sources = List(&KelIP::ListSimulationSources);
  Write("simulation", sources);
  for (const StringBase& source : sources) {
    StringList values;
    for (const StringBase& property : List(&KelIP::ListSourceProperties, source)) {
      // the extension .sv tells no language
      StringBase value;
      ip->GetSourceProperty(source, property, value);
      values.push_back(value);
    }
    Write("source", values);
  }
  Write("synthesis libraries", List(&KelIP::ListSynthesisLibraries));
  Write("simulation libraries", List(&KelIP::ListSimulationLibraries));
  for (const StringBase& key : List(&KelIP::ListVerilogIncludeLibraries)) {
    Write("include directory of " + std::string(key),
          {Ask<StringBase>(&KelIP::GetVerilogIncludeLocation, key)});
  }
}

void Examples::DescribeNetlists() {
  StringList netlists;
  if (!ip->ListNetlists(netlists)) return;
  Write("netlists", netlists);
  Write("netlist libraries", List(&KelIP::ListNetlistLibraries));
  for (const StringBase& netlist : netlists) {
    const StringBase property = List(&KelIP::ListNetlistProperties, netlist).front();
    Write("netlist", {property, Ask<StringBase>(&KelIP::GetNetlistProperty, netlist, property)});
  }
  for (const auto& [name, value] : {std::pair{"SCRAMBLE", "0"}, {"MODE", "FAST"}}) {
    if (!testing::Value(List(&KelIP::ListParameters), testing::Contains(name))) continue;
    EXPECT_TRUE(ip->SetParameterProperty(name, "VALUE", value));
    Write("netlists for " + std::string(name) + "=" + value, List(&KelIP::ListNetlists));
  }
}

TEST_F(Examples, AnswerAsReviewed) {
  ASSERT_TRUE(library.SetRepositoryPath((root + "overlay;" + root + "repository").c_str()));
  DescribeAll();
  ASSERT_TRUE(library.SetRepositoryPath((root + "repository").c_str()));
  DescribeCore("pulse_counter_v2_00_a");  // which the overlay hides
  EXPECT_THAT(recorder.Take(), testing::IsEmpty());
  ExpectReviewed("examples.txt", Replaced(report.str(), root, ""));
}

}  // namespace
