// The verb `sources`: the library's order, handed to one of the formats.

#include <utility>

#include "Arguments.h"
#include "Formats.h"
#include "MissingFiles.h"
#include "SourceList.h"
#include "Text.h"

namespace {

constexpr std::size_t kMostNamed = 10;

// Words that mean something to one format.
constexpr std::pair<const char*, const char*> kWordsOfFormats[] = {{"--run", "ghdl"},
                                                                   {"--tool", "edam"}};

// Names sources and data files that are not there.
void TellMissing(const SourceList& list, bool isError) {
  const std::vector<std::string> missing = MissingFiles(list);
  if (missing.empty()) return;
  std::string text = std::to_string(missing.size()) + " listed files do not exist:";
  if (missing.size() == 1) text = "a listed file does not exist:";
  for (std::size_t i = 0; i < missing.size() && i < kMostNamed; ++i) text += "\n" + missing[i];
  if (missing.size() > kMostNamed) text += "\nand others";
  isError ? Messages::Error(text) : Messages::Warn(text);
}

void WriteRawPaths(const SourceList& list) {
  Json records = Json::array();
  for (const Source& source : list.sources) records.push_back({{"path", source.path}});
  WritePaths(records);
}

Status Sources(const Tarvo::KelLibrary& library, const Request& request) {
  const std::string format = request.Value("--format");
  for (const auto& [word, itsFormat] : kWordsOfFormats) {
    if (request.Has(word) && format != itsFormat) {
      return Refuse(std::string(word) + " is for --format " + itsFormat, request.verb);
    }
  }
  const std::optional<SourceList> list = MakeSourceList(library, request);
  if (!list) return StatusFindings;
  TellMissing(*list, request.Has("--check-files"));
  if (!request.Has("--null")) return WriteSources(*list, format, request.Has("--language"));
  WriteRawPaths(*list);
  return StatusClean;
}

Choices Purposes() { return {{"synthesis"}, {"simulation"}}; }

std::vector<Word> Words() {
  return {Repeated(KeyWord()),
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
          {.name = "--top",
           .value = "NAME",
           .help = "The top unit; else the option TOP of the first core, or its bare name"},
          SetWord("Sets a parameter or generic of the top; may be repeated"),
          {.name = "--run", .help = "Have the script of --format ghdl run the top"},
          {.name = "--tool",
           .value = "TOOL",
           .help = "The simulator that --format edam is for, with the options that it needs",
           .choices = FlowTools},
          {.name = "--library-names",
           .value = "WHICH",
           .help = "What the library of a core's sources is called",
           .byDefault = "option",
           .choices = LibraryNamings},
          {.name = "--hdl-library",
           .value = "CORE=LIB",
           .help = "Calls the library of this core so; CORE is a key or bare name; may be repeated",
           .isRepeated = true,
           .fault = PairFault},
          {.name = "--vhdl-standard",
           .value = "YEAR",
           .help = "The standard of VHDL; else the option VHDL_STANDARD of each core",
           .choices = VhdlStandards},
          {.name = "--language",
           .value = "LANGUAGE",
           .help = "Of cores that have each file in both languages, take this one",
           .choices = Languages},
          {.name = "--benches",
           .value = "WHOSE",
           .help = "For simulation, leave out what other cores list for simulation alone (own)",
           .byDefault = "all",
           .choices = Benches},
          {.name = "--check-files", .help = "A listed file that does not exist is an error"},
          NullWord(),
          RelativeToWord()};
}

}  // namespace

Verb DescribeSources() {
  return {.name = "sources",
          .help = "Lists the HDL sources of cores in analyse order",
          .words = Words(),
          .example = "sources event_station --for simulation --format ghdl",
          .answer = Sources};
}
