// The pairs of a statement, and what is wrong with one at which place. Whole descriptions are among
// the cases of Readers_test.

#include <gtest/gtest.h>

#include <string>

#include "Tarvo_QVRStatement.h"

namespace {

using namespace Tarvo;
using namespace Tarvo::QVRStatement;

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

}  // namespace
