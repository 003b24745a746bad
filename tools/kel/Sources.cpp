#include <filesystem>
#include <memory>

#include "Formats.h"
#include "Messages.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_LDXParser.h"
#include "Text.h"
#include "Verbs.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Key;
using Tarvo::KelIP;
using Tarvo::StringBase;
using Tarvo::StringList;

std::string Property(const KelIP& ip, const StringBase& source, const StringBase& name) {
  StringBase value;
  ip.GetSourceProperty(source, name, value);
  return Text(value);
}

// Paths are compared as texts; links are not followed. None begins like an option.
std::string Relative(const StringBase& path, const std::string& directory) {
  if (directory.empty()) return Text(path);
  const fs::path base = fs::absolute(directory).lexically_normal();
  const std::string relative = fs::path(Text(path)).lexically_normal().lexically_relative(base);
  const bool isPlain = relative.find_first_of("-+#/") != 0;
  return isPlain ? relative : "./" + relative;
}

// A library whose directory does not bear its key's normal text is told by that directory.
std::string Library(const KelIP& ip, const StringBase& source, const StringList& directories) {
  std::string library = Property(ip, source, KelIP::KEL_HDL_LIBRARY_PROPERTY);
  if (!library.empty()) return library;
  const std::string path = Text(source);
  for (const StringBase& directory : directories) {
    if (path.rfind(Text(directory) + "/", 0) != 0) continue;
    return Text(Kel_Key(StringBase(fs::path(Text(directory)).filename().c_str())).GetKey());
  }
  return "";
}

// A source whose extension tells no language lies in the directory of the one that it was given.
std::string Language(const KelIP& ip, const StringBase& source) {
  std::string language = Property(ip, source, KelIP::KEL_HDL_LANGUAGE_PROPERTY);
  if (!language.empty()) return language;
  const std::string path = Text(source);
  const std::size_t vhdl = path.rfind("/hdl/vhdl/");
  const std::size_t verilog = path.rfind("/hdl/verilog/");
  if (vhdl == verilog) return "";
  const bool isVhdl = verilog == std::string::npos || (vhdl != std::string::npos && vhdl > verilog);
  return Text(isVhdl ? Tarvo::LDXParser::LDX_HDL_VHDL : Tarvo::LDXParser::LDX_HDL_VERILOG);
}

std::vector<IncludeDirectory> IncludeDirectories(const KelIP& ip, const std::string& relativeTo) {
  std::vector<IncludeDirectory> directories;
  StringList libraries;
  ip.ListVerilogIncludeLibraries(libraries);
  for (const StringBase& library : libraries) {
    StringBase directory;
    ip.GetVerilogIncludeLocation(library, directory);
    directories.push_back({Relative(directory, relativeTo), Text(directory)});
  }
  return directories;
}

}  // namespace

Status Sources(const Tarvo::KelLibrary& library, const Call& call) {
  const std::unique_ptr<KelIP> ip = OpenCore(library, call);
  if (!ip) return StatusFindings;
  const bool isSimulation = call.purpose == "simulation";
  const auto question = isSimulation ? &KelIP::ListSimulationSources : &KelIP::ListSynthesisSources;
  const auto directories =
      isSimulation ? &KelIP::ListSimulationLibraries : &KelIP::ListSynthesisLibraries;
  SourceList list = {Text(ip->GetKey()), call.purpose, {}, {}};
  StringList paths;
  if (!AskForFiles(*ip, question, "sources", paths)) return StatusFindings;
  StringList libraries;
  ((*ip).*directories)(libraries);
  for (const StringBase& path : paths) {
    list.sources.push_back(
        {Relative(path, call.relativeTo), Library(*ip, path, libraries), Language(*ip, path)});
  }
  if (!paths.empty()) list.includeDirectories = IncludeDirectories(*ip, call.relativeTo);
  const std::string format = call.asJson ? "json" : call.format.empty() ? "list" : call.format;
  WriteSources(list, format);
  return StatusClean;
}
