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
      EXPECT_EQ(std::tie(a) < std::tie(b), left < right);
      EXPECT_EQ(std::hash<String>()(a) == std::hash<String>()(b), left == right);
      EXPECT_EQ(a.Compare(b, String::CompareExact) < 0, left < right);
      if (left.find('\0') == std::string_view::npos) {
        EXPECT_EQ(left.data() == b, left == right);
      }
    }
  }
}

TEST(StringBase, FoldsOnlyAsciiLetters) {
  struct Row {
    const char* left;
    const char* right;
    int sign;
  };
  const Row rows[] = {
      {"Verilog", "VERILOG", 0}, {"", "", 0},    {"all", "al", 1}, {"al", "ALL", -1}, {"b", "A", 1},
      {"\xC4", "\xE4", -1},      {"[", "{", -1}, {"@", "`", -1}};
  for (const Row& row : rows) {
    const int result = String(row.left).Compare(row.right, String::CompareIgnoreCase);
    EXPECT_EQ((result > 0) - (result < 0), row.sign) << row.left << " against " << row.right;
  }
}

TEST(StringBase, ExtractStopsAtTheEnd) {
  struct Row {
    unsigned first;
    unsigned last;
    const char* result;
  };
  const Row rows[] = {{0, 0, "a"}, {1, 2, "bc"}, {2, 3, "c"},     {3, 3, ""},    {4, 9, ""},
                      {2, 1, ""},  {1, 0, ""},   {0, ~0U, "abc"}, {1, ~0U, "bc"}};
  for (const Row& row : rows) {
    EXPECT_EQ(String("abc").Extract({row.first, row.last}), row.result) << row.first << row.last;
  }
}

TEST(StringBase, ReadsNumbersThatFit) {
  struct Row {
    const char* text;
    Port_Range range;
    bool fits;
    unsigned value;
  };
  const Row rows[] = {{"x12y", {1, 2}, true, 12},
                      {"007", {0, 9}, true, 7},
                      {"4294967295", {0, 9}, true, 4294967295U},
                      {"4294967296", {0, 9}, false, 99},
                      {"99999999999999999999999", {0, 99}, false, 99},
                      {"12x", {0, 2}, false, 99},
                      {"-1", {0, 1}, false, 99},
                      {"+1", {0, 1}, false, 99},
                      {" 1", {0, 1}, false, 99},
                      {"12", {1, 0}, false, 99},
                      {"12", {2, 2}, false, 99}};
  for (const Row& row : rows) {
    unsigned value = 99;
    EXPECT_EQ(String(row.text).GetUINT32(row.range, &value), row.fits) << row.text;
    EXPECT_EQ(value, row.value) << row.text;
  }
}

TEST(StringBase, TrimsTheEndsThatTheTypeNames) {
  struct Row {
    const char* text;
    String::TrimType type;
    const char* result;
  };
  const Row rows[] = {{" \ta b\t ", String::TrimBoth, "a b"}, {" a ", String::TrimStart, "a "},
                      {" a ", String::TrimEnd, " a"},         {"\t \t", String::TrimBoth, ""},
                      {"  ", String::TrimStart, ""},          {"", String::TrimBoth, ""},
                      {"a", String::TrimBoth, "a"},           {"\na\n", String::TrimBoth, "\na\n"}};
  for (const Row& row : rows) {
    String text = row.text;
    text.Trim(" \t", row.type);
    EXPECT_EQ(text, row.result) << row.text;
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

TEST(StringBase, FormatsTextOfAnyLength) {
  const std::string longText(100000, 'x');
  EXPECT_EQ(String::doFormat("%s_%02d.%u\n", longText.c_str(), 5, ~0U).View(),
            longText + "_05.4294967295\n");
  EXPECT_EQ(String::doFormat("%s", ""), "");
}

}  // namespace
