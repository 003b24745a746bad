#include "Port_StringBase.h"

#include <gtest/gtest.h>

#include <tuple>
#include <vector>

namespace {

using Port::StringBase;
using String = StringBase<char>;
using namespace std::string_view_literals;

// Every comparison must agree with that of the bytes; none may fall back on addresses.
TEST(StringBase, ComparesBytesInEveryForm) {
  const std::vector<std::string_view> texts = {"",    "a",      "B",      "ab",   "abc",
                                               "b\t", "\xFF"sv, "a\0b"sv, "a\0"sv};
  for (const auto left : texts) {
    for (const auto right : texts) {
      SCOPED_TRACE(std::string(left) + " against " + std::string(right));
      const String a(left);
      const String b(right);
      EXPECT_EQ(a == b, left == right);
      EXPECT_EQ(a != b, left != right);
      EXPECT_EQ(a < b, left < right);
      EXPECT_EQ(a > b, left > right);
      EXPECT_EQ(a <= b, left <= right);
      EXPECT_EQ(a >= b, left >= right);
      EXPECT_EQ((a <=> b) < 0, left < right);
      EXPECT_EQ(std::hash<String>()(a) == std::hash<String>()(b), left == right);
      EXPECT_EQ(a.Compare(b, String::CompareExact) < 0, left < right);
      if (left.find('\0') == std::string_view::npos) {
        EXPECT_EQ(left.data() == b, left == right);
      }
    }
  }
}

TEST(StringBase, FoldsOnlyAsciiLetters) {
  const std::tuple<const char*, const char*, int> rows[] = {
      {"Verilog", "VERILOG", 0}, {"", "", 0},    {"all", "al", 1}, {"al", "ALL", -1}, {"b", "A", 1},
      {"\xC4", "\xE4", -1},      {"[", "{", -1}, {"@", "`", -1}};
  for (const auto& [left, right, sign] : rows) {
    const int result = String(left).Compare(right, String::CompareIgnoreCase);
    EXPECT_EQ((result > 0) - (result < 0), sign) << left << " against " << right;
  }
}

TEST(StringBase, ExtractStopsAtTheEnd) {
  const std::tuple<unsigned, unsigned, const char*> rows[] = {
      {0, 0, "a"}, {1, 2, "bc"}, {2, 3, "c"},     {3, 3, ""},    {4, 9, ""},
      {2, 1, ""},  {1, 0, ""},   {0, ~0U, "abc"}, {1, ~0U, "bc"}};
  for (const auto& [first, last, result] : rows) {
    EXPECT_EQ(String("abc").Extract({first, last}), result) << first << last;
  }
}

TEST(StringBase, ReadsNumbersThatFit) {
  constexpr unsigned kNone = 99;
  const std::tuple<const char*, Port_Range, unsigned> rows[] = {
      {"x12y", {1, 2}, 12},
      {"007", {0, 9}, 7},
      {"4294967295", {0, 9}, 4294967295U},
      {"4294967296", {0, 9}, kNone},
      {"99999999999999999999999", {0, 99}, kNone},
      {"12x", {0, 2}, kNone},
      {"-1", {0, 1}, kNone},
      {"+1", {0, 1}, kNone},
      {" 1", {0, 1}, kNone},
      {"12", {1, 0}, kNone},
      {"12", {2, 2}, kNone}};
  for (const auto& [text, range, expected] : rows) {
    unsigned value = kNone;
    EXPECT_EQ(String(text).GetUINT32(range, &value), expected != kNone) << text;
    EXPECT_EQ(value, expected) << text;
  }
}

TEST(StringBase, TrimsTheEndsThatTheTypeNames) {
  const std::tuple<const char*, String::TrimType, const char*> rows[] = {
      {" \ta b\t ", String::TrimBoth, "a b"}, {" a ", String::TrimStart, "a "},
      {" a ", String::TrimEnd, " a"},         {"\t \t", String::TrimBoth, ""},
      {"  ", String::TrimStart, ""},          {"", String::TrimBoth, ""},
      {"a", String::TrimBoth, "a"},           {"\na\n", String::TrimBoth, "\na\n"}};
  for (const auto& [whole, type, result] : rows) {
    String text = whole;
    text.Trim(" \t", type);
    EXPECT_EQ(text, result) << whole;
  }
}

TEST(StringBase, HoldsAnyBytes) {
  String text("a\0b"sv);
  text.Append("\xC4z", 1);
  text.Append(String("\0"sv));
  text.MakeLower();
  EXPECT_EQ(text.View(), "a\0b\xC4\0"sv);
  EXPECT_EQ(text.ReplaceChars('\0', ' '), 2U);
  EXPECT_EQ(text.GetIndexOfFirstChar(' ', 0), 1U);
  EXPECT_EQ(text.GetIndexOfFirstChar('#', 0), String::None);
  text.Assign(text.GetText(), 2);
  EXPECT_EQ(text, "a ");
  text.Assign("whole", ~0U);
  text.Append("r", ~0U);
  EXPECT_EQ(text, "wholer");
  EXPECT_EQ(String(static_cast<const char*>(nullptr)), "");
}

}  // namespace
