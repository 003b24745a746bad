// A diagnostic is written as compilers write theirs, so that editors find the place.

#include "Diagnostics.h"

#include <unistd.h>

#include <array>
#include <cstdlib>
#include <fstream>

#include "Tarvo_KelChecker.h"
#include "Text.h"

using Tarvo::KelDiagnostic;
using Tarvo::KelPlace;
using Tarvo::KelRelatedPlace;

const std::vector<Tarvo::KelDiagnosticCode>& Codes() {
  static const std::vector<Tarvo::KelDiagnosticCode> codes = Tarvo::KelChecker::ListCodes();
  return codes;
}

const char* SeverityWord(KelDiagnostic::Severity severity) {
  constexpr std::array words = {"note", "warning", "error"};
  return words.at(severity);
}

std::optional<std::string_view> FileLines::Find(const KelPlace& place) {
  if (place.line == 0) return std::nullopt;
  if (Text(place.file) != file) {
    file = Text(place.file);
    lines.clear();
    std::ifstream stream(file, std::ios::binary);
    for (std::string line; std::getline(stream, line);) lines.push_back(line);
    // A byte order mark counts for no column.
    const bool isMarked = !lines.empty() && lines[0].starts_with("\xEF\xBB\xBF");
    if (isMarked) lines[0].erase(0, 3);
  }
  if (place.line > lines.size()) return std::nullopt;
  std::string_view line = lines[place.line - 1];
  if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
  return line;
}

// A column that the file no longer has is left out.
std::string DiagnosticWriter::Where(const KelPlace& place) {
  std::string where = Printable(RelativeTo(relativeTo, place.file));
  if (place.line > 0) where += ":" + std::to_string(place.line);
  const std::optional<std::string_view> line = lines.Find(place);
  if (place.column == 0 || !line || place.column > line->size() + 1) return where;
  return where + ":" + std::to_string(CountCells(line->substr(0, place.column - 1)) + 1);
}

std::string DiagnosticWriter::Shown(const KelPlace& place) {
  const std::optional<std::string_view> line = lines.Find(place);
  if (excerptWidth == 0 || !line || place.column > line->size() + 1) return "";
  const std::string number = std::to_string(place.line);
  const std::string head = "  " + number + " | ";
  const std::size_t width = excerptWidth - head.size();
  const std::size_t start = place.column > 0 ? place.column - 1 : 0;
  const Excerpt excerpt = MakeExcerpt(*line, start, place.length, width);
  std::string shown = head + excerpt.line + '\n';
  if (place.column == 0) return shown;
  return shown + std::string(number.size() + 2, ' ') + " | " + excerpt.marks + '\n';
}

// A text that ends in "from here" is completed by the place.
std::string DiagnosticWriter::Related(const KelRelatedPlace& related) {
  const std::string where = Where(related.place);
  const std::string note = withColour ? Coloured("note: ", KelDiagnostic::Note) : "note: ";
  std::string text = Printable(related.text.View());
  // So that a line begins as compilers write such notes.
  const bool isFrom = text.ends_with(" from here");
  if (isFrom) text.replace(text.size() - 4, 4, where);
  const std::string excerpt = related.place.column > 0 ? Shown(related.place) : "";
  return (isFrom ? "" : where + ": ") + note + text + '\n' + excerpt;
}

std::string DiagnosticWriter::Write(const KelDiagnostic& diagnostic) {
  const std::string where = Where(diagnostic.place);
  const std::string lead = std::string(SeverityWord(diagnostic.severity)) + "[" +
                           Printable(diagnostic.code.View()) + "]: ";
  std::string written = (where.empty() ? "" : where + ": ") +
                        (withColour ? Coloured(lead, diagnostic.severity) : lead) +
                        Printable(diagnostic.text.View()) + '\n' + Shown(diagnostic.place);
  if (withHelp && diagnostic.hint.GetLength() > 0) {
    written += "  help: " + Printable(diagnostic.hint.View()) + '\n';
  }
  if (!withRelated) return written;
  for (const KelRelatedPlace& related : diagnostic.related) written += Related(related);
  return written;
}

std::string Coloured(const std::string& words, KelDiagnostic::Severity severity) {
  constexpr std::array colours = {"\x1B[1;36m", "\x1B[1;33m", "\x1B[1;31m"};
  return colours.at(severity) + words + "\x1B[0m";
}

bool WantsColour(const std::string& choice, int descriptor) {
  if (choice != "auto") return choice == "always";
  // As many programs do: NO_COLOR with any text, or a terminal without colours.
  const char* const refused = std::getenv("NO_COLOR");
  const char* const terminal = std::getenv("TERM");
  const bool isRefused = refused != nullptr && *refused != 0;
  const bool isDumb = terminal != nullptr && std::string(terminal) == "dumb";
  return ::isatty(descriptor) != 0 && !isRefused && !isDumb;
}
