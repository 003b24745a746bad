#include <filesystem>
#include <memory>

#include "Formats.h"
#include "Messages.h"
#include "Tarvo_KelIP.h"
#include "Text.h"
#include "Verbs.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::KelIP;
using Tarvo::StringBase;
using Tarvo::StringList;

std::string Property(const KelIP& ip, const StringBase& source, const StringBase& name) {
  StringBase value;
  ip.GetSourceProperty(source, name, value);
  return Text(value);
}

// Paths are compared as texts; links are not followed.
std::string Relative(const StringBase& path, const std::string& directory) {
  if (directory.empty()) return Text(path);
  const fs::path base = fs::absolute(directory).lexically_normal();
  return fs::path(Text(path)).lexically_normal().lexically_relative(base);
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
  const std::unique_ptr<KelIP> ip = OpenCore(library, call.key);
  if (!ip) return StatusFindings;
  const auto question =
      call.purpose == "simulation" ? &KelIP::ListSimulationSources : &KelIP::ListSynthesisSources;
  SourceList list = {Text(ip->GetKey()), call.purpose, {}, {}};
  StringList paths;
  if (!AskForFiles(*ip, question, "sources", paths)) return StatusFindings;
  for (const StringBase& path : paths) {
    list.sources.push_back({Relative(path, call.relativeTo),
                            Property(*ip, path, KelIP::KEL_HDL_LIBRARY_PROPERTY),
                            Property(*ip, path, KelIP::KEL_HDL_LANGUAGE_PROPERTY)});
  }
  if (!paths.empty()) list.includeDirectories = IncludeDirectories(*ip, call.relativeTo);
  const std::string format = call.asJson ? "json" : call.format.empty() ? "list" : call.format;
  WriteSources(list, format);
  return StatusClean;
}
