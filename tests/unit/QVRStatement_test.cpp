#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "Tarvo_QVRStatement.h"
#include "Tarvo_TokenReader.h"

namespace {

using namespace Tarvo;
using namespace Tarvo::QVRStatement;

std::string Dump(const PropertyList& properties) {
  std::string text;
  for (const auto& [name, value] : properties) {
    text += "<" + std::string(name.View()) + "=" + std::string(value.View()) + ">";
  }
  return text;
}

std::string Option(const char* line, const char* delimiters) {
  if (!BeginsWith(line, "OPTION", delimiters)) return "ignored";
  OptionText option;
  LineFault fault;
  const Result result = ReadOption(line, delimiters, option, fault);
  if (result == Read) return Dump({MakeOption(option)});
  return result == NamesNothing ? "ignored" : "unparsable";
}

// The rows in which the two readers differ are those with two results.
TEST(QVRStatement, ReadsOptions) {
  struct Row {
    const char* line;
    const char* scanned;
    const char* parsed;
  };
  const Row rows[] = {
      {"OPTION A = b c", "<A=b c>", nullptr},
      {"OPTION  A=b=c", "<A=b=c>", nullptr},
      {"OPTION A = x,y , z", "<A=x,y , z>", nullptr},
      {"OPTION A = (b (c) ]\" d) e", "<A=(b (c) ]\" d) e>", nullptr},
      {"OPTION A = [1 [2] (] x", "<A=[1 [2] (] x>", nullptr},
      {"OPTION A = \"  b 'c \"", "<A=b 'c>", nullptr},
      {"OPTION A = 'say \"x\"'", "<A=say \"x\">", nullptr},
      {"OPTION A = \"quoted\" and \"the\" rest", "<A=quoted and \"the\" rest>", nullptr},
      {"OPTION A = \"\"", "<A=>", nullptr},
      {"OPTION A = ''b", "<A=b>", nullptr},
      {"OPTION A = =", "<A==>", nullptr},
      {"OPTION A = ) b", "<A=) b>", nullptr},
      {"OPTION = = x", "<==x>", nullptr},
      {"OPTION A = 16:4096", "<A=16:4096>", nullptr},
      {"OPTION", "ignored", nullptr},
      {"OPTIONS A = b", "ignored", nullptr},
      {"option A = b", "ignored", nullptr},
      {"\"OPTION\" A = b", "ignored", nullptr},
      {"", "ignored", nullptr},
      {"OPTION A", "unparsable", nullptr},
      {"OPTION A =", "unparsable", nullptr},
      {"OPTION A B = c", "unparsable", nullptr},
      {"OPTION A = \"b", "unparsable", nullptr},
      {"OPTION A = '", "unparsable", nullptr},
      {"OPTION A = (b [c)] (", "<A=(b [c)] (>", nullptr},
      {"OPTION A = ((b)", "unparsable", nullptr},
      {"OPTION A = [", "unparsable", nullptr},
      {"OPTION a:b = c", "unparsable", "<a:b=c>"},
      {"OPTION=x y", "unparsable", "ignored"},
      {"OPTION:x = y", "unparsable", "ignored"}};
  for (const Row& row : rows) {
    EXPECT_EQ(Option(row.line, kScannerDelimiters), row.scanned) << row.line;
    const std::string parsed =
        BeginsWith(row.line, "OPTION", " ") ? Option(row.line, kOptionDelimiters) : "ignored";
    EXPECT_EQ(parsed, row.parsed ? row.parsed : row.scanned) << row.line;
  }
}

// The pairs, then what is left of the line, or what is wrong and where.
std::string List(std::string_view line) {
  QVRStatement::List list;
  LineFault fault;
  std::string text = ReadList(line, list, fault) ? "" : std::string(fault.text) + " at ";
  if (fault.text) return text + std::to_string(fault.where.data() - line.data());
  for (const Pair& pair : list.pairs) {
    text.append("<").append(pair.key).append("=").append(pair.value).append(">");
  }
  return text.append(list.rest);
}

TEST(QVRStatement, ReadsPairs) {
  const char* const rows[][2] = {
      {"PORT a = 1", "<a=1>"},
      {"PORT a = 1 b = 2", "<a=1>b = 2"},
      {"PORT a = 1,", "<a=1>,"},
      {"PORT a = 1, b", "missing '=' after the name at 13"},
      {"PORT a = 1, b =", "missing value after '=' at 15"},
      {"PORT a = , b = 2", "<a=,>b = 2"},
      {"PORT a = 1,b=\"2, 3\" , c = 16:4", "<a=1><b=2, 3><c=16:4>"},
      {"PARAMETER a = two words, b = 1", "<a=two>words, b = 1"},
      {"PARAMETER a = (1, 2), b = [3, (4]", "<a=(1, 2)><b=[3, (4]>"},
      {"PARAMETER a = \"it's\", b = 'say \"x\"'", "<a=it's><b=say \"x\">"},
      {"PARAMETER a = \"abc", "quote is not closed at 14"},
      {"PARAMETER a = 1, , = 2", "<a=1><,=2>"},
      {"PARAMETER", "missing name at 9"},
      {"PARAMETER a", "missing '=' after the name at 11"},
      {"PARAMETER a b = 1", "missing '=' after the name at 12"}};
  for (const auto& [line, expected] : rows) EXPECT_EQ(List(line), expected) << line;
}

// Whatever the line: its tokens joined give it back, and reading values until it ends does end.
TEST(TokenReader, LosesNothingOfAnyLine) {
  const std::string alphabet = " =:,()[]\"'ab";
  unsigned long random = 1;
  for (int round = 0; round < 4000; ++round) {
    std::string line;
    for (int i = 0; i < round % 12; ++i) {
      random = random * 6364136223846793005UL + 1442695040888963407UL;
      line += alphabet[(random >> 33U) % alphabet.size()];
    }
    for (const char* delimiters : {kOptionDelimiters, kListDelimiters, kScannerDelimiters}) {
      std::string joined;
      TokenReader tokens(line, delimiters, TokenReader::WithGroups);
      for (std::string_view rest = tokens.GetRest(); !rest.empty(); rest = tokens.GetRest()) {
        joined += tokens.GetToken();
        tokens.Step();
      }
      ASSERT_EQ(joined, line);
      TokenReader values(line, delimiters, TokenReader::WithGroups);
      std::size_t steps = 0;
      for (; values.MoreTokens(); values.Step()) {
        values.ReadValue();
        ASSERT_LE(++steps, line.size());
      }
    }
  }
}

TEST(TokenReader, TakesGroupsOnlyWhereTheFormatHasThem) {
  EXPECT_EQ(TokenReader("( a ) b", " ", TokenReader::WithGroups).ReadValue().text, "( a )");
  EXPECT_EQ(TokenReader("( a ) b", " ", TokenReader::WithoutGroups).ReadValue().text, "(");
  EXPECT_EQ(TokenReader("(a ) b", " ", TokenReader::WithGroups).ReadValue().text, "(a");
  const auto unclosed = TokenReader("'a b", " \"'", TokenReader::WithGroups).ReadValue();
  EXPECT_EQ(unclosed.text, "a b");
  EXPECT_FALSE(unclosed.whole);
}

}  // namespace
