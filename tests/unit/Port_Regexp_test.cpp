#include "Port_Regexp.h"

#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <tuple>

namespace {

const char* const kSuffix = "[_][vV][0-9]+[_][0-9][0-9][_][a-zA-Z]$";

std::string Dump(const Port_Range& range) {
  return range.IsEmpty() ? "none" : std::to_string(range.first) + "-" + std::to_string(range.last);
}

TEST(Regexp, FindsTheFirstMatch) {
  const std::tuple<const char*, const char*, unsigned, const char*> rows[] = {
      {kSuffix, "abc_v1_00_a", 0, "3-10"},
      {kSuffix, "abc_v1_00_a\n", 0, "none"},
      {kSuffix, "_V123_45_Z", 0, "0-9"},
      {kSuffix, "a_v1_00_a_v2_00_b", 0, "9-16"},
      {kSuffix, "\xFF_v1_00_a", 0, "1-8"},
      {kSuffix, "abc_v1_00_a", 4, "none"},
      {kSuffix, "abc", 9, "none"},
      {kSuffix, "", 0, "none"},
      {"a+", "baab", 0, "1-2"},
      {"ab", "baab", 0, "2-3"},
      {"x*", "baab", 0, "none"}};
  for (const auto& [pattern, text, start, range] : rows) {
    EXPECT_EQ(Dump(Port_Regexp(pattern).GetRangeOfMatch(text, start)), range)
        << pattern << " on " << text;
  }
}

TEST(Regexp, EndsOnLongTexts) {
  std::string starts;
  while (starts.size() < 1U << 20U) starts += "_v1_00_a";
  const std::string digits = "_v" + std::string(1U << 20U, '1');
  const Port_Regexp expression(kSuffix);
  EXPECT_EQ(Dump(expression.GetRangeOfMatch((starts + "_").c_str(), 0)), "none");
  EXPECT_EQ(Dump(expression.GetRangeOfMatch(digits.c_str(), 0)), "none");
  EXPECT_EQ(Dump(expression.GetRangeOfMatch((digits + "_00_a").c_str(), 0)), "0-1048582");
}

TEST(Regexp, RefusesWhatIsNoPattern) { EXPECT_THROW(Port_Regexp("["), std::invalid_argument); }

}  // namespace
