// Formats that are programs: for the shell, Tcl, make and CMake.

#include <algorithm>
#include <functional>

#include "FormatWriters.h"
#include "Quoting.h"

namespace {

using Quoting::CMakeWord;
using Quoting::MakeWord;
using Quoting::ShellWord;
using Quoting::TclWord;

// Neighbours of one library are analysed by one call, since each is a process of its own. A call
// stays below what a system takes for one.
constexpr std::size_t kLongestCall = 100'000;  // bytes

class GhdlCalls {
 public:
  GhdlCalls(std::ostream& theOutput, std::string theFlags)
      : output(theOutput), flags(std::move(theFlags)) {}

  void Analyse(const Source& source) {
    const std::string path = ShellWord(source.path);
    if (source.library != library || size + path.size() > kLongestCall) Finish();
    library = source.library;
    size += path.size() + 1;
    paths.push_back(path);
  }

  // A call with one source stays on one line.
  void Finish() {
    if (paths.empty()) return;
    output << "ghdl -a " << flags << "--work=" << ShellWord(library);
    for (const std::string& path : paths) output << (paths.size() > 1 ? " \\\n  " : " ") << path;
    output << '\n';
    paths.clear();
    size = 0;
  }

 private:
  std::ostream& output;
  std::string flags;
  std::string library;
  std::vector<std::string> paths;
  std::size_t size = 0;
};

void WriteGhdlRun(std::ostream& output, const SourceList& list, const std::string& flags) {
  output << "ghdl --elab-run " << flags << "--work=" << ShellWord(list.topLibrary) << ' '
         << ShellWord(list.top);
  for (const Setting& parameter : list.parameters) {
    output << ' ' << ShellWord("-g" + parameter.name + "=" + parameter.value);
  }
  output << " \"$@\"\n";
}

using Words = std::vector<std::string>;

// Writes a variable and its values.
using WriteVariable = std::function<void(const std::string& name, const Words& values)>;

Words PathsOf(const SourceList& list, const std::function<bool(const Source&)>& isMeant) {
  Words paths;
  for (const Source& source : list.sources) {
    if (isMeant(source)) paths.push_back(source.path);
  }
  return paths;
}

Words PathsOf(const std::vector<Place>& places) {
  Words paths;
  for (const Place& place : places) paths.push_back(place.path);
  return paths;
}

// The variables of the formats that have nothing else.
void WriteVariables(const SourceList& list, const WriteVariable& write) {
  const std::vector<Library> libraries = LibrariesOf(list);
  Words names;
  for (const Library& library : libraries) names.push_back(library.name);
  Words parameters;
  for (const Setting& parameter : list.parameters) {
    parameters.push_back(parameter.name + "=" + parameter.value);
  }
  write("KEL_TOP", {list.top});
  write("KEL_TOP_LIBRARY", {list.topLibrary});
  write("KEL_PARAMETERS", parameters);
  write("KEL_SOURCES", PathsOf(list, [](const Source&) { return true; }));
  write("KEL_VHDL_SOURCES", PathsOf(list, IsVhdl));
  write("KEL_VERILOG_SOURCES", PathsOf(list, IsVerilog));
  write("KEL_INCLUDE_DIRECTORIES", PathsOf(list.includeDirectories));
  write("KEL_DATA_FILES", PathsOf(list.dataFiles));
  write("KEL_LIBRARIES", names);
  for (const Library& library : libraries) {
    Words paths;
    for (const Source* const source : library.sources) paths.push_back(source->path);
    write("KEL_SOURCES_" + library.name, paths);
  }
}

}  // namespace

// GHDL takes VHDL alone. What users state of their own counts more, since it stands behind.
void WriteGhdl(std::ostream& output, const SourceList& list) {
  output << "#!/bin/sh\n# Analyses into the current directory; GHDL_FLAGS go to every call.\n";
  if (list.hasRun) output << "# The words of this script go to the run, such as --stop-time=1us.\n";
  output << "set -e\n";
  const std::string standard = OneStandard(list, "GHDL");
  const std::string flags = (standard.empty() ? "" : "--std=" + standard + " ") + "$GHDL_FLAGS ";
  GhdlCalls calls(output, flags);
  for (const Source& source : list.sources) {
    if (IsVhdl(source)) calls.Analyse(source);
  }
  calls.Finish();
  if (list.hasRun) WriteGhdlRun(output, list, flags);
}

// Only words and no calls, so that a tool may read it with `source` and do with it what it likes.
void WriteTcl(std::ostream& output, const SourceList& list) {
  output << "# Each source is a dict of library, language and path.\nset kel_sources {}\n";
  for (const Source& source : list.sources) {
    output << "lappend kel_sources [dict create library " << TclWord(source.library) << " language "
           << TclWord(source.language) << " path " << TclWord(source.path) << "]\n";
  }
  output << "set kel_include_directories {}\n";
  for (const Place& directory : list.includeDirectories) {
    output << "lappend kel_include_directories " << TclWord(directory.path) << '\n';
  }
  if (!list.dataFiles.empty()) output << "set kel_data_files {}\n";
  for (const Place& file : list.dataFiles) {
    output << "lappend kel_data_files " << TclWord(file.path) << '\n';
  }
}

void WriteMake(std::ostream& output, const SourceList& list) {
  WriteVariables(list, [&](const std::string& name, const Words& values) {
    output << name << " :=";
    for (const std::string& value : values) output << " \\\n  " << MakeWord(value);
    output << '\n';
  });
}

void WriteCMake(std::ostream& output, const SourceList& list) {
  WriteVariables(list, [&](const std::string& name, const Words& values) {
    output << "set(" << name;
    for (const std::string& value : values) output << "\n  " << CMakeWord(value);
    output << ")\n";
  });
}
