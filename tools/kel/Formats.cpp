// How sources are written for tools. Each format escapes names as its reader wants them: a path may
// hold any byte but NUL.

#include "Formats.h"

#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <iostream>
#include <iterator>
#include <sstream>
#include <string_view>

#include "Text.h"

namespace {

namespace fs = std::filesystem;

// As `Source` writes them.
const char* const kVhdl = "VHDL";
const char* const kVerilog = "Verilog";

// The text with a backslash in front of each of these characters.
std::string Backslashed(const std::string& text, std::string_view special) {
  std::string escaped;
  for (const char c : text) {
    if (special.find(c) != std::string_view::npos) escaped += '\\';
    escaped += c;
  }
  return escaped;
}

// Quotes only where they are needed, since people read these files too.
std::string ShellWord(const std::string& text) {
  const auto isPlain = [](char c) { return IsPlain(c, "_-./,:+@%"); };
  if (!text.empty() && std::all_of(text.begin(), text.end(), isPlain)) return text;
  std::string word = "'";
  for (const char c : text) word += c == '\'' ? std::string("'\\''") : std::string(1, c);
  return word + "'";
}

// A string with quotes. TOML takes what JSON does, but for one control character.
std::string TomlString(const std::string& text) {
  std::string quoted = Json(text).dump(-1, ' ', false, Json::error_handler_t::replace);
  for (std::size_t at; (at = quoted.find('\x7F')) != std::string::npos;) {
    quoted.replace(at, 1, "\\u007F");
  }
  return quoted;
}

// Braces would need no escapes, but can't hold a path with a brace that nothing closes.
std::string TclWord(const std::string& text) {
  std::string word = Backslashed(text, "\\\"$[]{}");
  for (std::size_t at; (at = word.find('\n')) != std::string::npos;) word.replace(at, 1, "\\n");
  return "\"" + word + "\"";
}

// A pattern that stands for this path alone.
// That configuration takes patterns, and a path may hold their characters.
std::string GlobLiteral(const std::string& path) {
  std::string pattern;
  for (const char c : path) {
    const bool special = std::string_view("*?[]").find(c) != std::string_view::npos;
    pattern += special ? std::string("[") + c + "]" : std::string(1, c);
  }
  return pattern;
}

// Through a table, so that a terminal is shown each name on one line.
void WriteList(std::ostream& output, const SourceList& list) {
  Table table;
  for (const Source& source : list.sources) table.Add({source.path});
  table.Write(output);
}

void WriteJsonList(std::ostream& output, const SourceList& list) {
  Json sources = Json::array();
  Json libraries = Json::array();
  for (const Source& source : list.sources) {
    sources.push_back(
        {{"path", source.path}, {"library", source.library}, {"language", source.language}});
    if (libraries.empty() || libraries.back() != source.library)
      libraries.push_back(source.library);
  }
  Json directories = Json::array();
  for (const IncludeDirectory& directory : list.includeDirectories) {
    directories.push_back(directory.path);
  }
  WriteJson({{"key", list.key},
             {"purpose", list.purpose},
             {"libraries", libraries},
             {"sources", sources},
             {"include_directories", directories}},
            output);
}

// Comments name the libraries, which the format can't say.
void WriteFileList(std::ostream& output, const SourceList& list) {
  const std::string_view special = " \t\\\"$";
  for (const IncludeDirectory& directory : list.includeDirectories) {
    output << "+incdir+" << Backslashed(directory.path, special) << '\n';
  }
  std::string library;
  for (const Source& source : list.sources) {
    if (source.language != kVerilog) continue;
    if (source.library != library) output << "// library " << source.library << '\n';
    library = source.library;
    output << Backslashed(source.path, special) << '\n';
  }
}

// GHDL takes VHDL alone. Each library is analysed in the order of its sources, into the current
// directory.
void WriteGhdl(std::ostream& output, const SourceList& list) {
  output << "#!/bin/sh\n# Analyses into the current directory; GHDL_FLAGS go to every call.\n"
            "set -e\n";
  for (const Source& source : list.sources) {
    if (source.language != kVhdl) continue;
    output << "ghdl -a $GHDL_FLAGS --work=" << ShellWord(source.library) << ' '
           << ShellWord(source.path) << '\n';
  }
}

Json EdamFile(const Source& source) {
  Json file = {{"name", source.path}};
  if (!source.language.empty()) {
    file["file_type"] = source.language == kVhdl ? "vhdlSource" : "verilogSource";
  }
  file["logical_name"] = source.library;
  return file;
}

// The files of an include directory, by name. One that can't be read is an error.
std::vector<std::string> FilesIn(const std::string& directory) {
  std::vector<std::string> files;
  std::error_code error;
  fs::directory_iterator entry(directory, error);
  while (!error && entry != fs::directory_iterator()) {
    std::error_code failure;
    const fs::file_type type = entry->status(failure).type();
    if (type == fs::file_type::regular) files.push_back(entry->path().filename());
    if (type == fs::file_type::none) error = failure;
    if (!error) entry.increment(error);
  }
  if (error) Messages::Error("Unable to list " + directory + "\n" + error.message());
  std::sort(files.begin(), files.end());
  return files;
}

// Include files are files of their own there, so the directories are listed.
void WriteEdam(std::ostream& output, const SourceList& list) {
  Json files = Json::array();
  for (const IncludeDirectory& directory : list.includeDirectories) {
    for (const std::string& name : FilesIn(directory.location)) {
      files.push_back({{"name", directory.path + "/" + name},
                       {"file_type", "verilogSource"},
                       {"is_include_file", true},
                       {"include_path", directory.path}});
    }
  }
  for (const Source& source : list.sources) files.push_back(EdamFile(source));
  const Json document = {{"version", "0.2.1"}, {"name", list.key}, {"files", files}};
  WriteDocument(output, document);
}

void WriteVhdlLs(std::ostream& output, const SourceList& list) {
  output << "[libraries]\n";
  std::string library;
  bool open = false;
  for (const Source& source : list.sources) {
    if (source.language != kVhdl) continue;
    if (!open || source.library != library) {
      output << (open ? "]\n" : "") << TomlString(source.library) << ".files = [\n";
    }
    library = source.library;
    open = true;
    output << "  " << TomlString(GlobLiteral(source.path)) << ",\n";
  }
  // A library whose sources stand in two places of the order would have two lists: the order says
  // each library once.
  if (open) output << "]\n";
}

// Only words and no calls, so that a tool may read it with `source` and do with it what it likes.
void WriteTcl(std::ostream& output, const SourceList& list) {
  output << "# Each source is a dict of library, language and path.\nset kel_sources {}\n";
  for (const Source& source : list.sources) {
    output << "lappend kel_sources [dict create library " << TclWord(source.library) << " language "
           << TclWord(source.language) << " path " << TclWord(source.path) << "]\n";
  }
  output << "set kel_include_directories {}\n";
  for (const IncludeDirectory& directory : list.includeDirectories) {
    output << "lappend kel_include_directories " << TclWord(directory.path) << '\n';
  }
}

struct Format {
  const char* name;
  void (*write)(std::ostream& output, const SourceList& list);
  const char* language;  // the only one that it has room for, if there is one
  const char* help;
};
const Format kFormats[] = {
    {"list", WriteList, nullptr, "A path on each line"},
    {"json", WriteJsonList, nullptr, "A document of sources and include directories"},
    {"f", WriteFileList, kVerilog, "A file list for Verilog tools"},
    {"ghdl", WriteGhdl, kVhdl, "A shell script that analyses with GHDL"},
    {"edam", WriteEdam, nullptr, "A document for flow generators"},
    {"vhdl_ls", WriteVhdlLs, kVhdl, "The configuration of the VHDL language server"},
    {"tcl", WriteTcl, nullptr, "A script that sets lists of sources and directories"}};

// Whoever asks for one language should know that the core has more.
void NoteWhatIsLeftOut(const Format& format, const SourceList& list) {
  if (format.language == nullptr) return;
  const auto left =
      std::count_if(list.sources.begin(), list.sources.end(),
                    [&](const Source& source) { return source.language != format.language; });
  if (left == 0) return;
  Messages::Note(std::string("the format ") + format.name + " is for " + format.language +
                 " only and leaves out " + std::to_string(left) + " of " +
                 std::to_string(list.sources.size()) + " sources");
}

}  // namespace

Choices SourceFormats() { return ChoicesOf(kFormats); }

void WriteSources(const SourceList& list, const std::string& format) {
  const auto* const chosen =
      std::find_if(std::begin(kFormats), std::end(kFormats),
                   [&](const Format& candidate) { return candidate.name == format; });
  if (chosen == std::end(kFormats)) return;
  NoteWhatIsLeftOut(*chosen, list);
  // A tool gets each byte of a name; a terminal must not obey one.
  if (::isatty(STDOUT_FILENO) == 0) return chosen->write(std::cout, list);
  std::stringstream lines;
  chosen->write(lines, list);
  for (std::string line; std::getline(lines, line);) std::cout << Printable(line) << '\n';
}
