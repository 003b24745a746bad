// Ranges as descriptions write them. The reader is lenient on purpose: what it gives is for a
// checker, which must not find fault with what some tool understands.

#include "Tarvo_RangeText.h"

#include <algorithm>
#include <charconv>

namespace Tarvo {

namespace {

using Text = std::string_view;

constexpr std::string_view kBlanks = " \t";
// So that no file can use up the stack.
constexpr int kDeepestBracket = 50;

bool IsDigit(char c) { return c >= '0' && c <= '9'; }

bool IsWordChar(char c) {
  return IsDigit(c) || (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_' || c == '.';
}

std::string_view Trim(std::string_view text) {
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kBlanks) + 1 - first);
}

std::string_view Unquoted(std::string_view text) {
  const bool isQuoted = text.size() > 1 && text.front() == text.back() &&
                        (text.front() == '"' || text.front() == '\'');
  return isQuoted ? text.substr(1, text.size() - 2) : text;
}

// Whether brackets close, and no list of two or more dots stands for a range.
bool IsPlausible(std::string_view text) {
  int depth = 0;
  for (const char c : text) {
    if (c == '(' || c == '[') ++depth;
    if (c == ')' || c == ']') --depth;
    if (depth < 0) return false;
  }
  return depth == 0 && text.find("..") == std::string_view::npos;
}

// Passes over an expression:
//     sum = product { (+ | -) product }     product = factor { (* | / | %) factor }
//     factor = [-] (WORD | "(" sum ")")
class Expression {
 public:
  Expression(std::string_view text, RangeText& range) : rest(text), result(range) {}

  // What it passed over; empty if there is none.
  std::string_view Read() {
    const std::string_view start = rest;
    if (!PassList("+-", [&] { return PassProduct(); })) return {};
    return Trim(start.substr(0, start.size() - rest.size()));
  }
  // Passes over that character. False if it is not the next one.
  bool Pass(char c) {
    PassBlanks();
    if (rest.empty() || rest.front() != c) return false;
    rest.remove_prefix(1);
    return true;
  }
  bool IsAtEnd() {
    PassBlanks();
    return rest.empty();
  }

 private:
  void PassBlanks() { rest.remove_prefix(std::min(rest.find_first_not_of(kBlanks), rest.size())); }

  template <class Part>
  bool PassList(std::string_view operators, const Part& part) {
    while (part()) {
      PassBlanks();
      if (rest.empty() || operators.find(rest.front()) == std::string_view::npos) return true;
      rest.remove_prefix(1);
    }
    return false;
  }
  bool PassProduct() {
    return PassList("*/%", [&] { return PassFactor(); });
  }
  // A sign may stand before a bracket too.
  bool PassFactor() {
    Pass('-');
    if (!Pass('(')) return PassWord();
    if (++depth > kDeepestBracket) return false;
    const bool isClosed = PassList("+-", [&] { return PassProduct(); }) && Pass(')');
    --depth;
    return isClosed;
  }
  bool PassWord() {
    PassBlanks();
    const auto* const end = std::find_if_not(rest.begin(), rest.end(), IsWordChar);
    const std::string_view word = rest.substr(0, static_cast<std::size_t>(end - rest.begin()));
    rest.remove_prefix(word.size());
    // What begins with a digit is a number, whatever follows.
    if (!word.empty() && !IsDigit(word.front())) result.names.push_back(word);
    return !word.empty();
  }

  std::string_view rest;
  RangeText& result;
  int depth = 0;
};

// LOW:HIGH, or a single value where that is enough.
bool ReadItem(Expression& expression, bool isPair, RangeText& range) {
  RangeText::Item item;
  item.low = expression.Read();
  if (item.low.empty()) return false;
  item.high = item.low;
  if (expression.Pass(':')) {
    item.high = expression.Read();
  } else if (isPair) {
    return false;
  }
  range.items.push_back(item);
  return !item.high.empty();
}

}  // namespace

std::optional<RangeText> ReadVector(std::string_view text) {
  RangeText range;
  Expression expression(text, range);
  const bool isRead = expression.Pass('[') && ReadItem(expression, true, range) &&
                      expression.Pass(']') && expression.IsAtEnd();
  if (isRead) return range;
  // What the grammar doesn't cover, as a call of a function, may be good for a tool that knows
  // more. Only what is surely wrong is told.
  const std::size_t colon = text.find(':');
  const bool isFramed = text.size() > 4 && text.front() == '[' && text.back() == ']' && colon > 1 &&
                        colon + 2 < text.size() && text.find(':', colon + 1) == Text::npos;
  return isFramed && IsPlausible(text) ? std::optional(RangeText()) : std::nullopt;
}

std::optional<RangeText> ReadRange(std::string_view text) {
  RangeText range;
  Expression expression(text, range);
  bool isRead = expression.Pass('(');
  do {
    isRead = isRead && ReadItem(expression, false, range);
  } while (isRead && expression.Pass(','));
  if (isRead && expression.Pass(')') && expression.IsAtEnd()) return range;
  const bool isFramed = text.size() > 2 && text.front() == '(' && text.back() == ')';
  return isFramed && IsPlausible(text) ? std::optional(RangeText()) : std::nullopt;
}

std::optional<long long> ReadNumber(std::string_view text) {
  const bool isHex = text.substr(0, 2) == "0x" || text.substr(0, 2) == "0X";
  if (isHex) text.remove_prefix(2);
  long long number = 0;
  // The whole text or nothing.
  const auto [end, error] =
      std::from_chars(text.data(), text.data() + text.size(), number, isHex ? 16 : 10);
  const bool isRead = error == std::errc() && end == text.data() + text.size() && !text.empty();
  return isRead ? std::optional(number) : std::nullopt;
}

std::vector<std::string_view> ReadValues(std::string_view text) {
  std::vector<std::string_view> words;
  if (text.size() < 2 || text.front() != '(' || text.back() != ')') return words;
  text = text.substr(1, text.size() - 2);
  // Both separators are in use. What stands behind "=" or ":" is the value's name for people.
  const char separator = text.find(';') == std::string_view::npos ? ',' : ';';
  while (!text.empty()) {
    const std::string_view part = text.substr(0, text.find(separator));
    text.remove_prefix(std::min(part.size() + 1, text.size()));
    const std::string_view word = Unquoted(Trim(part.substr(0, part.find_first_of(":="))));
    if (word.empty() || !std::all_of(word.begin(), word.end(), IsWordChar)) return {};
    words.push_back(word);
  }
  return words;
}

}  // namespace Tarvo
