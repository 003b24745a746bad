// Records are lists of properties, as stated. Defaults are never stored: they are looked up behind
// what is stated, so that a list of a record's properties and a question for one of them can't
// differ.

#include "Tarvo_QVRParser.h"

#include <algorithm>
#include <initializer_list>
#include <string_view>
#include <utility>

#include "Port_Input.h"
#include "Tarvo_FileScanner.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_KnownProperties.h"
#include "Tarvo_NameTable.h"
#include "Tarvo_PropertyList.h"
#include "Tarvo_QVRStatement.h"
#include "Tarvo_Report.h"
#include "Tarvo_TellFault.h"
#include "Tarvo_TokenReader.h"
#include "Tarvo_Word.h"

namespace Tarvo {

const StringBase QVRParser::QVR_TRUE = "TRUE";
const StringBase QVRParser::QVR_FALSE = "FALSE";
const StringBase QVRParser::QVR_PROPERTY_NAME = "NAME";
const StringBase QVRParser::QVR_PROPERTY_VALUE = "VALUE";
const StringBase QVRParser::QVR_PROPERTY_DEFAULT = "DEFAULT_VALUE";
const StringBase QVRParser::QVR_PROPERTY_VERSION = "VERSION";
const StringBase QVRParser::QVR_BUS_IF_NAME = "BUS";
const StringBase QVRParser::QVR_BUS_IF_ROLE_NAME = "DEFAULT";
const StringBase QVRParser::QVR_IO_IF_NAME = "IO_IF";
const StringBase QVRParser::QVR_IO_IF_ROLE_NAME = "IO_IS";
const StringBase QVRParser::QVR_ASSIGNMENT = "ASSIGNMENT";
const StringBase QVRParser::QVR_ASSIGNMENT_OPTIONAL = "OPTIONAL";
const StringBase QVRParser::QVR_ISVALID = "ISVALID";
const StringBase QVRParser::QVR_PERMIT = "PERMIT";
const StringBase QVRParser::QVR_PERMIT_ADVANCED_USER = "ADVANCED_USER";
const StringBase QVRParser::QVR_OPTION_IMP_NETLIST = "IMP_NETLIST";
const StringBase QVRParser::QVR_OPTION_RUN_TRAMFOLD = "RUN_TRAMFOLD";
const StringBase QVRParser::QVR_OPTION_STYLE = "STYLE";
const StringBase QVRParser::QVR_OPTION_STYLE_HDL = "HDL";
const StringBase QVRParser::QVR_OPTION_USAGE_LEVEL = "USAGE_LEVEL";
const StringBase QVRParser::QVR_PARAMETER_TYPE = "TYPE";
const StringBase QVRParser::QVR_PARAMETER_TYPE_HDL = "HDL";
const StringBase QVRParser::QVR_PARAMETER_TYPE_NON_HDL = "NON_HDL";
const StringBase QVRParser::QVR_BUS_INTERFACE_SHARES_ADDR = "SHARES_ADDR";
const StringBase QVRParser::QVR_BUS_INTERFACE_SHARES_ADDR_ALL = "ALL";
const StringBase QVRParser::QVR_PORT_ENABLE = "ENABLE";
const StringBase QVRParser::QVR_PORT_ENABLE_SINGLE = "SINGLE";
const StringBase QVRParser::QVR_PORT_ENDIAN = "ENDIAN";
const StringBase QVRParser::QVR_PORT_ENDIAN_BIG = "BIG";
const StringBase QVRParser::QVR_PORT_INITIALVAL = "INITIALVAL";
const StringBase QVRParser::QVR_PORT_INITIALVAL_GND = "GND";
const StringBase QVRParser::QVR_PORT_INTERRUPT_PRIORITY = "INTERRUPT_PRIORITY";
const StringBase QVRParser::QVR_PORT_INTERRUPT_PRIORITY_MEDIUM = "MEDIUM";
const StringBase QVRParser::QVR_PORT_SIGIS = "SIGIS";
const StringBase QVRParser::QVR_PORT_SIGIS_INTERRUPT = "INTERRUPT";
const StringBase QVRParser::QVR_PORT_VEC = "VEC";

namespace {

using Q = QVRParser;
using Records = QVRList<QVRRecord>;
using Members = std::vector<std::vector<unsigned>>;

constexpr Report::Module kModule{"s/Tarvo_QVRParser", "1.0"};

// What the kinds of records differ in: how messages call one, its known properties, and for an
// interface the key that names it and that ties its members to it.
struct Kind {
  const char* noun;
  KnownPropertyRows (*known)();
  const StringBase* key = nullptr;
};
const Kind kParameter{"Parameter", KnownProperties::OfParameters};
const Kind kGeneric{"Generic", KnownProperties::OfParameters};
const Kind kBusInterface{"Bus Interface", KnownProperties::OfBusInterfaces, &Q::QVR_BUS_IF_NAME};
const Kind kIoInterface{"I/O Interface", KnownProperties::OfIoInterfaces, &Q::QVR_IO_IF_NAME};
const Kind kPort{"Port", KnownProperties::OfPorts};

// A record that its first pair names. That pair's value stands under each of the value keys, behind
// the name and in front of the other pairs.
QVRRecord MakeNamedByFirst(const QVRStatement::List& list,
                           std::initializer_list<const StringBase*> valueKeys) {
  const QVRStatement::Pair& first = list.pairs.front();
  QVRRecord record{StringBase(first.key), {}, 0};
  PropertyList& properties = record.properties.entries;
  properties.reserve(valueKeys.size() + list.pairs.size());
  properties.emplace_back(Q::QVR_PROPERTY_NAME, record.name);
  for (const StringBase* const key : valueKeys) properties.emplace_back(*key, first.value);
  for (std::size_t i = 1; i < list.pairs.size(); ++i) {
    properties.emplace_back(list.pairs[i].key, list.pairs[i].value);
  }
  NameTable::Make(record.properties);
  return record;
}

// A record that the pair with that key names; the name stands in front of the pair.
QVRRecord MakeNamedByKey(const QVRStatement::List& list, const StringBase& key) {
  QVRRecord record;
  PropertyList& properties = record.properties.entries;
  properties.reserve(list.pairs.size() + 1);
  for (const QVRStatement::Pair& pair : list.pairs) {
    Property property{StringBase(pair.key), StringBase(pair.value)};
    if (EqualsIgnoringCase(property.first, key)) {
      record.name = property.second;
      properties.emplace_back(Q::QVR_PROPERTY_NAME, property.second);
    }
    properties.push_back(std::move(property));
  }
  NameTable::Make(record.properties);
  return record;
}

// Each TYPE counts, not the first alone: NON_HDL anywhere keeps a parameter from the generics.
bool IsGeneric(const QVRRecord& parameter) {
  const PropertyList& properties = parameter.properties.entries;
  return std::none_of(properties.begin(), properties.end(), [](const Property& property) {
    return EqualsIgnoringCase(property.first, Q::QVR_PARAMETER_TYPE) &&
           EqualsIgnoringCase(property.second, Q::QVR_PARAMETER_TYPE_NON_HDL);
  });
}

StringList RecordNames(const Records& records) {
  StringList names;
  names.reserve(records.entries.size());
  for (const QVRRecord& record : records.entries) names.push_back(record.name);
  return names;
}

// The number of the first record of that name.
std::size_t Find(const Records& records, const Kind& kind, const StringBase& name) {
  const std::size_t number = NameTable::Find(records, name.View());
  if (number < records.entries.size()) return number;
  throw Report::Exception(AppException::NotFound, "Cannot find %s %s\n", kind.noun, name);
}

// What the Get of a property and the List of them share, for options too: the same rows.
const StringBase* FindStatedOrDefault(const QVRList<Property>& properties, KnownPropertyRows known,
                                      const StringBase& name) {
  const std::size_t stated = NameTable::Find(properties, name.View());
  return stated < properties.entries.size() ? &properties.entries[stated].second
                                            : FindDefault(properties.entries, known, name);
}

StringList ListStatedAndDefault(const PropertyList& properties, KnownPropertyRows known) {
  StringList names = NamesOf(properties);
  ForEachMissing(properties, known, [&](const StringBase& name, const StringBase& /*value*/) {
    names.push_back(name);
  });
  return names;
}

StringBase GetProperty(const Records& records, const Kind& kind, const StringBase& name,
                       const StringBase& property) {
  const QVRRecord& record = records.entries[Find(records, kind, name)];
  const StringBase* const value = FindStatedOrDefault(record.properties, kind.known(), property);
  if (value) return *value;
  throw Report::Exception(AppException::NotFound, "Cannot find %s %s Property %s\n", kind.noun,
                          name, property);
}

StringList ListProperties(const Records& records, const Kind& kind, const StringBase& name) {
  const QVRRecord& record = records.entries[Find(records, kind, name)];
  return ListStatedAndDefault(record.properties.entries, kind.known());
}

void SetProperty(QVRRecord& record, const StringBase& property, const StringBase& value) {
  // Of several entries of one name the first is the one that counts, so that is the one to change.
  // A new one goes behind all others.
  PropertyList& properties = record.properties.entries;
  const std::size_t stated = NameTable::Find(record.properties, property.View());
  if (stated < properties.size()) {
    properties[stated].second = value;
  } else {
    NameTable::Append(record.properties, Property(property, value));
  }
}

// Gives `tie` the number of each interface that a record belongs to, more than once for one that it
// names several times. Needs no memory.
template <class Tie>
void ForEachTie(const QVRRecord& record, const Records& interfaces, const Kind& kind,
                const Tie& tie) {
  for (const Property& property : record.properties.entries) {
    if (property.first != *kind.key) continue;
    ForEachPiece(property.second.View(), kInterfaceDelimiter, [&](std::string_view name) {
      const std::size_t number = NameTable::Find(interfaces, name);
      if (number < interfaces.entries.size()) tie(number);
    });
  }
}

// Who of the records belongs to each of the interfaces.
Members FindMembers(const Records& interfaces, const Kind& kind, const Records& records) {
  Members members(interfaces.entries.size());
  if (members.empty()) return members;
  for (unsigned number = 0; number < records.entries.size(); ++number) {
    ForEachTie(records.entries[number], interfaces, kind, [&](std::size_t interface) {
      std::vector<unsigned>& of = members[interface];
      if (of.empty() || of.back() != number) of.push_back(number);
    });
  }
  return members;
}

// Sets a property that ties a record to interfaces. All that needs memory comes first, so that
// nothing has changed if it runs out.
void SetTies(Records& records, unsigned number, const StringBase& value, const Records& interfaces,
             const Kind& kind, Members& members) {
  QVRRecord& record = records.entries[number];
  QVRRecord changed = record;
  SetProperty(changed, *kind.key, value);
  const auto forEach = [&](const QVRRecord& tied, const auto& work) {
    ForEachTie(tied, interfaces, kind, [&](std::size_t interface) {
      std::vector<unsigned>& of = members[interface];
      work(of, std::lower_bound(of.begin(), of.end(), number));
    });
  };
  // Room for the new ties; then the old ones go, and the new ones come.
  forEach(changed, [](auto& of, auto) { of.reserve(of.size() + 1); });
  forEach(record, [&](auto& of, auto at) {
    if (at != of.end() && *at == number) of.erase(at);
  });
  std::swap(record, changed);
  forEach(record, [&](auto& of, auto at) {
    if (at == of.end() || *at != number) of.insert(at, number);
  });
}

// The names of the records that belong to a declared interface.
StringList ListMembers(const Records& interfaces, const Kind& kind, const StringBase& interface,
                       const Records& records, const Members& members) {
  // Who asks for the members of an interface that is not declared should hear of it.
  const std::size_t number = Find(interfaces, kind, interface);
  StringList names;
  for (const unsigned member : members[number]) names.push_back(records.entries[member].name);
  return names;
}

}  // namespace

QVRParser::QVRParser(const Kel_Index& index, const Kel_Key& key)
    : QVRParser(
          Kel_Index::GetDataFile(index.GetIPLocation(key), key, Kel_Index::KEL_QVR_EXTENSION)) {}

QVRParser::QVRParser(const Port::FileName& file) : fileName(file.GetName()) {
  TARVO_TRACE("  Parsing QVR File %s\n", fileName);
  Port_Input input(fileName);
  FileScanner lines = ScanFile(file, Codes::kMissingDescription);
  std::string_view line;
  for (unsigned lineNumber = 0; lines.GetNextLine(line, lineNumber);) {
    input.AtLine(lineNumber);
    LineFault fault;
    if (ReadStatement(line, lineNumber, fault)) continue;
    Diagnosis::Add([&] { return TellFault(Codes::kBadStatement, lines, fault); });
    kModule.Error("QVR unparsable %s: %s line %d, %s\n", StringBase(FirstWord(line)), fileName,
                  lineNumber, StringBase(line));
    // A description that was read in part would give wrong answers.
    throw Report::Told(Report::Exception(AppException::Failure, "Invalid QVR %s\n", fileName));
  }
  MakeTables();
  TARVO_TRACE("  Parse successful\n");
}

QVRParser::~QVRParser() = default;

// Any other line is no statement, and ignored.
bool QVRParser::ReadStatement(std::string_view line, unsigned number, LineFault& fault) {
  const QVRStatement::Keyword keyword = QVRStatement::KeywordOf(line);
  if (keyword == QVRStatement::None) return true;
  if (keyword == QVRStatement::Option) return ReadOption(line, number, fault);
  QVRStatement::List list;
  if (!QVRStatement::ReadList(line, list, fault)) return false;
  switch (keyword) {
    case QVRStatement::BusInterface:
      return AddInterface(list, number, QVR_BUS_IF_NAME, busInterfaces, fault);
    case QVRStatement::IoInterface:
      return AddInterface(list, number, QVR_IO_IF_NAME, ioInterfaces, fault);
    case QVRStatement::Port:
      ports.entries.push_back(MakeNamedByFirst(list, {&QVR_BUS_IF_ROLE_NAME}));
      ports.entries.back().line = number;
      return true;
    default:
      AddParameter(list, number);
      return true;
  }
}

bool QVRParser::ReadOption(std::string_view line, unsigned number, LineFault& fault) {
  QVRStatement::OptionText option;
  const auto result =
      QVRStatement::ReadOption(line, QVRStatement::kOptionDelimiters, option, fault);
  if (result != QVRStatement::Read) return false;
  options.entries.push_back(QVRStatement::MakeOption(option));
  // Beside the options, which callers get as plain pairs.
  optionLines.push_back(number);
  return true;
}

void QVRParser::AddParameter(const QVRStatement::List& list, unsigned number) {
  QVRRecord record = MakeNamedByFirst(list, {&QVR_PROPERTY_VALUE, &QVR_PROPERTY_DEFAULT});
  record.line = number;
  // A copy: setting a generic leaves the parameter as it is, and the other way round.
  if (IsGeneric(record)) generics.entries.push_back(record);
  parameters.entries.push_back(std::move(record));
}

bool QVRParser::AddInterface(const QVRStatement::List& list, unsigned number, const StringBase& key,
                             Records& interfaces, LineFault& fault) {
  std::size_t position = 0;
  if (!QVRStatement::FindName(list, key, position, fault)) return false;
  interfaces.entries.push_back(MakeNamedByKey(list, key));
  interfaces.entries.back().line = number;
  return true;
}

// Behind the last line, since an interface may be declared behind its members.
void QVRParser::MakeTables() {
  NameTable::Make(options);
  for (Records* const records : {&generics, &parameters, &ports, &busInterfaces, &ioInterfaces}) {
    NameTable::Make(*records);
  }
  busParameters = FindMembers(busInterfaces, kBusInterface, parameters);
  busPorts = FindMembers(busInterfaces, kBusInterface, ports);
  ioParameters = FindMembers(ioInterfaces, kIoInterface, parameters);
  ioPorts = FindMembers(ioInterfaces, kIoInterface, ports);
}

StringList QVRParser::ListOptions() const {
  return ListStatedAndDefault(options.entries, KnownProperties::OfCores());
}

StringList QVRParser::ListParameters() const { return RecordNames(parameters); }

StringList QVRParser::ListGenerics() const { return RecordNames(generics); }

StringList QVRParser::ListBusInterfaces() const { return RecordNames(busInterfaces); }

StringList QVRParser::ListIoInterfaces() const { return RecordNames(ioInterfaces); }

StringList QVRParser::ListPorts() const { return RecordNames(ports); }

StringBase QVRParser::GetOptionValue(const StringBase& option) const {
  const StringBase* const value = FindStatedOrDefault(options, KnownProperties::OfCores(), option);
  if (value) return *value;
  throw Report::Exception(AppException::NotFound, "Cannot find option %s\n", option);
}

StringBase QVRParser::GetParameterProperty(const StringBase& parameter,
                                           const StringBase& property) const {
  return GetProperty(parameters, kParameter, parameter, property);
}

StringBase QVRParser::GetGenericProperty(const StringBase& generic,
                                         const StringBase& property) const {
  return GetProperty(generics, kGeneric, generic, property);
}

StringBase QVRParser::GetBusInterfaceProperty(const StringBase& interface,
                                              const StringBase& property) const {
  return GetProperty(busInterfaces, kBusInterface, interface, property);
}

StringBase QVRParser::GetIoInterfaceProperty(const StringBase& interface,
                                             const StringBase& property) const {
  return GetProperty(ioInterfaces, kIoInterface, interface, property);
}

StringBase QVRParser::GetPortProperty(const StringBase& port, const StringBase& property) const {
  return GetProperty(ports, kPort, port, property);
}

StringList QVRParser::ListParameterProperties(const StringBase& parameter) const {
  return ListProperties(parameters, kParameter, parameter);
}

StringList QVRParser::ListGenericProperties(const StringBase& generic) const {
  return ListProperties(generics, kGeneric, generic);
}

StringList QVRParser::ListBusInterfaceProperties(const StringBase& interface) const {
  return ListProperties(busInterfaces, kBusInterface, interface);
}

StringList QVRParser::ListIoInterfaceProperties(const StringBase& interface) const {
  return ListProperties(ioInterfaces, kIoInterface, interface);
}

StringList QVRParser::ListPortProperties(const StringBase& port) const {
  return ListProperties(ports, kPort, port);
}

StringList QVRParser::ListBusInterfaceParameters(const StringBase& interface) const {
  return ListMembers(busInterfaces, kBusInterface, interface, parameters, busParameters);
}

StringList QVRParser::ListBusInterfacePorts(const StringBase& interface) const {
  return ListMembers(busInterfaces, kBusInterface, interface, ports, busPorts);
}

StringList QVRParser::ListIoInterfaceParameters(const StringBase& interface) const {
  return ListMembers(ioInterfaces, kIoInterface, interface, parameters, ioParameters);
}

StringList QVRParser::ListIoInterfacePorts(const StringBase& interface) const {
  return ListMembers(ioInterfaces, kIoInterface, interface, ports, ioPorts);
}

// Kept by kind; here they are sorted back into the order of the file.
std::vector<KelStatement> QVRParser::GetStatements() const {
  std::vector<KelStatement> statements;
  const auto add = [&](KelStatement::Kind kind, const StringBase& name, unsigned line) {
    statements.push_back({kind, name, {fileName, line, 0, 0}});
  };
  for (std::size_t i = 0; i < options.entries.size(); ++i) {
    add(KelStatement::Option, options.entries[i].first, optionLines[i]);
  }
  const std::pair<KelStatement::Kind, const Records*> kinds[] = {
      {KelStatement::Parameter, &parameters},
      {KelStatement::Port, &ports},
      {KelStatement::BusInterface, &busInterfaces},
      {KelStatement::IoInterface, &ioInterfaces}};
  for (const auto& [kind, records] : kinds) {
    for (const QVRRecord& record : records->entries) add(kind, record.name, record.line);
  }
  std::sort(statements.begin(), statements.end(),
            [](const KelStatement& left, const KelStatement& right) {
              return left.place.line < right.place.line;
            });
  return statements;
}

void QVRParser::SetParameterProperty(const StringBase& parameter, const StringBase& property,
                                     const StringBase& value) {
  const auto number = static_cast<unsigned>(Find(parameters, kParameter, parameter));
  if (property == QVR_BUS_IF_NAME) {
    SetTies(parameters, number, value, busInterfaces, kBusInterface, busParameters);
  } else if (property == QVR_IO_IF_NAME) {
    SetTies(parameters, number, value, ioInterfaces, kIoInterface, ioParameters);
  } else {
    SetProperty(parameters.entries[number], property, value);
  }
}

void QVRParser::SetGenericProperty(const StringBase& generic, const StringBase& property,
                                   const StringBase& value) {
  SetProperty(generics.entries[Find(generics, kGeneric, generic)], property, value);
}

}  // namespace Tarvo
