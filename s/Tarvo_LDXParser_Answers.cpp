// What LDXParser answers from the order that it holds.

#include <vector>

#include "Tarvo_FileKey.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_LDXParser.h"
#include "Tarvo_LDXParser_Hdl.h"

namespace Tarvo {

using Port::FileName;

namespace {

std::vector<KelSource> DescribeSources(const AnalyseOrder::SourceList& list) {
  std::vector<KelSource> sources;
  for (const AnalyseOrder::Library& library : list.libraries) {
    for (const AnalyseOrder::Source* const source : library.sources) {
      const AnalyseOrder::Origin& origin = *source->origin;
      sources.push_back({source->GetLocation().GetAbsolutePath(), *origin.library, origin.language,
                         source->mark.In(*origin.file)});
    }
  }
  return sources;
}

StringList ListPaths(const AnalyseOrder::SourceList& list) {
  StringList paths;
  for (const AnalyseOrder::Library& library : list.libraries) {
    for (const AnalyseOrder::Source* const source : library.sources) {
      paths.push_back(source->GetLocation().GetAbsolutePath());
    }
  }
  return paths;
}

StringList ListDirectories(const Kel_Index& index, const AnalyseOrder::SourceList& list) {
  StringList directories;
  for (const AnalyseOrder::Library& library : list.libraries) {
    directories.push_back(index.GetIPLocation(*library.key).GetAbsolutePath());
  }
  return directories;
}

}  // namespace

// A question to the parser like the others, though its answer needs none of it.
// NOLINTNEXTLINE(readability-convert-member-functions-to-static)
StringBase LDXParser::GetFileLanguage(const FileName& file) const {
  return LanguageByExtension(file);
}

Kel_Key LDXParser::GetFileLibrary(const FileName& file) const {
  const StringBase fileKey = FileKey::OfLocation(file);
  const AnalyseOrder::Source* source = order.GetSynthesis().Find(fileKey.View());
  // A source for one purpose stands in one list alone.
  if (!source) source = order.GetSimulation().Find(fileKey.View());
  return source ? *source->origin->library : Kel_Key();
}

StringBase LDXParser::GetVerilogIncludeLocation(const StringBase& library) const {
  const Kel_Key libKey(library);
  const auto* const known = order.FindIncludeDirectory(libKey);
  return (known ? known->location : index.GetIPLocation(libKey)).GetAbsolutePath();
}

StringList LDXParser::ListSynthesisLibraries() const {
  return ListDirectories(index, order.GetSynthesis());
}

StringList LDXParser::ListSimulationLibraries() const {
  return ListDirectories(index, order.GetSimulation());
}

StringList LDXParser::ListSynthesisAnalyseOrder() const { return ListPaths(order.GetSynthesis()); }

StringList LDXParser::ListSimulationAnalyseOrder() const {
  return ListPaths(order.GetSimulation());
}

StringList LDXParser::ListVerilogIncludeLibraryKeys() const {
  StringList keys;
  for (const auto* const entry : order.includeDirectories) keys.push_back(entry->library.GetKey());
  return keys;
}

std::vector<KelSource> LDXParser::GetSynthesisSources() const {
  return DescribeSources(order.GetSynthesis());
}

std::vector<KelSource> LDXParser::GetSimulationSources() const {
  return DescribeSources(order.GetSimulation());
}

std::vector<KelIncludeDirectory> LDXParser::GetVerilogIncludeDirectories() const {
  std::vector<KelIncludeDirectory> directories;
  for (const auto* const entry : order.includeDirectories) {
    directories.push_back(
        {entry->library.GetKey(), entry->location.GetAbsolutePath(), entry->mark.In(*entry->file)});
  }
  return directories;
}

std::vector<KelInclude> LDXParser::GetIncludes() const {
  std::vector<KelInclude> includes;
  for (const auto& entry : order.includes) {
    includes.push_back({entry.library, *entry.core, entry.mark.In(*entry.file)});
  }
  return includes;
}

}  // namespace Tarvo
