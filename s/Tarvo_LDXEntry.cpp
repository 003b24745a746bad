// The grammar of an analyse order. A line is an entry, is ignored, or is bad; there is nothing
// between.

#include "Tarvo_LDXEntry.h"

#include "Tarvo_TokenReader.h"
#include "Tarvo_Word.h"

namespace Tarvo {

namespace {

const char* const kDelimiters = " \"'";
// These three count in small letters only; `all` counts in any.
const char* const kBoth = "lib";
const char* const kSynthesisOnly = "synlib";
const char* const kSimulationOnly = "simlib";
constexpr std::string_view kWholeLibrary = "all";
constexpr std::string_view kIncludeDirectory = "vlgincdir";

bool ReadEnd(TokenReader& tokens, const char* text, LineFault& fault) {
  if (!tokens.MoreTokens()) return true;
  fault = {tokens.GetRest(), text};
  return false;
}

bool ReadLibraryEntry(TokenReader& tokens, LDXEntry& entry, LineFault& fault) {
  if (!ReadNeeded(tokens, entry.keyword, "missing keyword", fault)) return false;
  entry.forSynthesis = entry.keyword == kBoth || entry.keyword == kSynthesisOnly;
  entry.forSimulation = entry.keyword == kBoth || entry.keyword == kSimulationOnly;
  if (!entry.forSynthesis && !entry.forSimulation) {
    fault = {entry.keyword, "unknown keyword", false, true};
    return false;
  }
  if (!ReadNeeded(tokens, entry.library, "missing library", fault)) return false;
  if (!ReadNeeded(tokens, entry.name, "missing file name or 'all'", fault)) return false;
  if (EqualsIgnoringCase(entry.name, kWholeLibrary)) {
    entry.kind = LDXEntry::WholeLibrary;
    return ReadEnd(tokens, "nothing may follow 'all'", fault);
  }
  // A language that is not closed is judged by what there is of it.
  entry.language = tokens.ReadValue().text;
  tokens.Step();
  return ReadEnd(tokens, "nothing may follow the language", fault);
}

// A keyword in other letter case, and a line that goes on behind the directory, are ignored.
bool ReadPathEntry(TokenReader& tokens, LDXEntry& entry, LineFault& fault) {
  entry.kind = LDXEntry::IncludeDirectory;
  if (!ReadNeeded(tokens, entry.keyword, "missing keyword", fault)) return false;
  if (entry.keyword != kIncludeDirectory) {
    entry.kind = LDXEntry::Ignored;
    entry.rest = entry.keyword;
    return true;
  }
  if (!ReadNeeded(tokens, entry.library, "missing library", fault)) return false;
  if (!ReadNeeded(tokens, entry.name, "missing directory", fault)) return false;
  if (tokens.MoreTokens()) entry.rest = tokens.GetRest();
  return true;
}

}  // namespace

StringList LDXKeywords() {
  return {kBoth, kSynthesisOnly, kSimulationOnly, StringBase(kIncludeDirectory)};
}

bool ReadLDXEntry(std::string_view line, LDXEntry& entry, LineFault& fault) {
  TokenReader tokens(line, kDelimiters, TokenReader::WithGroups);
  entry = LDXEntry();
  // In any letter case, though only small letters make an entry of it. So VLGINCDIR is ignored,
  // where it would be an unknown keyword otherwise.
  const bool isPath = EqualsIgnoringCase(FirstWord(line), kIncludeDirectory);
  return isPath ? ReadPathEntry(tokens, entry, fault) : ReadLibraryEntry(tokens, entry, fault);
}

}  // namespace Tarvo
