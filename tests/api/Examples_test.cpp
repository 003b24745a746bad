// Every exported operation of every class, asked on every core of the sample repositories: what an
// instance answers is compared with a reviewed text, and what the other classes answer with that.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>

#include "MessageRecorder.h"
#include "Questions.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"
#include "Tarvo_KelLibrary_Utils.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_LDXParser.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_TEWParser.h"

namespace {

using namespace Questions;
using namespace Tarvo;
namespace fs = std::filesystem;

class Examples : public testing::Test {
 protected:
  // Turns to these repositories, the first of which counts.
  void Open(std::initializer_list<const char*> repositories) {
    std::string path;
    index.ClearIP();
    for (const char* repository : repositories) {
      path += root + "/" + repository + ";";
      for (const auto& entry : fs::directory_iterator(root + "/" + repository + "/ipmods")) {
        Port::FileName location;
        location.SetHead(entry.path().c_str());
        index.AddIP(Kel_Key(StringBase(entry.path().filename().c_str())), location);
      }
    }
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
  void DescribeElements(const KelIP& ip, const QVRParser& parser);
  void DescribeMembers(const KelIP& ip, const QVRParser& parser);
  void DescribeSources(const KelIP& ip, const QVRParser& parser);
  void DescribeNetlists(KelIP& ip, QVRParser& parser);

  const std::string root = KEL_EXAMPLES;
  KelLibrary library;
  Kel_Index index;
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
  EXPECT_EQ(list, index.GetAllIPKeys());
  EXPECT_EQ(index.GetFullIPCount(), list.size());
  Write("keys", list);
  Write("newest", index.GetLatestIPKeys());
  EXPECT_EQ(index.GetBaseIPCount(), index.GetLatestIPKeys().size());
  EXPECT_TRUE(library.ListAllIPProperties(list));
  Write("all core properties", list);
  const std::unique_ptr<KelIP> ip(library.CreateIP(index.GetAllIPKeys().front()));
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
  EXPECT_EQ(index.GetIPKey(key), key);
  EXPECT_EQ(ip.GetName(), key.GetName());
  EXPECT_EQ(library.GetName(text), key.GetName());
  EXPECT_EQ(ip.GetVersion(), key.GetVersion());
  EXPECT_EQ(library.GetVersion(text), key.GetVersion());
  EXPECT_EQ(library.GetLocation(text), ip.GetLocation());
  EXPECT_EQ(index.GetIPLocation(key).GetAbsolutePath(), ip.GetLocation());
  report << ip.GetKey() << " " << key.GetName() << " " << key.GetVersion() << " "
         << key.GetMajorVersion() << " " << key.GetMinorVersion() << " " << key.GetRevision()
         << ", newest " << library.GetLatestIPKey(text) << ", at " << Shorten(ip.GetLocation())
         << "\n";
}

void Examples::DescribeOptions(const StringBase& text, const KelIP& ip) {
  const Kel_Key key(text);
  const Port::FileName file =
      Kel_Index::GetDataFile(index.GetIPLocation(key), key, Kel_Index::KEL_QVR_EXTENSION);
  unsigned count = 0;
  StringBase line;
  FileScanner lines(file);
  while (lines.GetNextLine(line)) ++count;
  report << "  lines: " << count << "\n  options:";
  const PropertyList options = OptionScanner(key, file).GetOptions();
  EXPECT_EQ(index.GetIPOptions(key), options);
  StringList names;
  EXPECT_TRUE(library.ListIPProperties(text, names));
  EXPECT_EQ(Ask(ip, &KelIP::ListIPProperties), names);
  for (const auto& [name, value] : options) {
    report << " " << name << "=" << value << ";";
    EXPECT_EQ(OptionScanner::GetOptionValue(options, name), value);
    StringBase other;
    EXPECT_TRUE(ip.GetIPProperty(name, other));
    EXPECT_EQ(other, value);
    EXPECT_TRUE(library.GetIPProperty(text, name, other));
    EXPECT_EQ(other, value);
  }
  report << "\n";
}

void Examples::DescribeElements(const KelIP& ip, const QVRParser& parser) {
  for (const Kind& kind : kKinds) {
    EXPECT_EQ(Ask(ip, kind.list), (parser.*kind.parserList)());
    for (const StringBase& name : Ask(ip, kind.list)) {
      report << "  " << kind.name << " " << name << ":";
      EXPECT_EQ(Ask(ip, kind.listProperties, name), (parser.*kind.parserListProperties)(name));
      for (const StringBase& property : Ask(ip, kind.listProperties, name)) {
        const StringBase value = Ask(ip, kind.get, name, property);
        EXPECT_EQ((parser.*kind.parserGet)(name, property), value);
        report << " " << property << "=" << value << ";";
      }
      report << "\n";
    }
  }
}

void Examples::DescribeMembers(const KelIP& ip, const QVRParser& parser) {
  for (const Members& members : kMembers) {
    for (const StringBase& interface : Ask(ip, members.interfaces)) {
      const StringList list = Ask(ip, members.list, interface);
      EXPECT_EQ((parser.*members.parserList)(interface), list);
      Write(std::string(members.name) + " of " + interface.GetText(), list);
    }
  }
}

void Examples::DescribeSources(const KelIP& ip, const QVRParser& parser) {
  StringList sources;
  if (!ip.ListSynthesisSources(sources)) return;
  const StringList options = parser.ListOptions();
  const bool stated = std::find(options.begin(), options.end(), "HDL") != options.end();
  const LDXParser order(index, Kel_Key(ip.GetKey()), Kel_Key(),
                        stated ? parser.GetOptionValue("HDL") : LDXParser::LDX_HDL_VHDL);
  EXPECT_EQ(order.ListSynthesisAnalyseOrder(), sources);
  Write("synthesis", sources);
  Write("simulation", Ask(ip, &KelIP::ListSimulationSources));
  EXPECT_EQ(order.ListSimulationAnalyseOrder(), Ask(ip, &KelIP::ListSimulationSources));
  Write("synthesis libraries", Ask(ip, &KelIP::ListSynthesisLibraries));
  EXPECT_EQ(order.ListSynthesisLibraries(), Ask(ip, &KelIP::ListSynthesisLibraries));
  Write("simulation libraries", Ask(ip, &KelIP::ListSimulationLibraries));
  EXPECT_EQ(order.ListSimulationLibraries(), Ask(ip, &KelIP::ListSimulationLibraries));
  const StringList libraries = Ask(ip, &KelIP::ListVerilogIncludeLibraries);
  EXPECT_EQ(order.ListVerilogIncludeLibraryKeys(), libraries);
  for (const StringBase& key : libraries) {
    StringBase directory;
    EXPECT_TRUE(ip.GetVerilogIncludeLocation(key, directory));
    EXPECT_EQ(order.GetVerilogIncludeLocation(key), directory);
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
    EXPECT_EQ(values[0], order.GetFileLibrary(file).GetKey());
    EXPECT_EQ(values[1], order.GetFileLanguage(file));
    EXPECT_EQ(values[1], file.HasExtension("v") ? "Verilog" : "VHDL");
    EXPECT_EQ(std::string(values[2]) + "/" + values[3].GetText(), source.GetText());
    EXPECT_EQ(source.View().find(library.GetLocation(values[0]).View()), 0U);
  }
}

void Examples::DescribeNetlists(KelIP& ip, QVRParser& parser) {
  StringList netlists;
  if (!ip.ListNetlists(netlists)) return;
  const TEWParser table(index, Kel_Key(ip.GetKey()), &parser);
  EXPECT_EQ(table.ListFiles(), netlists);
  Write("netlists", netlists);
  Write("netlist libraries", Ask(ip, &KelIP::ListNetlistLibraries));
  EXPECT_EQ(table.ListLibraries(), Ask(ip, &KelIP::ListNetlistLibraries));
  for (const StringBase& netlist : netlists) {
    EXPECT_TRUE(fs::is_regular_file(netlist.GetText())) << netlist;
    EXPECT_THAT(Ask(ip, &KelIP::ListNetlistProperties, netlist), testing::ElementsAre("LIBRARY"));
    const StringBase owner = Ask(ip, &KelIP::GetNetlistProperty, netlist, "LIBRARY");
    EXPECT_EQ(table.GetFileLibrary(Port::FileName(netlist)).GetKey(), owner);
    EXPECT_EQ(netlist.View().find(library.GetLocation(owner).View()), 0U);
  }
  for (const auto& [name, value] : {std::pair{"SCRAMBLE", "0"}, {"MODE", "FAST"}}) {
    const StringList parameters = parser.ListParameters();
    if (std::find(parameters.begin(), parameters.end(), name) == parameters.end()) continue;
    EXPECT_TRUE(ip.SetParameterProperty(name, "VALUE", value));
    parser.SetParameterProperty(name, "VALUE", value);
    Write("netlists for " + std::string(name) + "=" + value, Ask(ip, &KelIP::ListNetlists));
    EXPECT_EQ(table.ListFiles(), Ask(ip, &KelIP::ListNetlists));
  }
}

void Examples::DescribeCore(const StringBase& key) {
  SCOPED_TRACE(key.GetText());
  const std::unique_ptr<KelIP> ip(library.CreateIP(key));
  ASSERT_TRUE(ip);
  QVRParser parser(index, Kel_Key(key));
  DescribeIdentity(key, *ip);
  DescribeOptions(key, *ip);
  DescribeElements(*ip, parser);
  DescribeMembers(*ip, parser);
  DescribeSources(*ip, parser);
  DescribeNetlists(*ip, parser);
}

TEST_F(Examples, AnswerAsReviewed) {
  Open({"overlay", "repository"});
  DescribeLibrary();
  for (const StringBase& key : index.GetAllIPKeys()) DescribeCore(key);
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
