// Goes through a description line by line, with the functions for a line that the readers use.
// Faults of one line are told at once; what depends on other lines, as an interface that is
// declared further down, waits for the end.

#include "Tarvo_DescriptionChecker.h"

#include <algorithm>
#include <boost/filesystem.hpp>
#include <map>
#include <set>
#include <string>
#include <string_view>
#include <utility>

#include "Port_Input.h"
#include "Tarvo_Existence.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary_Utils.h"
#include "Tarvo_KnownProperties.h"
#include "Tarvo_LDXParser_Hdl.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_QVRStatement.h"
#include "Tarvo_RangeText.h"
#include "Tarvo_TellFault.h"
#include "Tarvo_TellUnknown.h"
#include "Tarvo_TokenReader.h"
#include "Tarvo_Word.h"

namespace Tarvo {

namespace {

using Diagnosis::At;
using Diagnosis::Say;
using QVRStatement::Pair;

// A property or an option that takes a few values, in any letter case.
struct Choice {
  QVRStatement::Keyword keyword;
  bool isOpen;  // it takes others too, and only what is nearly one of these is told
  const char* key;
  std::vector<const char*> values;
};
const Choice kChoices[] = {
    {QVRStatement::Option, false, "STYLE", {"HDL", "BLACKBOX", "MIX"}},
    {QVRStatement::Option, false, kLanguageOption, {"VHDL", "Verilog", "MIXED", "BOTH"}},
    {QVRStatement::Option, false, "VHDL_STANDARD", {"93", "02", "08", "19"}},
    {QVRStatement::Parameter, false, "TYPE", {"HDL", "NON_HDL"}},
    {QVRStatement::Port, false, "DIR", {"I", "O", "IO"}},
    {QVRStatement::Port, false, "ENDIAN", {"BIG", "LITTLE"}},
    {QVRStatement::Port, true, "SIGIS", {"CLK", "RST", "INTERRUPT"}}};

const char* const kDataFiles = "DATA_FILES";

// An option that takes any name of a kind.
struct Named {
  const char* key;
  bool (*fits)(std::string_view value);
  const char* hint;
};
const Named kNamed[] = {
    {"HDL_LIBRARY",
     [](std::string_view value) { return KelLibrary_Utils::IsHdlLibrary(StringBase(value)); },
     "write a VHDL name: letters, digits and single '_', no reserved word, not std or ieee"},
    {"TOP",
     [](std::string_view value) {
       return !value.empty() && value.find(' ') == std::string_view::npos;
     },
     "write one name, without blanks"}};

// The options of cores that mean something to the library, or to the command alone.
StringList NamesOfOptions() {
  StringList names = NamesOf(KnownProperties::OfCores());
  for (const char* const name : {kDataFiles, "HDL_LIBRARY", "TOP", "VHDL_STANDARD"}) {
    names.emplace_back(name);
  }
  return names;
}

// The keys of a kind of statement: those that the readers put in front of the stated ones, which
// they hide, and all that mean something.
struct Keys {
  StringList fixed;
  StringList known;
};

const Keys& KeysOf(QVRStatement::Keyword keyword) {
  // Made at the first call: exported constants are there by then.
  static const Keys none;
  static const Keys options{{"NAME", "VERSION"}, NamesOfOptions()};
  static const Keys parameters{{"NAME", "VALUE", "DEFAULT_VALUE"},
                               NamesOf(KnownProperties::OfParameters())};
  static const Keys ports{{"NAME", "DEFAULT"}, NamesOf(KnownProperties::OfPorts())};
  static const Keys busInterfaces{{}, NamesOf(KnownProperties::OfBusInterfaces())};
  static const Keys ioInterfaces{{}, NamesOf(KnownProperties::OfIoInterfaces())};
  static const Keys* const keys[] = {&none,          &options,      &parameters,
                                     &busInterfaces, &ioInterfaces, &ports};
  return *keys[keyword];
}

bool Contains(const StringList& words, std::string_view word) {
  return std::any_of(words.begin(), words.end(),
                     [&](const StringBase& known) { return known.View() == word; });
}

constexpr std::string_view kRestIgnored = "; the rest of the line is ignored";

std::string_view FirstOf(std::string_view text, const char* ends) {
  return text.substr(0, std::max<std::size_t>(1, std::min(text.find_first_of(ends), text.size())));
}

// Whether the rest of a line follows the last value without a blank, so that both were meant for
// one value. Behind a quoted value stands its quote.
bool IsGoneOn(const QVRStatement::List& list) {
  const std::string_view value = list.pairs.back().value;
  const auto between = list.rest.data() - (value.data() + value.size());
  const bool isQuote = between == 1 && *(list.rest.data() - 1) != ' ';
  return (between == 0 || isQuote) && list.rest.find_first_of(",;)]") != 0;
}

std::string_view Trimmed(std::string_view text) {
  text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
  return text.substr(0, text.find_last_not_of(' ') + 1);
}

// How far such a rest goes on: up to a blank or a comma outside of quotes and brackets. An
// apostrophe is a letter, as in 8'hFF.
std::string_view GoneOn(std::string_view rest) {
  TokenReader tokens(rest, " ,=()[]\"", TokenReader::WithGroups);
  std::string_view left = rest;
  while (!left.empty() && left.find_first_of(" ,") != 0) {
    if (!tokens.ReadValue().whole) return rest.substr(0, rest.find_first_of(" ,"));
    tokens.Step();
    left = tokens.GetRest();
  }
  return rest.substr(0, rest.size() - left.size());
}

StringBase Joined(const std::vector<const char*>& words) {
  std::string text;
  for (const char* const word : words) {
    text += text.empty() ? "" : word == words.back() ? " or " : ", ";
    text += word;
  }
  return StringBase(std::string_view(text));
}

class DescriptionChecker {
 public:
  explicit DescriptionChecker(const Port::FileName& file)
      : name(file.GetName()), input(name), lines(ScanFile(file, Codes::kMissingDescription)) {}

  DescribedCore Check();

 private:
  using Text = std::string_view;

  // What can be judged only when all is read: an interface or a parameter that is named somewhere.
  struct Mention {
    QVRStatement::Keyword declaredBy;
    const KelDiagnosticCode* code;
    StringBase name;
    KelPlace place;
    StringBase text;
  };

  void CheckLine(Text line);
  void CheckKeyword(Text line);
  bool CheckScanned(Text line);
  void CheckOption(Text line);
  void CheckDataFiles(Text files) const;
  void CheckList(QVRStatement::Keyword keyword, Text line);
  void CheckEnd(const QVRStatement::List& list);
  void TellGoneOn(const QVRStatement::List& list);
  void CheckPairs(QVRStatement::Keyword keyword, const QVRStatement::List& list, std::size_t first);
  void CheckKey(QVRStatement::Keyword keyword, const std::vector<Pair>& pairs, std::size_t at,
                std::size_t first);
  void CheckValue(QVRStatement::Keyword keyword, const Pair& pair);
  void CheckVector(const Pair& pair);
  void CheckInterfaces(QVRStatement::Keyword keyword, const Pair& pair);
  bool Declare(QVRStatement::Keyword keyword, Text declared);
  void AddParameter(const QVRStatement::List& list);
  void TellMentions() const;
  StringList DeclaredNames(QVRStatement::Keyword keyword) const;

  template <class... Rest>
  void Tell(const KelDiagnosticCode& code, Text part, const StringBase& text,
            const Rest&... hint) const {
    Diagnosis::Add([&] { return At(code, SpanOf(lines, part), text, hint...); });
  }

  void TellBad(const LineFault& fault) const {
    Diagnosis::Add([&] { return TellFault(Codes::kBadStatement, lines, fault); });
  }

  StringBase name;
  Port_Input input;
  FileScanner lines;
  DescribedCore core;
  std::map<std::pair<QVRStatement::Keyword, StringBase>, KelPlace> declarations;
  std::vector<Mention> mentions;
  std::set<QVRStatement::Keyword> bad;  // of which a statement could not be read
};

DescribedCore DescriptionChecker::Check() {
  core.language = DefaultLanguage();
  Text line;
  for (unsigned number = 0; lines.GetNextLine(line, number);) {
    input.AtLine(number);
    if (!line.empty()) CheckLine(line);
  }
  TellMentions();
  core.hasAllParameters = !bad.contains(QVRStatement::Parameter);
  return std::move(core);
}

void DescriptionChecker::CheckLine(Text line) {
  // The walk comes first: a line that is bad for it costs the core all options.
  if (!CheckScanned(line)) return;
  const QVRStatement::Keyword keyword = QVRStatement::KeywordOf(line);
  if (keyword == QVRStatement::None) return CheckKeyword(line);
  if (keyword == QVRStatement::Option) return CheckOption(line);
  CheckList(keyword, line);
}

// A line that begins with no keyword is ignored. It may be meant for a statement all the same.
void DescriptionChecker::CheckKeyword(Text line) {
  const Text word = FirstOf(line, " =,:");
  const bool isBare = Contains(QVRStatement::ListKeywords(), word);
  if (isBare) {
    return Tell(Codes::kUnknownKeyword, word,
                "the line is ignored; a keyword has a blank and a name after it");
  }
  const StringList near =
      KelLibrary_Utils::ListNear(StringBase(word), QVRStatement::ListKeywords());
  if (near.empty()) return;
  // What the line would have declared is not to be told as undeclared.
  bad.insert(QVRStatement::KeywordOf(Say({near.front().View(), " "}).View()));
  Tell(Codes::kUnknownKeyword, word, "unknown keyword; the line is ignored",
       Say({"did you mean ", near.front().View(), "?"}));
}

// The reader of options takes some lines for options that the other one doesn't.
bool DescriptionChecker::CheckScanned(Text line) {
  using namespace QVRStatement;
  if (!BeginsWith(line, OptionScanner::QVR_OPTION, kScannerDelimiters)) return true;
  OptionText option;
  LineFault fault;
  const Result result = ReadOption(line, kScannerDelimiters, option, fault);
  if (result == Unparsable) TellBad(fault);
  return result != Unparsable;
}

// The first of several values is the one that counts.
void DescriptionChecker::CheckOption(Text line) {
  QVRStatement::OptionText option;
  LineFault fault;
  const auto result =
      QVRStatement::ReadOption(line, QVRStatement::kOptionDelimiters, option, fault);
  if (result != QVRStatement::Read) return TellBad(fault);
  TellCut(lines, line);
  if (!Declare(QVRStatement::Option, option.pair.key)) return;
  CheckKey(QVRStatement::Option, {option.pair}, 0, 1);
  const Property stated = QVRStatement::MakeOption(option);
  // A choice is judged by all that the option holds, as in HDL = VHDL 2008.
  Pair whole = option.pair;
  if (!option.tail.empty()) {
    whole.value =
        Text(whole.value.data(), static_cast<std::size_t>(line.end() - whole.value.begin()));
  }
  CheckValue(QVRStatement::Option, whole);
  if (stated.first == kDataFiles) CheckDataFiles(whole.value);
  if (stated.first == KelIP::KEL_LANGUAGE_OPTION_NAME) core.language = stated.second;
  if (stated.first != KelIP::KEL_STYLE_OPTION_NAME) return;
  const bool isMix = EqualsIgnoringCase(stated.second, KelIP::KEL_STYLE_OPTION_VALUE_MIX);
  core.hasSources = isMix || EqualsIgnoringCase(stated.second, KelIP::KEL_STYLE_OPTION_VALUE_HDL);
  core.hasNetlists =
      isMix || EqualsIgnoringCase(stated.second, KelIP::KEL_STYLE_OPTION_VALUE_BLACKBOX);
  core.isStyleKnown = core.hasSources || core.hasNetlists;
}

// They lie below the directory of the core, and the description in a directory there.
void DescriptionChecker::CheckDataFiles(Text files) const {
  const boost::filesystem::path location =
      boost::filesystem::path(name.GetText()).parent_path().parent_path();
  while (!files.empty()) {
    const std::size_t end = std::min(files.find(','), files.size());
    const Text file = Trimmed(files.substr(0, end));
    files.remove_prefix(std::min(end + 1, files.size()));
    if (file.empty() || MayExist(Port::FileName((location / std::string(file)).c_str()))) continue;
    Tell(Codes::kMissingDataFile, file, Say({"data file does not exist: ", file}));
  }
}

void DescriptionChecker::CheckList(QVRStatement::Keyword keyword, Text line) {
  QVRStatement::List list;
  LineFault fault;
  const bool isBus = keyword == QVRStatement::BusInterface;
  const bool isInterface = isBus || keyword == QVRStatement::IoInterface;
  const StringBase& key = isBus ? QVRParser::QVR_BUS_IF_NAME : QVRParser::QVR_IO_IF_NAME;
  std::size_t position = 0;
  if (!QVRStatement::ReadList(line, list, fault) ||
      (isInterface && !QVRStatement::FindName(list, key, position, fault))) {
    bad.insert(keyword);
    return TellBad(fault);
  }
  TellCut(lines, line);
  // An interface is named by the value of its key, all else by the key of the first pair.
  Declare(keyword, isInterface ? list.pairs[position].value : list.pairs.front().key);
  CheckPairs(keyword, list, isInterface ? 0 : 1);
  CheckEnd(list);
  if (keyword == QVRStatement::Parameter) AddParameter(list);
}

// A comma is missing, if one makes a good list of it. Anything else may be the rest of a value that
// has several words.
void DescriptionChecker::CheckEnd(const QVRStatement::List& list) {
  if (list.rest.empty()) return;
  if (list.rest == ",") {
    return Tell(Codes::kTrailingComma, list.rest,
                "the statement ends in a comma, but can't continue on the next line",
                "remove the comma");
  }
  const Pair& last = list.pairs.back();
  const Text word = FirstOf(list.rest, " ,=()[]\"'");
  if (last.value == "=" || last.value == ",") {
    const bool isTwice = last.value == "=";
    return Tell(Codes::kListEnds, last.value,
                Say({isTwice ? "'=' stands twice" : "missing value after '='", kRestIgnored}));
  }
  Text written(last.key.data(), static_cast<std::size_t>(list.rest.data() - last.key.data()));
  written = written.substr(0, written.find_last_not_of(" ;") + 1);
  const StringBase mended = Say({written, ", ", list.rest});
  // Would a comma have made it whole? That is tried on a statement of its own.
  const StringBase line = Say({"PORT ", mended.View()});
  QVRStatement::List read;
  LineFault fault;
  const bool isMended = QVRStatement::ReadList(line.View(), read, fault) && read.rest.empty();
  if (!isMended && IsGoneOn(list)) return TellGoneOn(list);
  Tell(Codes::kListEnds, word,
       Say({"missing ',' ", isMended ? "" : "or quotes ", "before ", isMended ? "" : "'", word,
            isMended ? "" : "'", kRestIgnored}),
       isMended ? Say({"write ", mended.View()}) : StringBase());
}

// What to write for the whole value depends on the quotes that are in it.
void DescriptionChecker::TellGoneOn(const QVRStatement::List& list) {
  const Pair& last = list.pairs.back();
  const Text more = GoneOn(list.rest);
  const Text whole(last.value.data(), last.value.size() + more.size());
  const bool isVector = last.key == QVRParser::QVR_PORT_VEC.View();
  const bool isQuoted = last.value.data() + last.value.size() != list.rest.data();
  const Text quote = whole.find('"') == Text::npos ? "\"" : "'";
  const bool mayQuote = !isQuoted && whole.find(quote) == Text::npos;
  Tell(Codes::kListEnds, more, Say({"the value ends at '", last.value, "'", kRestIgnored}),
       isVector   ? StringBase("a VEC is one range, [LEFT:RIGHT]")
       : mayQuote ? Say({"write ", quote, whole, quote})
                  : StringBase("put the whole value in one pair of quotes"));
}

void DescriptionChecker::CheckPairs(QVRStatement::Keyword keyword, const QVRStatement::List& list,
                                    std::size_t first) {
  for (std::size_t i = first; i < list.pairs.size(); ++i) {
    CheckKey(keyword, list.pairs, i, first);
    CheckValue(keyword, list.pairs[i]);
    const bool isMember = keyword == QVRStatement::Parameter || keyword == QVRStatement::Port;
    if (isMember) CheckInterfaces(keyword, list.pairs[i]);
  }
}

// A key that stands twice, or that is nearly one that means something.
void DescriptionChecker::CheckKey(QVRStatement::Keyword keyword, const std::vector<Pair>& pairs,
                                  std::size_t at, std::size_t first) {
  const Text key = pairs[at].key;
  const Keys& keys = KeysOf(keyword);
  if (Contains(keys.fixed, key)) {
    return Tell(Codes::kDuplicateName, key,
                Say({"'", key, "' is set already; this value is ignored"}));
  }
  for (std::size_t i = first; i < at; ++i) {
    if (pairs[i].key != key) continue;
    return Diagnosis::Add([&] {
      return Diagnosis::With(At(Codes::kDuplicateName, SpanOf(lines, key),
                                Say({"'", key, "' is given already; the first one counts"})),
                             Diagnosis::Here(SpanOf(lines, pairs[i].key)), "first given here");
    });
  }
  // Cores may state properties of their own, so an unknown one is told only if it is nearly a known
  // one.
  if (Contains(keys.known, key)) return;
  const StringBase meant = FindMisspelt(key, keys.known);
  if (meant.GetLength() == 0) return;
  // Options and properties are two words for people.
  const char* const kind = keyword == QVRStatement::Option ? "option " : "property ";
  Tell(Codes::kUnknownProperty, key, Say({"unknown ", kind, "'", key, "'"}),
       Say({"did you mean ", meant.View(), "?"}));
}

void DescriptionChecker::CheckValue(QVRStatement::Keyword keyword, const Pair& pair) {
  if (keyword == QVRStatement::Port && pair.key == QVRParser::QVR_PORT_VEC.View()) {
    return CheckVector(pair);
  }
  if (keyword == QVRStatement::Parameter && pair.key == "RANGE" && !pair.value.empty() &&
      !ReadRange(pair.value)) {
    return Tell(Codes::kBadRange, pair.value, Say({"range can't be read: ", pair.value}),
                "write (LOW:HIGH), or values with commas between");
  }
  if (pair.value == "=") return;  // told as the end of the list
  const StringBase value(pair.value);
  for (const Choice& choice : kChoices) {
    if (choice.keyword != keyword || pair.key != choice.key) continue;
    const auto fits = [&](const char* known) { return EqualsIgnoringCase(value, known); };
    if (std::any_of(choice.values.begin(), choice.values.end(), fits)) return;
    const StringBase meant =
        FindMisspelt(pair.value, StringList(choice.values.begin(), choice.values.end()));
    if (choice.isOpen && meant.GetLength() == 0) return;
    Tell(Codes::kBadValue, pair.value, Say({pair.key, " can't be '", pair.value, "'"}),
         meant.GetLength() > 0 ? Say({"did you mean ", meant.View(), "?"})
                               : Say({"write ", Joined(choice.values).View()}));
  }
  if (keyword != QVRStatement::Option) return;
  for (const Named& named : kNamed) {
    if (pair.key != named.key || named.fits(pair.value)) continue;
    Tell(Codes::kBadValue, pair.value, Say({pair.key, " can't be '", pair.value, "'"}), named.hint);
  }
}

// An empty one is a port of one bit.
void DescriptionChecker::CheckVector(const Pair& pair) {
  if (pair.value.empty()) return;
  const auto range = ReadVector(pair.value);
  if (!range) {
    return Tell(Codes::kBadRange, pair.value, Say({"range can't be read: ", pair.value}),
                "write [LEFT:RIGHT]");
  }
  for (const Text used : range->names) {
    // A bound may name parameters, and those may be declared further down.
    mentions.push_back({QVRStatement::Parameter, &Codes::kBadRange, StringBase(used),
                        Diagnosis::Here(SpanOf(lines, used)),
                        Say({"the core has no parameter '", used, "'"})});
  }
}

void DescriptionChecker::CheckInterfaces(QVRStatement::Keyword keyword, const Pair& pair) {
  const bool isBus = pair.key == QVRParser::QVR_BUS_IF_NAME.View();
  if (!isBus && pair.key != QVRParser::QVR_IO_IF_NAME.View()) return;
  const char* const what = keyword == QVRStatement::Port ? "port" : "parameter";
  const char* const kind = isBus ? "bus interface " : "I/O interface ";
  for (Text rest = pair.value; !rest.empty();) {
    const Text piece = rest.substr(0, rest.find(':'));
    rest.remove_prefix(std::min(piece.size() + 1, rest.size()));
    if (piece.empty()) continue;
    // Judged at the end: the interface may be declared further down.
    mentions.push_back({isBus ? QVRStatement::BusInterface : QVRStatement::IoInterface,
                        &Codes::kUndeclaredInterface, StringBase(piece),
                        Diagnosis::Here(SpanOf(lines, piece)),
                        Say({kind, "'", piece, "' of this ", what, " is not declared"})});
  }
}

// False for a name that is declared already.
bool DescriptionChecker::Declare(QVRStatement::Keyword keyword, Text declared) {
  const KelPlace place = Diagnosis::Here(SpanOf(lines, declared));
  const auto [known, isNew] = declarations.try_emplace({keyword, StringBase(declared)}, place);
  if (isNew) return true;
  Diagnosis::Add([&, first = known->second] {
    return Diagnosis::With(At(Codes::kDuplicateName, SpanOf(lines, declared),
                              Say({QVRStatement::ListKeywords()[keyword - 1].View(), " '", declared,
                                   "' is declared already; the first one counts"})),
                           first, "first declared here");
  });
  return false;
}

void DescriptionChecker::AddParameter(const QVRStatement::List& list) {
  DescribedParameter parameter{StringBase(list.pairs.front().key), {}, {}};
  // From the last to the first, so that the first of several stays.
  for (std::size_t i = list.pairs.size() - 1; i > 0; --i) {
    if (list.pairs[i].key == "RANGE") parameter.range = StringBase(list.pairs[i].value);
    if (list.pairs[i].key == "VALUES") parameter.values = StringBase(list.pairs[i].value);
  }
  core.parameters.push_back(std::move(parameter));
}

// Each name once, with the other places that name it. A bad statement may be the one that declares
// what is missing.
void DescriptionChecker::TellMentions() const {
  // Sorted by name, so that the order does not depend on a hash.
  std::map<std::pair<QVRStatement::Keyword, StringBase>, KelDiagnostic> missing;
  for (const Mention& mention : mentions) {
    const std::pair key(mention.declaredBy, mention.name);
    if (declarations.contains(key) || bad.contains(mention.declaredBy)) continue;
    const auto [known, isNew] =
        missing.try_emplace(key, Diagnosis::AtPlace(*mention.code, mention.place, mention.text));
    if (isNew) {
      known->second.hint = DidYouMean(mention.name.View(), DeclaredNames(mention.declaredBy));
    } else {
      known->second.related.push_back({mention.place, "named here too"});
    }
  }
  for (const auto& [key, diagnostic] : missing) {
    Diagnosis::Add([&found = diagnostic] { return found; });
  }
}

StringList DescriptionChecker::DeclaredNames(QVRStatement::Keyword keyword) const {
  StringList names;
  for (const auto& [key, place] : declarations) {
    if (key.first == keyword) names.push_back(key.second);
  }
  return names;
}

}  // namespace

DescribedCore CheckDescription(const Port::FileName& file) {
  return DescriptionChecker(file).Check();
}

}  // namespace Tarvo
