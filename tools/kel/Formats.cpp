// The table of formats, and what all of them share: the checks before, and the way to a terminal.

#include "Formats.h"

#include <unistd.h>

#include <algorithm>
#include <iostream>
#include <iterator>
#include <map>
#include <sstream>

#include "FormatWriters.h"
#include "Quoting.h"
#include "Text.h"

namespace {

// What in a path a format can't hold, or an empty text.
std::string AnyPath(const std::string&) { return ""; }

std::string OneLine(const std::string& path) {
  return path.find_first_of("\n\r") == std::string::npos ? "" : "a line end";
}

std::string OneWord(const std::string& path) {
  return path.find_first_of(" \t") == std::string::npos ? OneLine(path) : "a blank";
}

std::string MakeItem(const std::string& path) {
  return path.ends_with('\\') ? "a backslash at its end" : OneWord(path);
}

// A list is split at semicolons, but not while a bracket is open.
std::string CMakeItem(const std::string& path) {
  const auto count = [&](char c) { return std::count(path.begin(), path.end(), c); };
  if (count('[') != count(']')) return "a bracket without its partner";
  return path.ends_with('\\') ? "a backslash at its end" : "";
}

std::string Utf8(const std::string& path) {
  return Quoting::IsUtf8(path) ? "" : "bytes that are no UTF-8";
}

using Takes = bool (*)(const Source& source);
bool TakesAll(const Source&) { return true; }

struct Format {
  const char* name;
  void (*write)(std::ostream& output, const SourceList& list);
  Takes takes;           // the sources that it has room for
  const char* language;  // of those, if they are of one
  std::string (*fault)(const std::string& path);
  const char* help;
};
const Format kFormats[] = {
    {"list", WriteList, TakesAll, "", AnyPath, "A path on each line"},
    {"json", WriteJsonList, TakesAll, "", Utf8, "A document of sources and include directories"},
    {"f", WriteFileList, IsVerilog, "Verilog", OneLine, "A file list for Verilog tools"},
    {"verilator", WriteVerilator, IsVerilog, "Verilog", OneLine,
     "A file list with top and parameters, for Verilator"},
    {"ghdl", WriteGhdl, IsVhdl, "VHDL", AnyPath, "A shell script that analyses with GHDL"},
    {"edam", WriteEdam, TakesAll, "", Utf8, "A document for flow generators"},
    {"vhdl_ls", WriteVhdlLs, IsVhdl, "VHDL", Utf8, "The configuration of the VHDL language server"},
    {"tcl", WriteTcl, TakesAll, "", AnyPath, "A script that sets lists of sources and directories"},
    {"make", WriteMake, TakesAll, "", MakeItem, "Variables for a makefile to include"},
    {"cmake", WriteCMake, TakesAll, "", CMakeItem, "Variables for CMake to include"}};

const Format& FormatOf(const std::string& name) {
  return *std::find_if(std::begin(kFormats), std::end(kFormats),
                       [&](const Format& candidate) { return candidate.name == name; });
}

// Whoever asks for one language should know that the core has more.
bool HasRoom(const Format& format, const SourceList& list, bool isMeant) {
  const std::size_t all = list.sources.size();
  const auto taken = static_cast<std::size_t>(
      std::count_if(list.sources.begin(), list.sources.end(), format.takes));
  if (taken == all) return true;
  const std::string text = std::string("the format ") + format.name + " is for " + format.language +
                           " only and leaves out ";
  const std::string count = std::to_string(all);
  if (taken == 0) {
    Messages::Error(text + (all == 1 ? "the only source" : "all " + count + " sources"));
  } else if (!isMeant) {
    Messages::Warn(text + std::to_string(all - taken) + " of " + count + " sources");
  }
  return taken > 0;
}

bool CanHold(const Format& format, const std::string& path) {
  const std::string fault = format.fault(path);
  if (fault.empty()) return true;
  Messages::Error(std::string("the format ") + format.name + " can't hold " + fault +
                  ", which this path has: " + path);
  return false;
}

bool CanHoldPaths(const Format& format, const SourceList& list) {
  std::vector<std::string> paths;
  for (const Source& source : list.sources) {
    if (format.takes(source)) paths.push_back(source.path);
  }
  for (const Place& directory : list.includeDirectories) paths.push_back(directory.path);
  for (const Place& file : list.dataFiles) paths.push_back(file.path);
  bool isGood = true;
  for (const std::string& path : paths) {
    if (!CanHold(format, path)) isGood = false;
  }
  return isGood;
}

}  // namespace

Choices SourceFormats() { return ChoicesOf(kFormats); }

std::string OneStandard(const SourceList& list, const char* tool) {
  std::map<int, const Source*> newest;  // the first source of each standard, by its year
  for (const Source& source : list.sources) {
    if (source.standard.empty()) continue;
    const int year = std::stoi(source.standard);
    newest.try_emplace(year < 87 ? year + 100 : year, &source);
  }
  if (newest.empty()) return "";
  const Source& chosen = *newest.rbegin()->second;
  if (newest.size() > 1) {
    const Source& other = *newest.begin()->second;
    Messages::Warn(std::string(tool) + " takes one standard of VHDL for all sources: " +
                   chosen.standard + ", as " + chosen.key + " wants it, though " + other.key +
                   " wants " + other.standard + ". Choose with --vhdl-standard");
  }
  return chosen.standard;
}

Status WriteSources(const SourceList& list, const std::string& format, bool isMeant) {
  const Format& chosen = FormatOf(format);
  if (!HasRoom(chosen, list, isMeant) || !CanHoldPaths(chosen, list)) return StatusFindings;
  // A tool gets each byte of a name; a terminal must not obey one.
  if (::isatty(STDOUT_FILENO) == 0) {
    chosen.write(std::cout, list);
    return StatusClean;
  }
  std::stringstream lines;
  chosen.write(lines, list);
  for (std::string line; std::getline(lines, line);) std::cout << Printable(line) << '\n';
  return StatusClean;
}
