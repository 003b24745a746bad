#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "MessageRecorder.h"
#include "Outcome.h"
#include "RepositoryBuilder.h"
#include "Tarvo_FileScanner.h"

namespace {

using namespace Tarvo;
using namespace std::string_literals;
using testing::ElementsAre;

std::string Dump(FileScanner& scanner) {
  std::string text;
  StringBase line;
  unsigned number = 0;
  while (scanner.GetNextLine(line, number)) {
    text += std::to_string(number) + "<" + std::string(line.View()) + ">";
    text += scanner.GetComment();
  }
  EXPECT_EQ(line, "");
  return text + std::to_string(number);
}

TEST(FileScanner, CleansLinesAndKeepsTheirNumbers) {
  const std::string rows[][2] = {{"", "1"},
                                 {"PORT a = 1 # note", "1<PORT a = 1># note2"},
                                 {"   PARAMETER x = 1\t\n", "1<PARAMETER x = 1>2"},
                                 {"#\n \t \nx#\t\r\n\n", "1<>#2<>3<x>#4<>5"},
                                 {"a\t b\r\n\"x # y\"", "1<a  b>2<\"x># y\"3"},
                                 {"a\0b\xFF\xC3\n"s, "1<a\0b\xFF\xC3>2"s}};
  RepositoryBuilder directory;
  for (const auto& [content, lines] : rows) {
    directory.File("f", content);
    FileScanner scanner(Port::FileName((directory / "f").c_str()));
    EXPECT_EQ(Dump(scanner), lines);
    StringBase line = "old";
    EXPECT_FALSE(scanner.GetNextLine(line));
    EXPECT_EQ(line, "");
    scanner.GoToStart();
    EXPECT_EQ(Dump(scanner), lines);
  }
}

TEST(FileScanner, TellsOfFilesAndTabs) {
  RepositoryBuilder directory;
  const std::string name = directory / "f";
  MessageRecorder recorder(MessageRecorder::MessagesAndTraces);
  directory.File("f", "a\tb\n\tc\n");
  FileScanner scanner(Port::FileName(name.c_str()));
  EXPECT_THAT(recorder.Take(), ElementsAre("trace: Opening File " + name + "\n",
                                           "trace:   Tabs found in file " + name + "\n",
                                           "trace: Closed File " + name + "\n"));
  directory.File("f", "a # b\tc\n#\t\n");
  scanner = FileScanner(Port::FileName(name.c_str()));
  EXPECT_EQ(recorder.Take().size(), 2U);
  EXPECT_EQ(Outcome([&] { FileScanner(Port::FileName((name + "%s").c_str())); }),
            "failure: Cannot read file " + name + "%s\n");
  EXPECT_THAT(recorder.Take(), ElementsAre("trace: Opening File " + name + "%s\n"));
}

}  // namespace
