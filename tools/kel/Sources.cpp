// The verb `sources`: the library's order, handed to one of the formats.

#include "Formats.h"
#include "Tarvo_LDXParser.h"
#include "Text.h"

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

Status Sources(const Tarvo::KelLibrary& library, const Request& request) {
  const std::unique_ptr<KelIP> ip = OpenCore(library, request);
  if (!ip) return StatusFindings;
  const std::string purpose = request.Value("--for");
  const std::string base = request.Value("--relative-to");
  const auto question =
      purpose == "simulation" ? &KelIP::GetSimulationSources : &KelIP::GetSynthesisSources;
  std::vector<KelSource> sources;
  if (!Ask(*ip, question, "sources", sources)) return StatusFindings;
  std::vector<KelIncludeDirectory> directories;
  // Without a source there is nothing to include into.
  if (!sources.empty()) ip->GetVerilogIncludeDirectories(directories);
  SourceList list = {Text(ip->GetKey()), purpose, {}, {}};
  for (const KelSource& source : sources) {
    list.sources.push_back(
        {RelativeTo(base, source.path), Text(source.library.GetKey()), Language(source.language)});
  }
  for (const KelIncludeDirectory& directory : directories) {
    list.includeDirectories.push_back({RelativeTo(base, directory.path), Text(directory.path)});
  }
  WriteSources(list, request.Value("--format"));
  return StatusClean;
}

Choices Purposes() { return {{"synthesis"}, {"simulation"}}; }

}  // namespace

Verb DescribeSources() {
  return {.name = "sources",
          .help = "Lists the HDL sources of a core in analyse order",
          .words = {KeyWord(),
                    {.name = "--for",
                     .value = "PURPOSE",
                     .help = "What the sources are for",
                     .isRequired = true,
                     .choices = Purposes},
                    {.name = "--format",
                     .value = "FORMAT",
                     .help = "How the sources are written",
                     .byDefault = "list",
                     .choices = SourceFormats},
                    RelativeToWord()},
          .example = "sources event_station --for simulation --format ghdl",
          .answer = Sources};
}
