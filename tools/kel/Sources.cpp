#include <memory>

#include "Formats.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_LDXParser.h"
#include "Text.h"
#include "Verbs.h"

namespace {

using Tarvo::KelIncludeDirectory;
using Tarvo::KelIP;
using Tarvo::KelSource;
using Tarvo::LDXParser;
using Tarvo::StringBase;

// The language as the formats write it, in whatever letter case a core does.
std::string Language(const StringBase& language) {
  for (const StringBase* const known : {&LDXParser::LDX_HDL_VHDL, &LDXParser::LDX_HDL_VERILOG}) {
    if (language.Compare(*known, StringBase::CompareIgnoreCase) == 0) return Text(*known);
  }
  return "";
}

}  // namespace

Status Sources(const Tarvo::KelLibrary& library, const Call& call) {
  const std::unique_ptr<KelIP> ip = OpenCore(library, call);
  if (!ip) return StatusFindings;
  const auto question =
      call.purpose == "simulation" ? &KelIP::GetSimulationSources : &KelIP::GetSynthesisSources;
  std::vector<KelSource> sources;
  if (!Ask(*ip, question, "sources", sources)) return StatusFindings;
  std::vector<KelIncludeDirectory> directories;
  if (!sources.empty()) ip->GetVerilogIncludeDirectories(directories);
  SourceList list = {Text(ip->GetKey()), call.purpose, {}, {}};
  for (const KelSource& source : sources) {
    list.sources.push_back({RelativeTo(call.relativeTo, source.path), Text(source.library.GetKey()),
                            Language(source.language)});
  }
  for (const KelIncludeDirectory& directory : directories) {
    list.includeDirectories.push_back(
        {RelativeTo(call.relativeTo, directory.path), Text(directory.path)});
  }
  WriteSources(list, call.asJson ? "json" : call.format.empty() ? "list" : call.format);
  return StatusClean;
}
