// Every exported operation of a library and its instances, asked on every core of the sample
// repositories: the answers are compared with a reviewed text.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>

#include "MessageRecorder.h"
#include "Questions.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_Kel_Key.h"

namespace {

using namespace Questions;
using namespace Tarvo;
namespace fs = std::filesystem;

class Examples : public testing::Test {
 protected:
  // Turns to these repositories, the first of which counts.
  void Open(std::initializer_list<const char*> repositories) {
    std::string path;
    for (const char* repository : repositories) path += root + "/" + repository + ";";
    ASSERT_TRUE(library.SetRepositoryPath(path.c_str()));
    ASSERT_TRUE(library.RefreshLibrary());
  }

  std::string Shorten(const StringBase& text) const {
    std::string shortened(text.View());
    if (shortened.rfind(root + "/", 0) == 0) shortened.erase(0, root.size() + 1);
    return shortened;
  }
  void Write(const std::string& what, const StringList& list) {
    report << "  " << what << ":";
    for (const StringBase& name : list) report << " " << Shorten(name);
    report << "\n";
  }

  void DescribeLibrary();
  void DescribeCore(const StringBase& key);
  void DescribeIdentity(const StringBase& key, const KelIP& ip);
  void DescribeOptions(const StringBase& key, const KelIP& ip);
  void DescribeElements(const KelIP& ip);
  void DescribeMembers(const KelIP& ip);
  void DescribeSources(const KelIP& ip);
  void DescribeNetlists(KelIP& ip);

  const std::string root = KEL_EXAMPLES;
  KelLibrary library;
  MessageRecorder recorder;
  std::ostringstream report;
};

StringList Ask(const KelIP& ip, List list) {
  StringList answer;
  EXPECT_TRUE((ip.*list)(answer));
  return answer;
}

StringList Ask(const KelIP& ip, ListOf list, const StringBase& name) {
  StringList answer;
  EXPECT_TRUE((ip.*list)(name, answer));
  return answer;
}

StringBase Ask(const KelIP& ip, Get get, const StringBase& name, const StringBase& property) {
  StringBase answer;
  EXPECT_TRUE((ip.*get)(name, property, answer));
  return answer;
}

void Examples::DescribeLibrary() {
  StringList list;
  EXPECT_TRUE(library.ListAllIPKeys(list));
  Write("keys", list);
  const std::unique_ptr<KelIP> ip(library.CreateIP(list.front()));
  EXPECT_TRUE(library.ListAllIPProperties(list));
  Write("all core properties", list);
  for (const Kind& kind : kKinds) {
    Write(std::string("all ") + kind.name + " properties", Ask(*ip, kind.listAll));
  }
  Write("all source properties", Ask(*ip, &KelIP::ListAllSourceProperties));
  Write("all netlist properties", Ask(*ip, &KelIP::ListAllNetlistProperties));
}

void Examples::DescribeIdentity(const StringBase& text, const KelIP& ip) {
  const Kel_Key key(ip.GetKey());
  EXPECT_TRUE(key.IsValid());
  EXPECT_EQ(ip.GetKey(), key.GetKey());
  EXPECT_EQ(ip.GetName(), key.GetName());
  EXPECT_EQ(library.GetName(text), key.GetName());
  EXPECT_EQ(ip.GetVersion(), key.GetVersion());
  EXPECT_EQ(library.GetVersion(text), key.GetVersion());
  EXPECT_EQ(library.GetLocation(text), ip.GetLocation());
  report << ip.GetKey() << " " << key.GetName() << " " << key.GetVersion() << " "
         << key.GetMajorVersion() << " " << key.GetMinorVersion() << " " << key.GetRevision()
         << ", newest " << library.GetLatestIPKey(text) << ", at " << Shorten(ip.GetLocation())
         << "\n";
}

void Examples::DescribeOptions(const StringBase& key, const KelIP& ip) {
  StringList names;
  EXPECT_TRUE(library.ListIPProperties(key, names));
  EXPECT_EQ(Ask(ip, &KelIP::ListIPProperties), names);
  report << "  options:";
  for (const StringBase& name : names) {
    StringBase value;
    StringBase other;
    EXPECT_TRUE(library.GetIPProperty(key, name, value));
    EXPECT_TRUE(ip.GetIPProperty(name, other));
    EXPECT_EQ(other, value);
    report << " " << name << "=" << value << ";";
  }
  report << "\n";
}

void Examples::DescribeElements(const KelIP& ip) {
  for (const Kind& kind : kKinds) {
    for (const StringBase& name : Ask(ip, kind.list)) {
      report << "  " << kind.name << " " << name << ":";
      for (const StringBase& property : Ask(ip, kind.listProperties, name)) {
        const StringBase value = Ask(ip, kind.get, name, property);
        report << " " << property << "=" << value << ";";
      }
      report << "\n";
    }
  }
}

void Examples::DescribeMembers(const KelIP& ip) {
  for (const Members& members : kMembers) {
    for (const StringBase& interface : Ask(ip, members.interfaces)) {
      const StringList list = Ask(ip, members.list, interface);
      Write(std::string(members.name) + " of " + interface.GetText(), list);
    }
  }
}

void Examples::DescribeSources(const KelIP& ip) {
  StringList sources;
  if (!ip.ListSynthesisSources(sources)) return;
  Write("synthesis", sources);
  Write("simulation", Ask(ip, &KelIP::ListSimulationSources));
  Write("synthesis libraries", Ask(ip, &KelIP::ListSynthesisLibraries));
  Write("simulation libraries", Ask(ip, &KelIP::ListSimulationLibraries));
  const StringList libraries = Ask(ip, &KelIP::ListVerilogIncludeLibraries);
  for (const StringBase& key : libraries) {
    StringBase directory;
    EXPECT_TRUE(ip.GetVerilogIncludeLocation(key, directory));
    Write("include directory of " + std::string(key), {directory});
  }
  for (const StringBase& source : Ask(ip, &KelIP::ListSimulationSources)) sources.push_back(source);
  for (const StringBase& source : sources) {
    EXPECT_TRUE(fs::is_regular_file(source.GetText())) << source;
    StringList values;
    for (const StringBase& property : Ask(ip, &KelIP::ListSourceProperties, source)) {
      values.push_back(Ask(ip, &KelIP::GetSourceProperty, source, property));
    }
    ASSERT_EQ(values.size(), 4U);
    const Port::FileName file(source);
    EXPECT_EQ(values[1], file.HasExtension("v") ? "Verilog" : "VHDL");
    EXPECT_EQ(std::string(values[2]) + "/" + values[3].GetText(), source.GetText());
    EXPECT_EQ(source.View().find(library.GetLocation(values[0]).View()), 0U);
  }
}

void Examples::DescribeNetlists(KelIP& ip) {
  StringList netlists;
  if (!ip.ListNetlists(netlists)) return;
  Write("netlists", netlists);
  Write("netlist libraries", Ask(ip, &KelIP::ListNetlistLibraries));
  for (const StringBase& netlist : netlists) {
    EXPECT_TRUE(fs::is_regular_file(netlist.GetText())) << netlist;
    EXPECT_THAT(Ask(ip, &KelIP::ListNetlistProperties, netlist), testing::ElementsAre("LIBRARY"));
    const StringBase owner = Ask(ip, &KelIP::GetNetlistProperty, netlist, "LIBRARY");
    EXPECT_EQ(netlist.View().find(library.GetLocation(owner).View()), 0U);
  }
  for (const auto& [name, value] : {std::pair{"SCRAMBLE", "0"}, {"MODE", "FAST"}}) {
    if (!testing::Value(Ask(ip, &KelIP::ListParameters), testing::Contains(name))) continue;
    EXPECT_TRUE(ip.SetParameterProperty(name, "VALUE", value));
    Write("netlists for " + std::string(name) + "=" + value, Ask(ip, &KelIP::ListNetlists));
  }
}

void Examples::DescribeCore(const StringBase& key) {
  SCOPED_TRACE(key.GetText());
  const std::unique_ptr<KelIP> ip(library.CreateIP(key));
  ASSERT_TRUE(ip);
  DescribeIdentity(key, *ip);
  DescribeOptions(key, *ip);
  DescribeElements(*ip);
  DescribeMembers(*ip);
  DescribeSources(*ip);
  DescribeNetlists(*ip);
}

TEST_F(Examples, AnswerAsReviewed) {
  Open({"overlay", "repository"});
  DescribeLibrary();
  StringList keys;
  EXPECT_TRUE(library.ListAllIPKeys(keys));
  for (const StringBase& key : keys) DescribeCore(key);
  Open({"repository"});
  DescribeCore("pulse_counter_v2_00_a");  // which the overlay hides
  EXPECT_THAT(recorder.Take(), testing::IsEmpty());
  std::ifstream reviewed(KEL_TEST_DATA "/examples.txt");
  std::istringstream answered(report.str());
  std::string expected;
  std::string line;
  std::ofstream(KEL_TEST_OUTPUT "/examples.txt") << report.str();
  for (int number = 1; std::getline(answered, line); ++number) {
    std::getline(reviewed, expected);
    ASSERT_EQ(line, expected) << "line " << number << "; all answers are in " KEL_TEST_OUTPUT;
  }
  EXPECT_FALSE(std::getline(reviewed, expected)) << expected;
}

}  // namespace
