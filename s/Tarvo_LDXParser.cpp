// The reader of analyse orders. A reader takes one file and makes a further one for each core that
// is included whole; all of them share an Analysis.
//
// What a file adds is its part. Readers put their sources into one order as they come to them,
// which is that of the root at the end. A core's own order is made only where somebody can tell:
// where an entry might be listed twice in that core, and for traces.

#include "Tarvo_LDXParser.h"

#include <algorithm>
#include <iterator>
#include <memory>
#include <string>
#include <string_view>
#include <tuple>
#include <utility>
#include <vector>

#include "Port_Input.h"
#include "Tarvo_AnalyseOrderReader.h"
#include "Tarvo_Existence.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Guard.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_LDXEntry.h"
#include "Tarvo_LDXParser_Hdl.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_OrderAnalysis.h"
#include "Tarvo_Report.h"
#include "Tarvo_SourceMaker.h"
#include "Tarvo_TellFault.h"
#include "Tarvo_TellUnknown.h"

namespace Tarvo {

using Port::FileName;

namespace {

using Diagnosis::Say;
using Mark = AnalyseOrder::Mark;
using Source = AnalyseOrder::Source;

constexpr Report::Module kModule{"s/Tarvo_LDXParser", "1.0"};

const char* const kSynthesis = "synthesis";
const char* const kSimulation = "simulation";

KelPlace PlaceOf(const OpenOrder& open) { return open.entry.In(*open.file); }

bool IsBefore(const OpenOrder& left, const OpenOrder& right) {
  return std::tie(*left.file, left.entry.line) < std::tie(*right.file, right.entry.line);
}

AppException Circular(const Kel_Key& key) {
  return Report::Exception(AppException::Failure, "Circular LDX definition for %s\n", key.GetKey());
}

// The key, which must not be that of the root of its own analysis.
const Kel_Key& CheckRoot(const Kel_Key& key, const Kel_Key& root) {
  if (!root.IsValid() || key != root) return key;
  throw Circular(root);
}

// A file that was looked for.
struct OrderFile {
  explicit OrderFile(const FileName& file) : name(file), found(file.GetName()) {}

  FileName name;
  Port::FoundFile found;
};

// The analyse-order file of a version, which must be there.
OrderFile GetLdxFile(const Kel_Index& index, const Kel_Key& key) {
  OrderFile file(
      Kel_Index::GetDataFile(index.GetIPLocation(key), key, Kel_Index::KEL_LDX_EXTENSION));
  // One that can't be looked at is read all the same: then the error says why.
  if (file.found.GetExistence() != Existence::No) return file;
  const StringBase name = file.name.GetName();
  Diagnosis::Add(
      [&] { return Diagnosis::Of(Codes::kMissingOrder, name, "the file does not exist"); });
  throw Report::Told(Report::Exception(AppException::Failure, "Invalid LDX %s\n", name));
}

// The key as the index stores it, or as it is if the index does not know it: a file may be read for
// a core that is in no index.
const Kel_Key& Resolve(const Kel_Index& index, const Kel_Key& key) {
  const Kel_Index::Version* const version = index.FindVersion(key);
  return version ? version->first : key;
}

// Reads one file. An include makes a further reader, and both work on one list of open files. The
// keys that it is given outlive it.
class OrderReader {
 public:
  OrderReader(const Kel_Index& theIndex, OrderAnalysis& theAnalysis, const Kel_Key& version,
              const Kel_Key& theRoot, StringBase language, OrderFile theFile)
      : index(theIndex),
        analysis(theAnalysis),
        open(analysis.open),
        key(version),
        core(Resolve(theIndex, version)),
        // Without a root this reader is the outermost one, and its version the root of all below.
        root(theRoot.IsValid() ? theRoot : version),
        isRoot(theRoot.IsValid() && version == theRoot),
        hdl(std::move(language)),
        ldxFile(std::move(theFile)),
        fileName(std::make_shared<const StringBase>(ldxFile.name.GetName())),
        state(analysis.cores[core.GetKey()]),
        order(analysis, open.empty()),
        maker(index, fileName, order.GetPart()) {}

  const OrderPart& Read();
  // What was read, for the outermost reader.
  AnalyseOrder TakeOrder();

 private:
  void Close();
  // What stands on the stack while an included core is read is kept small, so some are not inlined.
  [[gnu::noinline]] void CheckNesting() const;
  void TellCircle(OpenOrders::const_iterator first) const;
  [[gnu::noinline]] void Scan();
  void Parse();
  void ReadLine(std::string_view line);
  [[gnu::noinline]] void RefuseLine(std::string_view line, const LDXEntry& entry) const;
  bool AddEntry(const LDXEntry& entry);
  [[gnu::noinline]] bool AddFile(const LDXEntry& entry);
  [[gnu::noinline]] bool AddDirectory(const LDXEntry& entry);
  bool AddLibrary(const LDXEntry& entry);
  void AddSource(const LDXEntry& entry, Source& source);

  [[gnu::noinline]] StringBase LanguageOf(const Kel_Key& library) const;

  void TakeIn(std::string_view text, const Kel_Key& library, const StringBase& language);
  [[gnu::noinline]] std::unique_ptr<OrderReader> MakeReader(std::string_view text,
                                                            const Kel_Key& library,
                                                            const Kel_Key& included,
                                                            const StringBase& language);
  [[gnu::noinline]] void TakeOver(OrderReader& nested, const OrderPart& part,
                                  const Kel_Key& library);
  void AddInclude(std::string_view text, const Kel_Key& included);
  void KeepIncludes(const OrderReader& nested);
  OrderFile FindOrder(const Kel_Key& library, std::string_view text) const;
  bool ReportUnsettled(const LDXEntry& entry, const SourceLanguage& settled) const;
  void WarnOfSecond(const Source& source, const char* purpose) const;
  void TellSecond(const LDXEntry& entry, const AnalyseOrder::Earlier& earlier) const;
  [[gnu::noinline]] KelDiagnostic TellBadEntry(const LineFault& fault) const;
  void TellUnknown(std::string_view library) const;
  void TellIgnored(const LDXEntry& entry) const;
  void TellDoubtful(std::string_view line, const LDXEntry& entry) const;
  void TraceKnown(const AnalyseOrder::SourcePointers& sources, const char* purpose,
                  const Kel_Key& from) const;

  Diagnosis::Span SpanOf(std::string_view part) const { return Tarvo::SpanOf(*lines, part); }
  Mark MarkOf(std::string_view part) const {
    const Diagnosis::Span span = SpanOf(part);
    return {open.back().entry.line, span.column, span.length};
  }
  // A fault at a part of the present line.
  template <class Text>
  void Tell(const KelDiagnosticCode& code, std::string_view part, const Text& makeText) const {
    Diagnosis::Add([&] { return Diagnosis::At(code, SpanOf(part), makeText()); });
  }

  const Kel_Index& index;
  OrderAnalysis& analysis;
  OpenOrders& open;
  const Kel_Key& key;   // as given
  const Kel_Key& core;  // the version that it stands for
  const Kel_Key& root;
  bool isRoot;  // whether the key is that of the root again
  StringBase hdl;
  OrderFile ldxFile;
  std::shared_ptr<const StringBase> fileName;
  std::unique_ptr<FileScanner> lines;
  OrderAnalysis::Core& state;
  CoreOrder order;
  std::vector<AnalyseOrder::Include> includes;
  std::vector<AnalyseOrder::Include> further;  // of the files below; for a checker alone
  SourceMaker maker;
};

// The list of open files is the same for all readers of an analysis, so a failed one leaves it too.
// For a checker, what a file read before has was told, and taken over by what leads to it.
const OrderPart& OrderReader::Read() {
  CheckNesting();
  if (Diagnosis::GoesOn() && !analysis.done.insert(*fileName).second) return order.GetPart();
  open.push_back({fileName, &core, {}});
  ++state.timesOpen;
  try {
    Parse();
  } catch (...) {
    Close();
    throw;
  }
  Close();
  return order.GetPart();
}

void OrderReader::Close() {
  open.pop_back();
  --state.timesOpen;
}

AnalyseOrder OrderReader::TakeOrder() {
  AnalyseOrder taken = order.TakeOrder();
  taken.includes = std::move(includes);
  taken.further = std::move(further);
  taken.parts = std::move(analysis.parts);
  return taken;
}

// Refuses the root, a file that is being read already, which only an endless circle comes back to,
// and what is too deep for the stack. A core whose own file is another one than that which is read
// in its name is no circle.
void OrderReader::CheckNesting() const {
  auto same = open.cend();
  if (state.timesOpen > 0) {
    same = std::find_if(open.cbegin(), open.cend(), [&](const OpenOrder& outer) {
      return *outer.core == core && (isRoot || *outer.file == *fileName);
    });
  }
  // The root is refused by its key, all others by file and core.
  if (isRoot || same != open.cend()) {
    TellCircle(same == open.cend() ? open.cbegin() : same);
    throw Report::Told(Circular(core));
  }
  if (open.size() < OrderAnalysis::kDeepestLevel) return;
  Diagnosis::Add([&] {
    return Diagnosis::AtPlace(Codes::kIncludeTooDeep, PlaceOf(open.back()),
                              "includes nest too deep");
  });
  throw Report::Told(Report::Exception(AppException::Failure,
                                       "LDX definition for %s nested below %d others\n",
                                       core.GetKey(), OrderAnalysis::kDeepestLevel));
}

// Tells the circle at the include that closes it, with the others behind it. A checker comes into
// it at any of its cores, so it tells it at the first of its places.
void OrderReader::TellCircle(OpenOrders::const_iterator first) const {
  Diagnosis::Add([&] {
    OpenOrders circle(first, open.cend());
    const auto start = Diagnosis::GoesOn()
                           ? std::min_element(circle.begin(), circle.end(), IsBefore)
                           : std::prev(circle.end());
    std::rotate(circle.begin(), start, circle.end());
    std::string cores;
    for (const OpenOrder& step : circle) cores += std::string(step.core->GetKey()) + ", ";
    KelDiagnostic told =
        Diagnosis::AtPlace(Codes::kIncludeCircle, PlaceOf(circle[0]),
                           Say({"circle of includes: ", cores, circle[0].core->GetKey().View()}),
                           "take one of the includes out");
    // Otherwise the includes are told as those that lead here.
    for (std::size_t i = 1; Diagnosis::GoesOn() && i < circle.size(); ++i) {
      const Kel_Key& next = *circle[(i + 1) % circle.size()].core;
      told.related.push_back({PlaceOf(circle[i]), Say({"includes ", next.GetKey().View()})});
    }
    return told;
  });
}

void OrderReader::Scan() {
  // NOLINTNEXTLINE(modernize-make-unique): made in place, since it can't be moved
  lines.reset(
      new FileScanner(ScanFile(ldxFile.name, std::move(ldxFile.found), Codes::kMissingOrder)));
}

// The first bad line ends all reading, unless a checker reads.
void OrderReader::Parse() {
  TARVO_TRACE("  Parsing LDX File %s\n", *fileName);
  Port_Input input(*fileName);
  Scan();
  std::string_view line;
  for (unsigned lineNumber = 0; lines->GetNextLine(line, lineNumber);) {
    if (line.empty()) continue;
    input.AtLine(lineNumber);
    open.back().entry = {lineNumber, 0, 0};
    ReadLine(line);
  }
  TARVO_TRACE("  Parse successful\n");
}

void OrderReader::ReadLine(std::string_view line) {
  LDXEntry entry;
  LineFault fault;
  const bool isRead = ReadLDXEntry(line, entry, fault);
  if (!isRead) Diagnosis::Add([&] { return TellBadEntry(fault); });
  if (isRead && Diagnosis::GoesOn()) TellDoubtful(line, entry);
  if (!isRead || !AddEntry(entry)) RefuseLine(line, entry);
}

void OrderReader::RefuseLine(std::string_view line, const LDXEntry& entry) const {
  const char* const kind = entry.kind == LDXEntry::IncludeDirectory ? "path" : "library";
  kModule.Error("LDX unparsable %s entry: %s line %d, %s\n", kind, *fileName,
                open.back().entry.line, StringBase(line));
  // The first bad line ends the reading of all files that are open; a checker wants the others too.
  if (Diagnosis::GoesOn()) return;
  throw Report::Told(Report::Exception(AppException::Failure, "Invalid LDX %s\n", *fileName));
}

KelDiagnostic OrderReader::TellBadEntry(const LineFault& fault) const {
  KelDiagnostic told = TellFault(Codes::kBadEntry, *lines, fault);
  if (fault.isKeyword) told.hint = DidYouMean(fault.where, LDXKeywords());
  return told;
}

bool OrderReader::AddEntry(const LDXEntry& entry) {
  switch (entry.kind) {
    case LDXEntry::File:
      return AddFile(entry);
    case LDXEntry::WholeLibrary:
      return AddLibrary(entry);
    case LDXEntry::IncludeDirectory:
      return AddDirectory(entry);
    case LDXEntry::Ignored:
      TellIgnored(entry);
  }
  return true;
}

bool OrderReader::AddFile(const LDXEntry& entry) {
  const StringBase file(entry.name);
  try {
    // The library first: whatever its language, a source needs a place.
    maker.EnterLibrary(entry.library);
  } catch (const AppException& exception) {
    TellUnknown(entry.library);
    kModule.Error("Unable to determine location for library %s, file %s\n%s\n",
                  StringBase(entry.library), file, exception.what());
    return false;
  }
  const FileName name(file);
  const SourceLanguage settled = SettleLanguage(hdl, StringBase(entry.language), name);
  if (settled.assumed) {
    TARVO_TRACE("HDL language not specified for file %s:%s when IP core is MIXED\n",
                StringBase(entry.library), file);
  }
  if (settled.verdict != SourceLanguage::Settled) return ReportUnsettled(entry, settled);
  AddSource(entry, maker.Make(file, name, settled, MarkOf(entry.name)));
  return true;
}

// Says what is wrong with a file entry. True if only this source is lost, as for a language that
// can't count. Where nobody knows what a source is, compiling the others would only hide that.
bool OrderReader::ReportUnsettled(const LDXEntry& entry, const SourceLanguage& settled) const {
  const StringBase file(entry.name);
  const std::string_view language = entry.language;
  switch (settled.verdict) {
    case SourceLanguage::Settled:
      return true;
    case SourceLanguage::UnknownLanguage:
      Diagnosis::Add([&] {
        return Diagnosis::At(
            Codes::kUnknownLanguage, SpanOf(language),
            Say({"unknown language '", language, "'; the source is left out"}),
            DidYouMean(language, {LDXParser::LDX_HDL_VHDL, LDXParser::LDX_HDL_VERILOG}));
      });
      kModule.Error("Unknown HDL language specified\n");
      return true;
    case SourceLanguage::LanguageOnBoth:
      Tell(Codes::kLanguageNotAllowed, language,
           [] { return "a core of HDL BOTH names no languages; the source is left out"; });
      kModule.Error("HDL language specified when IP core is BOTH\n");
      return true;
    case SourceLanguage::AgainstExtension:
      Tell(Codes::kLanguageMismatch, language.empty() ? entry.name : language, [&] {
        return Say({"'", entry.name, "' can't be ", settled.language.View(), " by its extension"});
      });
      kModule.Error("File %s declared to be %s\n", file, settled.language);
      return false;
    case SourceLanguage::NeitherLanguageNorExtension:
      Tell(Codes::kNoLanguage, entry.name, [&] {
        return Say({"the language of '", entry.name,
                    "' is unknown: it has no extension v or vhd, and no language is given"});
      });
      kModule.Error("Unable to add file extension to %s\n", file);
      return false;
  }
  return false;
}

void OrderReader::AddSource(const LDXEntry& entry, Source& source) {
  const AnalyseOrder::Earlier earlier = order.Add(source, entry.forSynthesis, entry.forSimulation);
  if (!earlier.synthesis && !earlier.simulation) return;
  TellSecond(entry, earlier);
  // Two warnings where it stands in both: who works for one purpose looks for that one.
  if (earlier.synthesis) WarnOfSecond(source, kSynthesis);
  if (earlier.simulation) WarnOfSecond(source, kSimulation);
}

void OrderReader::TellSecond(const LDXEntry& entry, const AnalyseOrder::Earlier& earlier) const {
  Diagnosis::Add([&] {
    const bool both = earlier.synthesis != nullptr && earlier.simulation != nullptr;
    const char* const purpose = earlier.synthesis ? kSynthesis : kSimulation;
    const Source& first = *(earlier.synthesis ? earlier.synthesis : earlier.simulation);
    return Diagnosis::With(
        Diagnosis::At(Codes::kDuplicateSource, SpanOf(entry.name),
                      Say({"'", entry.name, "' of ", first.origin->library->GetKey().View(),
                           " is listed already", both ? "" : " for ", both ? "" : purpose})),
        first.mark.In(*first.origin->file), "first listed here");
  });
}

void OrderReader::WarnOfSecond(const Source& source, const char* purpose) const {
  kModule.Warning("%s - File %s:%s already exists in %s library\n", key.GetKey(),
                  source.origin->library->GetKey(), source.GetLocation().GetTail(), purpose);
}

void OrderReader::TellUnknown(std::string_view library) const {
  Diagnosis::Add([&] { return TellUnknownLibrary(*lines, index, library); });
}

// Only a checker tells what the order takes as it stands.
void OrderReader::TellIgnored(const LDXEntry& entry) const {
  if (!Diagnosis::GoesOn()) return;
  Tell(Codes::kIgnoredEntry, entry.rest, [&] {
    const bool isPath = entry.kind == LDXEntry::IncludeDirectory;
    return Say({isPath ? "the entry is ignored, because something follows the directory"
                       : "the entry is ignored; write vlgincdir in small letters"});
  });
}

// What a good entry does other than it looks. For a checker alone.
void OrderReader::TellDoubtful(std::string_view line, const LDXEntry& entry) const {
  TellCut(*lines, line);
  const bool isForBoth = entry.forSynthesis && entry.forSimulation;
  if (entry.kind != LDXEntry::WholeLibrary || isForBoth) return;
  Diagnosis::Add([&] {
    return Diagnosis::At(
        Codes::kIgnoredPurpose, SpanOf(entry.keyword),
        Say({entry.keyword, " with 'all' takes all of '", entry.library, "' for both purposes"}),
        Say({"write lib ", entry.library, " all"}));
  });
}

bool OrderReader::AddDirectory(const LDXEntry& entry) {
  const StringBase library(entry.library);
  const StringBase directory(entry.name);
  const Kel_Key libKey(library);
  // Below the version whose file this is, whatever library the entry names.
  FileName location = index.GetIPLocation(key);
  location.PushPathEnd(directory);
  if (!Exists(location)) {  // as the system resolves it, links and all
    Tell(Codes::kMissingIncludeDirectory, entry.name, [&] {
      return Say({"include directory does not exist: ", entry.name});
    });
    kModule.Warning("The include directory %s for library %s does not exist\n", directory, library);
    return false;
  }
  // Behind the question whether it exists: that one is asked in any case.
  if (!entry.rest.empty()) {
    TellIgnored(entry);
    return true;
  }
  // The first directory of a library counts; it is never replaced.
  if (const auto* const known = order.Add({libKey, location, fileName, MarkOf(entry.name)})) {
    Diagnosis::Add([&] {
      return Diagnosis::With(
          Diagnosis::At(Codes::kDuplicateIncludeDirectory, SpanOf(entry.library),
                        Say({"'", entry.library, "' has an include directory already"})),
          known->mark.In(*known->file), "first given here");
    });
    kModule.Warning("Library %s already has path %s defined\n", library, known->location.GetName());
    return false;
  }
  return true;
}

bool OrderReader::AddLibrary(const LDXEntry& entry) {
  const StringBase library(entry.library);
  // Guarded like an exported operation, so that a fault far below is followed by one message at
  // each level up to the file that was asked for.
  return Guard(NoOutput(), Failure(kModule, "Unable to analyse library %s\n%s\n", library), [&] {
    const Kel_Key libKey(library);
    open.back().entry = MarkOf(entry.library);
    TakeIn(entry.library, libKey, LanguageOf(libKey));
  });
}

// Adds the order of a core, read anew if need be.
void OrderReader::TakeIn(std::string_view text, const Kel_Key& library,
                         const StringBase& language) {
  const Kel_Key& included = Resolve(index, library);
  auto& reading = analysis.cores[included.GetKey()].readings[language];
  // The root is refused wherever it is included.
  if (!(root.IsValid() && library == root) && analysis.MayReuse(reading)) {
    AddInclude(text, included);
    order.Add(*reading.part, std::nullopt);
    return;
  }
  const auto nested = MakeReader(text, library, included, language);
  const OrderPart& part =
      analysis.Read(reading, [&]() -> const OrderPart& { return nested->Read(); });
  TakeOver(*nested, part, library);
}

std::unique_ptr<OrderReader> OrderReader::MakeReader(std::string_view text, const Kel_Key& library,
                                                     const Kel_Key& included,
                                                     const StringBase& language) {
  OrderFile file = FindOrder(library, text);
  AddInclude(text, included);
  return std::make_unique<OrderReader>(index, analysis, library, root, language, std::move(file));
}

void OrderReader::TakeOver(OrderReader& nested, const OrderPart& part, const Kel_Key& library) {
  if (Diagnosis::GoesOn()) KeepIncludes(nested);
  const bool isFirst = &part == &nested.order.GetPart();
  const AnalyseOrder::Known known =
      order.Add(part, isFirst ? nested.order.TakeSum() : std::nullopt);
  TraceKnown(known.synthesis, kSynthesis, library);
  TraceKnown(known.ForSimulation(), kSimulation, library);
}

// Those of the outermost file are asked for, and a checker wants all.
void OrderReader::AddInclude(std::string_view text, const Kel_Key& included) {
  if (open.size() > 1 && !Diagnosis::GoesOn()) return;
  auto from = includes.empty() ? std::make_shared<const Kel_Key>(core) : includes.back().from;
  includes.push_back({std::move(from), StringBase(text), std::make_shared<const Kel_Key>(included),
                      fileName, open.back().entry});
}

void OrderReader::KeepIncludes(const OrderReader& nested) {
  for (const auto* const taken : {&nested.includes, &nested.further}) {
    further.insert(further.end(), taken->begin(), taken->end());
  }
}

OrderFile OrderReader::FindOrder(const Kel_Key& library, std::string_view text) const {
  try {
    return GetLdxFile(index, library);
  } catch (AppException& exception) {
    // What was not told yet is that the index has no such core.
    if (!exception.told) TellUnknown(text);
    throw Report::Told(exception);
  }
}

// The language of an included core; this one's own if the index has no options of it.
StringBase OrderReader::LanguageOf(const Kel_Key& library) const {
  StringBase language;
  try {
    language = OptionScanner::GetOptionValue(index.GetIPOptions(library), kLanguageOption);
  } catch (const AppException& exception) {
    if (exception.level == AppException::NotFound) language = hdl;
  }
  return language.GetLength() > 0 ? language : DefaultLanguage();
}

void OrderReader::TraceKnown(const AnalyseOrder::SourcePointers& sources, const char* purpose,
                             const Kel_Key& from) const {
  for (const Source* const source : sources) {
    TARVO_TRACE("%s - File %s:%s included from %s already exists in %s library\n", key.GetKey(),
                source->origin->library->GetKey(), source->GetLocation().GetTail(), from.GetKey(),
                purpose);
  }
}

AnalyseOrder ReadOrder(OrderFile file, const Kel_Index& index, const Kel_Key& version,
                       const Kel_Key& root, const StringBase& language) {
  OrderAnalysis analysis;
  OrderReader reader(index, analysis, version, root, language, std::move(file));
  reader.Read();
  return reader.TakeOrder();
}

}  // namespace

AnalyseOrder ReadAnalyseOrder(const FileName& file, const Kel_Index& index, const Kel_Key& version,
                              const Kel_Key& root, const StringBase& language) {
  CheckRoot(version, root);
  return ReadOrder(OrderFile(file), index, version, root, language);
}

LDXParser::LDXParser(const Kel_Index& theIndex, const Kel_Key& version, const Kel_Key& root,
                     const StringBase& language)
    : index(theIndex),
      order(ReadOrder(GetLdxFile(theIndex, CheckRoot(version, root)), theIndex, version, root,
                      language)) {}

LDXParser::LDXParser(const FileName& ldxFile, const Kel_Index& theIndex, const Kel_Key& version,
                     const Kel_Key& root, const StringBase& language)
    : index(theIndex), order(ReadAnalyseOrder(ldxFile, theIndex, version, root, language)) {}

LDXParser::~LDXParser() = default;

}  // namespace Tarvo
