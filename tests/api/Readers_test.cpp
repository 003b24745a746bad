// What the readers make of files: the answers to the questions in tests/data/readers are compared
// with the reviewed ones. What is answered now goes to a file of the same name in the tests'
// output.
//
//     == what the case shows
//     abc_v1_00_a.ldx         the file of a core, or any path below `ipmods`
//     |lib abc a.vhd          a line of it
//     ? order abc VHDL        a question; messages, then what the reader gives or throws
//     > both: abc_v1_00_a/hdl/vhdl/a.vhd
//     % lib abc b.vhd         the question again, the last file being this, with `\n` and `\t`
//
// A message has the file and line in front that were being read.

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "IndexedRepository.h"
#include "MessageRecorder.h"
#include "Outcome.h"
#include "Questions.h"
#include "ReviewedText.h"
#include "Tarvo_LDXParser.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_TEWParser.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;

// The words of a question behind its topic. Those that it does not have are empty.
using Words = std::vector<StringBase>;

std::string List(const StringList& names) { return (names.empty() ? "none" : Join(names)) + "\n"; }

StringBase Pair(const StringBase& name, const StringBase& value) {
  StringBase pair = name;
  pair.Append("=");
  pair.Append(value);
  return pair;
}

std::string Dump(const KelPlace& place) {
  return " " + fs::path(place.file.GetText()).filename().string() + ":" +
         std::to_string(place.line) + ":" + std::to_string(place.column) + "+" +
         std::to_string(place.length) + "\n";
}

std::string AskOrder(const Kel_Index& index, const Words& words) {
  const LDXParser order(index, Kel_Key(words[0]), Kel_Key(), words[1]);
  const std::string synthesis = List(order.ListSynthesisAnalyseOrder());
  const std::string simulation = List(order.ListSimulationAnalyseOrder());
  std::string text = synthesis == simulation
                         ? "both: " + synthesis
                         : "synthesis: " + synthesis + "simulation: " + simulation;
  for (const StringBase& library : order.ListVerilogIncludeLibraryKeys()) {
    text += "include directory of " + std::string(library) + ": " +
            order.GetVerilogIncludeLocation(library).GetText() + "\n";
  }
  return text;
}

std::string AskPlaces(const Kel_Index& index, const Words& words) {
  const LDXParser order(index, Kel_Key(words[0]), Kel_Key(), words[1]);
  std::ostringstream text;
  for (const auto& list : {order.GetSynthesisSources(), order.GetSimulationSources()}) {
    for (const KelSource& source : list) {
      text << source.path << " of " << source.library.GetKey() << " in " << source.language
           << Dump(source.place);
    }
    text << "\n";
  }
  for (const KelIncludeDirectory& directory : order.GetVerilogIncludeDirectories()) {
    text << directory.path << " of " << directory.library << Dump(directory.place);
  }
  for (const KelInclude& include : order.GetIncludes()) {
    text << include.library << " is " << include.core.GetKey() << Dump(include.place);
  }
  return text.str();
}

std::string AskNetlists(const Kel_Index& index, const Words& words) {
  const Kel_Key key(words[0]);
  const bool isDescribed = words[1] != "undescribed";
  const auto description = isDescribed ? std::make_unique<QVRParser>(index, key) : nullptr;
  return List(TEWParser(index, key, description.get()).ListFiles());
}

// As the scanner finds them, then as the description's parser lists them unless that says the same.
std::string AskOptions(const Kel_Index& index, const Words& words) {
  const Kel_Key key(words[0]);
  const std::string scanned = Outcome([&] {
    StringList pairs;
    const auto file = Kel_Index::GetDataFile(index.GetIPLocation(key), key, "qvr");
    for (const auto& [name, value] : OptionScanner(key, file).GetOptions()) {
      pairs.push_back(Pair(name, value));
    }
    return List(pairs);
  });
  const std::string parsed = Outcome([&] {
    StringList pairs;
    const QVRParser parser(index, key);
    for (const StringBase& name : parser.ListOptions()) {
      pairs.push_back(Pair(name, parser.GetOptionValue(name)));
    }
    return List(pairs);
  });
  const std::string own =
      Join({Pair("NAME", key.GetName()), Pair("VERSION", key.GetVersion()), ""});
  return scanned == own + parsed ? scanned : scanned + parsed;
}

// A line for each record, with all properties, and for the members of each interface.
std::vector<std::string> Dump(const QVRParser& parser) {
  std::vector<std::string> lines;
  for (const Questions::Kind& kind : Questions::kKinds) {
    for (const StringBase& name : (parser.*kind.parserList)()) {
      lines.push_back(std::string(kind.name) + " " + name.GetText() + ":");
      for (const StringBase& property : (parser.*kind.parserListProperties)(name)) {
        lines.back() += " ";
        lines.back() += Pair(property, (parser.*kind.parserGet)(name, property));
      }
      lines.back() += "\n";
    }
  }
  for (const Questions::Members& members : Questions::kMembers) {
    for (const StringBase& interface : (parser.*members.parserInterfaces)()) {
      lines.push_back(std::string(members.name) + " of " + interface.GetText() + ": " +
                      List((parser.*members.parserList)(interface)));
    }
  }
  return lines;
}

std::string AskDescription(const Kel_Index& index, const Words& words) {
  std::string text;
  for (const std::string& line : Dump(QVRParser(index, Kel_Key(words[0])))) text += line;
  return text;
}

// The lines that go and come when a property is set.
std::string AskChange(const Kel_Index& index, const Words& words) {
  QVRParser parser(index, Kel_Key(words[0]));
  const auto set =
      words[1] == "parameter" ? &QVRParser::SetParameterProperty : &QVRParser::SetGenericProperty;
  const std::vector<std::string> before = Dump(parser);
  (parser.*set)(words[2], words[3], words[4]);
  const std::vector<std::string> after = Dump(parser);
  std::string text;
  const auto addMissing = [&](const char* mark, const auto& lines, const auto& others) {
    for (const std::string& line : lines) {
      const bool isSame = std::find(others.begin(), others.end(), line) != others.end();
      if (!isSame) text += mark + line;
    }
  };
  addMissing("- ", before, after);
  addMissing("+ ", after, before);
  return text;
}

const std::map<std::string, std::string (*)(const Kel_Index&, const Words&)> kTopics = {
    {"order", AskOrder},     {"places", AskPlaces},           {"netlists", AskNetlists},
    {"options", AskOptions}, {"description", AskDescription}, {"change", AskChange}};

// The path below `ipmods` of a file as a case names it.
std::string PathOf(const std::string& name) {
  if (name.find('/') != std::string::npos) return name;
  const std::size_t dot = name.rfind('.');
  const std::string core = name.substr(0, name.rfind("_v"));
  return name.substr(0, dot) + "/data/" + core + "_v2_1_0" + name.substr(dot);
}

std::string Unescape(std::string text) {
  for (std::size_t at; (at = text.find("\\n")) != std::string::npos;) text.replace(at, 2, "\n");
  for (std::size_t at; (at = text.find("\\t")) != std::string::npos;) text.replace(at, 2, "\t");
  return text;
}

class Readers : public testing::Test, protected IndexedRepository {
 protected:
  void Review(const std::string& name);

 private:
  void Take(const std::string& line);
  void Write(const std::string& text);
  void Answer();

  std::string file;
  std::string content;
  std::string question;
  std::string report;
};

void Readers::Review(const std::string& name) {
  std::ifstream reviewed(KEL_TEST_DATA "/readers/" + name);
  for (std::string line; std::getline(reviewed, line);) Take(line);
  ExpectReviewed("readers/" + name, report);
}

void Readers::Take(const std::string& line) {
  const char kind = line.empty() ? '#' : line[0];
  if (kind == '>') return;  // is answered anew
  report += line + "\n";
  if (kind == '#') return;
  if (kind == '=') {
    fs::remove_all(repo / "ipmods");
  } else if (kind == '|') {
    Write(content + line.substr(1) + "\n");
  } else if (kind == '?') {
    question = line.substr(2);
    Answer();
  } else if (kind == '%') {
    Write(Unescape(line.substr(2)));
    Answer();
  } else {
    file = PathOf(line);
    Write("");
  }
}

void Readers::Write(const std::string& text) {
  content = text;
  repo.File("ipmods/" + file, text);
}

void Readers::Answer() {
  const MessageRecorder ofTheIndex;
  index.ClearIP();
  for (const auto& core : fs::directory_iterator(repo / "ipmods")) {
    Outcome([&] { Add(core.path().filename()); });
  }
  std::istringstream stream(question);
  std::string topic;
  stream >> topic;
  const bool isTraced = topic == "traced";
  if (isTraced) stream >> topic;
  Words words;
  for (std::string word; stream >> word;) words.emplace_back(word);
  words.resize(5);
  MessageRecorder recorder(isTraced ? MessageRecorder::MessagesAndTraces
                                    : MessageRecorder::Messages);
  const std::string given = Outcome([&] { return kTopics.at(topic)(index, words); });
  std::string text;
  const auto messages = recorder.Take();
  for (std::size_t i = 0; i < messages.size(); ++i) {
    text += (isTraced ? "" : recorder.Inputs()[i] + " ") + messages[i];
  }
  std::istringstream lines(Shorten(text + given));
  for (std::string line; std::getline(lines, line);) {
    report += line.empty() ? ">\n" : "> " + line + "\n";
  }
}

TEST_F(Readers, AnswerAboutOrdersAsReviewed) { Review("orders.txt"); }
TEST_F(Readers, AnswerAboutDescriptionsAsReviewed) { Review("descriptions.txt"); }
TEST_F(Readers, AnswerAboutNetlistsAsReviewed) { Review("netlists.txt"); }

}  // namespace
