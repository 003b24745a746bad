// Formats that are lists of files: for people, for Verilog tools and for an editor.

#include <algorithm>
#include <map>

#include "FormatWriters.h"
#include "Quoting.h"

namespace {

using Quoting::FileListWord;
using Quoting::TomlString;

// Comments name the libraries, which a file list can't say.
void WriteVerilogFiles(std::ostream& output, const SourceList& list) {
  for (const Place& directory : list.includeDirectories) {
    output << "+incdir+" << FileListWord(directory.path) << '\n';
  }
  std::string library;
  for (const Source& source : list.sources) {
    if (!IsVerilog(source)) continue;
    if (source.library != library) output << "// library " << source.library << '\n';
    library = source.library;
    output << FileListWord(source.path) << '\n';
  }
}

// A number as it is, and any other text as a string.
std::string VerilogValue(const std::string& value) {
  const bool isNumber =
      !value.empty() &&
      value.find_first_not_of("0123456789abcdefABCDEFxXzZ_'.+-hHoOsS?") == std::string::npos &&
      value.find_first_of("0123456789'") != std::string::npos;
  return isNumber ? value : "\"" + Quoting::Backslashed(value, "\\\"") + "\"";
}

const std::map<std::string, const char*> kYears = {
    {"93", "1993"}, {"02", "2008"}, {"08", "2008"}, {"19", "2019"}};

}  // namespace

// Through a table, so that a terminal is shown each name on one line.
void WriteList(std::ostream& output, const SourceList& list) {
  Table table;
  for (const Source& source : list.sources) table.Add({source.path});
  table.Write(output);
}

// The tools that read this have no common words for all that, so it is in comments for people.
void WriteFileList(std::ostream& output, const SourceList& list) {
  if (list.isTopGiven) output << "// top " << list.top << '\n';
  const bool isSystem =
      std::any_of(list.sources.begin(), list.sources.end(),
                  [](const Source& source) { return source.language == "SystemVerilog"; });
  if (isSystem) output << "// SystemVerilog, for which some tools want -g2012 or -sv\n";
  WriteVerilogFiles(output, list);
}

void WriteVerilator(std::ostream& output, const SourceList& list) {
  output << "--top-module " << list.top << '\n';
  for (const Setting& parameter : list.parameters) {
    output << FileListWord("-G" + parameter.name + "=" + VerilogValue(parameter.value)) << '\n';
  }
  WriteVerilogFiles(output, list);
}

// It knows no VHDL of 2002, but all of that is in the next one.
void WriteVhdlLs(std::ostream& output, const SourceList& list) {
  const std::string standard = OneStandard(list, "the VHDL language server");
  if (!standard.empty()) output << "standard = \"" << kYears.at(standard) << "\"\n";
  output << "[libraries]\n";
  for (Library& library : LibrariesOf(list)) {
    std::erase_if(library.sources, [](const Source* source) { return !IsVhdl(*source); });
    if (library.sources.empty()) continue;
    output << TomlString(library.name) << ".files = [\n";
    for (const Source* const source : library.sources) {
      output << "  " << TomlString(Quoting::GlobLiteral(source->path)) << ",\n";
    }
    output << "]\n";
  }
}
