// Formats that are JSON.

#include <algorithm>
#include <filesystem>
#include <map>

#include "FormatWriters.h"
#include "IncludeFiles.h"
#include "Text.h"

namespace {

std::string ExtensionOf(const std::string& path) {
  return std::filesystem::path(path).extension().string();
}

// Readers know no VHDL of 2002 and drop what they don't know, but all of it is in the next one.
const std::map<std::string, const char*> kVhdlTypes = {{"", "vhdlSource"},
                                                       {"93", "vhdlSource-93"},
                                                       {"02", "vhdlSource-2008"},
                                                       {"08", "vhdlSource-2008"},
                                                       {"19", "vhdlSource-2019"}};

std::string EdamType(const Source& source) {
  if (IsVhdl(source)) return kVhdlTypes.at(source.standard);
  if (!IsVerilog(source)) return "user";
  return source.language == "Verilog" ? "verilogSource" : "systemVerilogSource";
}

Json EdamIncludeFile(const Place& directory, const std::string& name) {
  const std::string extension = ExtensionOf(name);
  const bool isSystem = extension == ".sv" || extension == ".svh";
  return {{"name", directory.path + "/" + name},
          {"file_type", isSystem ? "systemVerilogSource" : "verilogSource"},
          {"is_include_file", true},
          {"include_path", directory.path}};
}

// What a constraint is, its extension tells; all other data is for whoever knows it.
Json EdamDataFile(const Place& file) {
  static const std::map<std::string, const char*> types = {
      {".sdc", "SDC"}, {".xdc", "xdc"}, {".pcf", "PCF"}, {".lpf", "LPF"}, {".tcl", "tclSource"}};
  const auto type = types.find(ExtensionOf(file.path));
  return {{"name", file.path}, {"file_type", type == types.end() ? "user" : type->second}};
}

// Include files are files of their own there, so the directories are listed.
Json EdamFiles(const SourceList& list) {
  Json files = Json::array();
  for (const Place& directory : list.includeDirectories) {
    for (const std::string& name : FilesBelow(directory.location)) {
      files.push_back(EdamIncludeFile(directory, name));
    }
  }
  for (const Source& source : list.sources) {
    files.push_back(
        {{"name", source.path}, {"file_type", EdamType(source)}, {"logical_name", source.library}});
  }
  for (const Place& file : list.dataFiles) files.push_back(EdamDataFile(file));
  return files;
}

// A tool takes tops of its own language. Without one, the top is nearly always of the language of
// the main core's last source.
bool IsTopVhdl(const SourceList& list) {
  if (!list.tool.empty()) return list.tool == "ghdl";
  const auto last =
      std::find_if(list.sources.rbegin(), list.sources.rend(),
                   [&](const Source& source) { return source.key == list.keys.front(); });
  return last != list.sources.rend() && IsVhdl(*last);
}

// A VHDL unit is found by its library's name, which a user may have given already.
std::string EdamTop(const SourceList& list, bool isVhdl) {
  const bool needsLibrary = isVhdl && list.top.find('.') == std::string::npos;
  return needsLibrary ? list.topLibrary + "." + list.top : list.top;
}

Json EdamParameter(const std::string& value, bool isVhdl) {
  const char* const type = isVhdl ? "generic" : "vlogparam";
  const std::size_t digits = value.starts_with('-') ? 1 : 0;
  const bool isNumber = value.size() > digits && value.size() < 19 &&
                        value.find_first_not_of("0123456789", digits) == std::string::npos;
  const std::string lower = Lower(value);
  if (isNumber) return {{"datatype", "int"}, {"default", std::stoll(value)}, {"paramtype", type}};
  if (lower == "true" || lower == "false") {
    return {{"datatype", "bool"}, {"default", lower == "true"}, {"paramtype", type}};
  }
  return {{"datatype", "str"}, {"default", value}, {"paramtype", type}};
}

// What a flow of that tool needs beside the files: GHDL is given generics only so, and the others
// are not told that a source is SystemVerilog or that it brings its own clock.
Json EdamFlowOptions(const SourceList& list) {
  Json options = {{"tool", list.tool}};
  for (const Setting& parameter : list.parameters) {
    if (list.tool != "ghdl") break;
    options["sim_options"].push_back("-g" + parameter.name + "=" + parameter.value);
  }
  if (list.tool == "icarus") options["iverilog_options"] = {"-g2012"};
  if (list.tool == "verilator") {
    options["mode"] = list.purpose == "simulation" ? "binary" : "lint-only";
  }
  return options;
}

Json PathsOf(const std::vector<Place>& places) {
  Json paths = Json::array();
  for (const Place& place : places) paths.push_back(place.path);
  return paths;
}

}  // namespace

void WriteJsonList(std::ostream& output, const SourceList& list) {
  Json sources = Json::array();
  for (const Source& source : list.sources) {
    sources.push_back({{"path", source.path},
                       {"library", source.key},
                       {"logical_name", source.library},
                       {"language", source.language},
                       {"standard", source.standard}});
  }
  Json parameters = Json::object();
  for (const Setting& parameter : list.parameters) parameters[parameter.name] = parameter.value;
  WriteJson({{"key", list.keys.front()},
             {"keys", list.keys},
             {"purpose", list.purpose},
             {"top", list.top},
             {"top_library", list.topLibrary},
             {"parameters", parameters},
             {"libraries", CoresOf(list)},
             {"sources", sources},
             {"include_directories", PathsOf(list.includeDirectories)},
             {"data_files", PathsOf(list.dataFiles)}},
            output);
}

void WriteEdam(std::ostream& output, const SourceList& list) {
  const bool isVhdl = IsTopVhdl(list);
  Json parameters = Json::object();
  for (const Setting& parameter : list.parameters) {
    parameters[parameter.name] = EdamParameter(parameter.value, isVhdl);
  }
  Json document = {{"version", "0.2.1"},
                   {"name", list.keys.front()},
                   {"toplevel", EdamTop(list, isVhdl)},
                   {"parameters", parameters},
                   {"files", EdamFiles(list)}};
  if (!list.tool.empty()) document["flow_options"] = EdamFlowOptions(list);
  WriteDocument(output, document);
}
