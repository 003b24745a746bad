#ifndef TARVO_QVRPARSER_H
#define TARVO_QVRPARSER_H

#include <string_view>
#include <vector>

#include "Port_FileName.h"
#include "Tarvo_Export.h"
#include "Tarvo_KelRecords.h"

namespace Tarvo {

class Kel_Index;
struct LineFault;
namespace QVRStatement {
struct List;
}

// Entries in their order, and numbers that lead from a name to the first entry that has it.
template <class Entry>
struct QVRList {
  std::vector<Entry> entries;
  std::vector<unsigned> table;
};

// One statement of a core description: its name, and its properties in the order of the line, with
// the fixed ones that its kind adds, and its line.
struct QVRRecord {
  StringBase name;
  QVRList<Property> properties;
  unsigned line = 0;
};

// A core description, read as a whole: options, parameters, generics, ports, bus interfaces and I/O
// interfaces.
//
//     const Tarvo::QVRParser parser(Port::FileName("pulse_counter_v2_1_0.qvr"));
//     for (const auto& port : parser.ListPorts())
//       std::cout << port << ' ' << parser.GetPortProperty(port, "ISVALID") << '\n';
//
// The file has a statement on a line; `#` begins a comment. A line that begins with none of these
// five keywords, in capitals, is ignored. A value of several words stands in quotes, parentheses or
// square brackets, but for that of an option, which runs to the end of the line. In the others the
// list is over at the first word that no comma announces.
//
//     OPTION name = value                   PARAMETER name = value, KEY = value, ...
//     BUS_INTERFACE BUS = name, ...         PORT name = value, KEY = value, ...
//     IO_INTERFACE IO_IF = name, ...
//
// Records: all statements of a kind, in the order of the file, namesakes included; a lookup finds
// the first of them. A parameter is a generic too unless the file gives it the TYPE NON_HDL, be it
// in one of several TYPE entries; the generic is a copy that lives by itself from then on.
//
// Properties: those that the file states and, behind them, the defaults of their kind that it
// leaves out. A stated one is found by its exact name, letter case included, and by its first entry
// if it stands twice. A default is found in any letter case, even where the file states the
// property: with STYLE = MIX stated, "style" still gives HDL. Whatever a List operation names can
// be asked for with the matching Get.
//
//     parameter, generic   NAME, VALUE, DEFAULT_VALUE, then as stated
//                          ASSIGNMENT = OPTIONAL, ISVALID = TRUE, PERMIT = ADVANCED_USER,
//                          TYPE = HDL
//     port                 NAME, DEFAULT (the value behind its name), then as stated
//                          ASSIGNMENT = OPTIONAL, ENABLE = SINGLE, ENDIAN = BIG if VEC is stated
//                          and not empty, INITIALVAL = GND, INTERRUPT_PRIORITY = MEDIUM if SIGIS is
//                          INTERRUPT in any letter case, ISVALID = TRUE, PERMIT = ADVANCED_USER
//     bus interface        as stated, NAME in front of BUS; ISVALID = TRUE, SHARES_ADDR = ALL
//     I/O interface        as stated, NAME in front of IO_IF; ISVALID = TRUE
//     option               a single value; IMP_NETLIST = FALSE, RUN_TRAMFOLD = FALSE, STYLE = HDL,
//                          USAGE_LEVEL = ADVANCED_USER
//
// Failures: a name that is not there throws AppException with level NotFound. Every operation but
// the destructor may throw std::bad_alloc.
//
// Costs: a question costs in proportion to its answer, however large the description is. Tables
// that are made when it is read lead from names to records and properties, and from interfaces to
// members. Setting BUS or IO_IF of a parameter costs in proportion to its properties and to the
// members of the interfaces that they name.
//
// Threads: like an int; several may ask one parser, who sets a property must be alone.
class TARVO_EXPORT QVRParser {
 public:
  static const StringBase QVR_TRUE;
  static const StringBase QVR_FALSE;
  static const StringBase QVR_PROPERTY_NAME;
  static const StringBase QVR_PROPERTY_VALUE;
  static const StringBase QVR_PROPERTY_DEFAULT;  // DEFAULT_VALUE: what the file gave as VALUE
  static const StringBase QVR_PROPERTY_VERSION;
  static const StringBase QVR_BUS_IF_NAME;
  static const StringBase QVR_BUS_IF_ROLE_NAME;  // DEFAULT: a port's role in its bus interfaces
  static const StringBase QVR_IO_IF_NAME;
  static const StringBase QVR_IO_IF_ROLE_NAME;  // IO_IS: a record's role in its I/O interface
  static const StringBase QVR_ASSIGNMENT;
  static const StringBase QVR_ASSIGNMENT_OPTIONAL;
  static const StringBase QVR_ISVALID;
  static const StringBase QVR_PERMIT;
  static const StringBase QVR_PERMIT_ADVANCED_USER;
  static const StringBase QVR_OPTION_IMP_NETLIST;
  static const StringBase QVR_OPTION_RUN_TRAMFOLD;
  static const StringBase QVR_OPTION_STYLE;
  static const StringBase QVR_OPTION_STYLE_HDL;
  static const StringBase QVR_OPTION_USAGE_LEVEL;
  static const StringBase QVR_PARAMETER_TYPE;
  static const StringBase QVR_PARAMETER_TYPE_HDL;
  static const StringBase QVR_PARAMETER_TYPE_NON_HDL;
  static const StringBase QVR_BUS_INTERFACE_SHARES_ADDR;
  static const StringBase QVR_BUS_INTERFACE_SHARES_ADDR_ALL;
  static const StringBase QVR_PORT_ENABLE;
  static const StringBase QVR_PORT_ENABLE_SINGLE;
  static const StringBase QVR_PORT_ENDIAN;
  static const StringBase QVR_PORT_ENDIAN_BIG;
  static const StringBase QVR_PORT_INITIALVAL;
  static const StringBase QVR_PORT_INITIALVAL_GND;
  static const StringBase QVR_PORT_INTERRUPT_PRIORITY;
  static const StringBase QVR_PORT_INTERRUPT_PRIORITY_MEDIUM;
  static const StringBase QVR_PORT_SIGIS;
  static const StringBase QVR_PORT_SIGIS_INTERRUPT;
  static const StringBase QVR_PORT_VEC;

  // Reads a file of any name. Throws AppException with level Failure if the file can't be read, or
  // if a statement is bad: the first bad one is issued as an error with its line, and nothing
  // behind it is read.
  explicit QVRParser(const Port::FileName& file);
  // Reads the description of a version. Throws, besides the above, what Kel_Index::GetIPLocation
  // throws. The index is not kept.
  QVRParser(const Kel_Index& index, const Kel_Key& key);
  ~QVRParser();

  // Names in the order of the file; behind the options the missing defaults. Namesakes are listed
  // each.
  StringList ListOptions() const;
  StringList ListParameters() const;
  StringList ListGenerics() const;
  StringList ListBusInterfaces() const;
  StringList ListIoInterfaces() const;
  StringList ListPorts() const;

  // The value of an option or of a record's property; it may be empty. Throw AppException.
  StringBase GetOptionValue(const StringBase& option) const;
  StringBase GetParameterProperty(const StringBase& parameter, const StringBase& property) const;
  StringBase GetGenericProperty(const StringBase& generic, const StringBase& property) const;
  StringBase GetBusInterfaceProperty(const StringBase& interface, const StringBase& property) const;
  StringBase GetIoInterfaceProperty(const StringBase& interface, const StringBase& property) const;
  StringBase GetPortProperty(const StringBase& port, const StringBase& property) const;

  // The names of a record's properties: the fixed and stated ones in the order of the file,
  // duplicates included, then the missing defaults. Throw AppException.
  StringList ListParameterProperties(const StringBase& parameter) const;
  StringList ListGenericProperties(const StringBase& generic) const;
  StringList ListBusInterfaceProperties(const StringBase& interface) const;
  StringList ListIoInterfaceProperties(const StringBase& interface) const;
  StringList ListPortProperties(const StringBase& port) const;

  // The parameters or ports that belong to a declared interface, in the order of the file: those of
  // whose properties BUS, or IO_IF, in capitals, any names it, alone or among others with colons
  // between. Throw AppException for an interface that the file doesn't declare.
  StringList ListBusInterfaceParameters(const StringBase& interface) const;
  StringList ListBusInterfacePorts(const StringBase& interface) const;
  StringList ListIoInterfaceParameters(const StringBase& interface) const;
  StringList ListIoInterfacePorts(const StringBase& interface) const;

  // All statements as the file has them, options, parameters, ports and interfaces, in the order of
  // its lines. Setting a property changes none of them.
  std::vector<KelStatement> GetStatements() const;

  // Set the first property of exactly that name, or append it to the stated ones. Neither touches
  // the record of the other kind, nor moves one in or out of the generics; setting VALUE leaves
  // DEFAULT_VALUE as the file gave it. Throw AppException; then nothing has changed.
  void SetParameterProperty(const StringBase& parameter, const StringBase& property,
                            const StringBase& value);
  void SetGenericProperty(const StringBase& generic, const StringBase& property,
                          const StringBase& value);

 private:
  using Records = QVRList<QVRRecord>;
  // The numbers of the members of each interface, in their order, by the number of its first
  // record.
  using Members = std::vector<std::vector<unsigned>>;

  TARVO_LOCAL bool ReadStatement(std::string_view line, unsigned number, LineFault& fault);
  TARVO_LOCAL bool ReadOption(std::string_view line, unsigned number, LineFault& fault);
  TARVO_LOCAL void AddParameter(const QVRStatement::List& list, unsigned number);
  TARVO_LOCAL static bool AddInterface(const QVRStatement::List& list, unsigned number,
                                       const StringBase& key, Records& interfaces,
                                       LineFault& fault);
  TARVO_LOCAL void MakeTables();

  StringBase fileName;
  QVRList<Property> options;
  std::vector<unsigned> optionLines;
  Records generics;
  Records parameters;
  Records ports;
  Records busInterfaces;
  Records ioInterfaces;
  Members busParameters;
  Members busPorts;
  Members ioParameters;
  Members ioPorts;
};

}  // namespace Tarvo

#endif
