// What a walk reads of each description. Only lines that begin with the keyword are cut into
// tokens.

#include "Tarvo_OptionScanner.h"

#include <string_view>
#include <utility>

#include "Port_Input.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_KnownProperties.h"
#include "Tarvo_PropertyList.h"
#include "Tarvo_QVRStatement.h"
#include "Tarvo_Report.h"
#include "Tarvo_TellFault.h"

namespace Tarvo {

const StringBase OptionScanner::QVR_TRUE = "TRUE";
const StringBase OptionScanner::QVR_FALSE = "FALSE";
const StringBase OptionScanner::QVR_OPTION = "OPTION";
const StringBase OptionScanner::QVR_OPTION_NAME = "NAME";
const StringBase OptionScanner::QVR_OPTION_VERSION = "VERSION";
const StringBase OptionScanner::QVR_OPTION_IMP_NETLIST = "IMP_NETLIST";
const StringBase OptionScanner::QVR_OPTION_RUN_TRAMFOLD = "RUN_TRAMFOLD";
const StringBase OptionScanner::QVR_OPTION_STYLE = "STYLE";
const StringBase OptionScanner::QVR_OPTION_STYLE_HDL = "HDL";
const StringBase OptionScanner::QVR_OPTION_USAGE_LEVEL = "USAGE_LEVEL";
const StringBase OptionScanner::QVR_OPTION_USAGE_LEVEL_ADVANCED = "ADVANCED_USER";

namespace {

constexpr Report::Module kModule{"s/Tarvo_OptionScanner", "1.0"};

// Appends the option of a line that states one. False for a bad statement.
bool ReadLine(std::string_view line, PropertyList& options, LineFault& fault) {
  using namespace QVRStatement;
  if (!BeginsWith(line, OptionScanner::QVR_OPTION, kScannerDelimiters)) return true;
  OptionText option;
  const Result result = ReadOption(line, kScannerDelimiters, option, fault);
  if (result == Read) options.push_back(MakeOption(option));
  return result != Unparsable;
}

// The value of an option for a trace, which looks no further when it is missing.
StringBase ValueOrEmpty(const PropertyList& options, const StringBase& name) {
  const StringBase* const value = FindValue(options, name);
  return value ? *value : StringBase();
}

}  // namespace

OptionScanner::OptionScanner(const Kel_Key& key, const Port::FileName& file)
    : OptionScanner(key, file,
                    key.IsValid() ? Port::FoundFile(file.GetName()) : Port::FoundFile()) {}

// Goes on behind a bad statement, so that each gets its own error.
OptionScanner::OptionScanner(const Kel_Key& key, const Port::FileName& file,
                             Port::FoundFile found) {
  const StringBase name = file.GetName();
  if (!key.IsValid()) {
    throw Report::Exception(AppException::Failure, "Invalid IP key %s for file %s\n", key.GetKey(),
                            name);
  }
  TARVO_TRACE("  Parsing QVR File %s\n", name);
  Port_Input input(name);
  FileScanner lines = ScanFile(file, std::move(found), Codes::kMissingDescription);
  // In front of what the file states, so that the first match gives those of the version.
  options = {{QVR_OPTION_NAME, key.GetName()}, {QVR_OPTION_VERSION, key.GetVersion()}};
  bool ok = true;
  std::string_view line;
  for (unsigned lineNumber = 0; lines.GetNextLine(line, lineNumber);) {
    input.AtLine(lineNumber);
    LineFault fault;
    if (ReadLine(line, options, fault)) continue;
    Diagnosis::Add([&] { return TellFault(Codes::kBadStatement, lines, fault); });
    kModule.Error("QVR unparsable OPTION: %s line %d, %s\n", name, lineNumber, StringBase(line));
    ok = false;
  }
  // Behind them for the same reason: what is stated counts.
  ForEachMissing(options, KnownProperties::OfCores(),
                 [&](const StringBase& option, const StringBase& value) {
                   options.emplace_back(option, value);
                 });
  if (ok) return;
  throw Report::Told(Report::Exception(AppException::Failure, "Unable to parse QVR %s\n", name));
}

OptionScanner::~OptionScanner() = default;

PropertyList OptionScanner::GetOptions() const { return options; }

PropertyList OptionScanner::TakeOptions() { return std::exchange(options, {}); }

StringBase OptionScanner::GetOptionValue(const PropertyList& options, const StringBase& name) {
  if (const StringBase* const value = FindValue(options, name)) return *value;
  TARVO_TRACE("Cannot find option %s on IP %s version %s\n", name,
              ValueOrEmpty(options, QVR_OPTION_NAME), ValueOrEmpty(options, QVR_OPTION_VERSION));
  return {};
}

}  // namespace Tarvo
