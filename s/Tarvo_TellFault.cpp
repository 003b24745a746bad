// A comment begins at the first "#" of a line, so a value that has one is cut without a message.

#include "Tarvo_TellFault.h"

#include <cctype>

namespace Tarvo {

namespace {

using Diagnosis::Say;
using Text = std::string_view;

bool IsOneOf(char c, Text characters) { return characters.find(c) != Text::npos; }

// Letters beyond ASCII count as such: their bytes are.
bool IsWord(char c) {
  const auto byte = static_cast<unsigned char>(c);
  return std::isalnum(byte) != 0 || c == '_' || byte >= 0x80;
}

// People write a comment as "# text" or "#### text". So one that goes on without a blank is none,
// and neither is a lone "#", as in "C#".
bool IsText(Text comment) { return comment.size() == 1 || !IsOneOf(comment[1], " \t#"); }

// What would close the quote or bracket that a line has open; 0 if none is. A quote within a word
// is an apostrophe.
char FindOpen(Text line) {
  char open = 0;
  char before = ' ';
  for (const char c : line) {
    if (open != 0) {
      if (c == open) open = 0;
    } else if (IsOneOf(c, "([")) {
      open = c == '(' ? ')' : ']';
    } else if (IsOneOf(c, "\"'") && IsOneOf(before, " =,")) {
      open = c;
    }
    before = c;
  }
  return open;
}

bool IsWithin(Text line, Text comment) {
  const char open = FindOpen(line);
  return open != 0 && IsOneOf(open, comment);
}

// A "#" behind a blank begins a comment for people too.
bool IsBehindWord(Text line, Text comment) {
  return line.data() + line.size() == comment.data() && IsWord(line.back()) && IsText(comment);
}

}  // namespace

KelDiagnostic TellFault(const KelDiagnosticCode& code, const FileScanner& lines,
                        const LineFault& fault) {
  const Text comment = lines.GetComment();
  const char* hint = "";
  if (!comment.empty() && fault.isOpen) {
    hint = "'#' begins a comment, in quotes too";
  } else if (!comment.empty() && fault.where.empty() && IsText(comment)) {
    hint = "'#' begins a comment, wherever it stands";
  }
  return Diagnosis::At(code, SpanOf(lines, fault.where), fault.text, hint);
}

void TellCut(const FileScanner& lines, Text line) {
  const Text comment = lines.GetComment();
  if (comment.empty() || line.empty()) return;
  const bool isWithin = IsWithin(line, comment);
  if (!isWithin && !IsBehindWord(line, comment)) return;
  Diagnosis::Add([&] {
    return Diagnosis::At(
        Codes::kCommentInValue, SpanOf(lines, comment.substr(0, 1)),
        Say({"'#' begins a comment, ",
             isWithin ? "in quotes and brackets too" : "wherever it stands", "; the line ends at '",
             line.substr(line.rfind(' ') + 1), "'"}),
        "no value can have a '#'; write a number in decimal, and a comment behind a blank");
  });
}

}  // namespace Tarvo
