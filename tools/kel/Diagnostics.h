#ifndef KEL_DIAGNOSTICS_H
#define KEL_DIAGNOSTICS_H

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Tarvo_KelDiagnostic.h"

// All codes that a diagnostic may have, in the order of the alphabet.
const std::vector<Tarvo::KelDiagnosticCode>& Codes();

// "note", "warning" or "error", as a diagnostic's line and all formats have it.
const char* SeverityWord(Tarvo::KelDiagnostic::Severity severity);

// The lines that diagnostics are about. Files are read when a line is asked for; what can't be read
// has no lines.
class FileLines {
 public:
  // The line that a place is in, without its end and a byte order mark; none for a place without a
  // line. The view is good until a line of another file is asked for.
  std::optional<std::string_view> Find(const Tarvo::KelPlace& place);

 private:
  std::string file;
  std::vector<std::string> lines;
};

// How diagnostics are written for people:
//
//     FILE:LINE:COLUMN: SEVERITY[CODE]: TEXT
//       14 | the line
//          |     ^^^^
//       help: what to do
//     FILE:LINE: note: what is there
//
// Columns count cells. What a place doesn't have is left out, and so is what isn't wanted.
class DiagnosticWriter {
 public:
  std::string relativeTo;  // a directory, or nothing
  bool withColour = false;
  bool withRelated = false;
  bool withHelp = false;
  std::size_t excerptWidth = 0;  // cells; 0 for no excerpts

  std::string Write(const Tarvo::KelDiagnostic& diagnostic);

 private:
  std::string Where(const Tarvo::KelPlace& place);
  std::string Shown(const Tarvo::KelPlace& place);
  std::string Related(const Tarvo::KelRelatedPlace& related);

  FileLines lines;
};

// The first words of a text, in the colour of its severity.
std::string Coloured(const std::string& words, Tarvo::KelDiagnostic::Severity severity);

// Whether texts for this file are coloured, by the call's choice.
bool WantsColour(const std::string& choice, int descriptor);

#endif
