#ifndef TARVO_KELIP_H
#define TARVO_KELIP_H

#include <memory>
#include <vector>

#include "Tarvo_Export.h"
#include "Tarvo_KelRecords.h"

namespace Tarvo {

class Kel_Index;
class KelIPImpl;

// One version of one IP core, opened: answers for its options, parameters, generics, ports, bus and
// I/O interfaces, HDL sources and netlists.
//
//     const std::unique_ptr<Tarvo::KelIP> ip(library.CreateIP("pulse_counter"));
//     Tarvo::StringList ports;
//     if (ip && ip->ListPorts(ports)) ...
//
// What the questions mean (records, properties, defaults, first matches) is told in QVRParser,
// which the answers come from. They are those of the core description as it was when the instance
// was made, with the parameters as they were set since; nothing is written to any file.
//
// Results: true with the output replaced by the answer, which may be empty; false with an empty
// output, and a message that says why. Get operations on a record's property and
// SetParameterProperty issue a warning, all others an error; what arrives without a text of its own
// is always an error. Operations that may give false without a message say so. An argument may be
// the output itself or lie in it.
//
// Failures: the constructor and the operations that say so throw; all others throw nothing. A
// text that is given as `const char*` becomes a string at the call, which may throw std::bad_alloc
// there.
//
// Lifetime: the caller owns the instance, and destroys it before the library that made it. Across a
// refresh of the library an instance keeps its key, location and description. Sources and netlists
// are read, at the first question for them, from where the library then says, and later changes of
// the files are not seen; questions for libraries ask it each time. Threads: for one at a time,
// also for const operations; separate instances of one library may not work at the same time as a
// refresh of it.
class TARVO_EXPORT KelIP {
 public:
  // Properties of a core that its key gives: NAME, VERSION.
  static const StringBase KEL_IP_NAME;
  static const StringBase KEL_IP_VERSION;
  // The option STYLE, and its values HDL (sources), BLACKBOX (netlists) and MIX (both).
  static const StringBase KEL_STYLE_OPTION_NAME;
  static const StringBase KEL_STYLE_OPTION_VALUE_HDL;
  static const StringBase KEL_STYLE_OPTION_VALUE_BLACKBOX;
  static const StringBase KEL_STYLE_OPTION_VALUE_MIX;
  // The option HDL, which names the language of the sources (see LDXParser).
  static const StringBase KEL_LANGUAGE_OPTION_NAME;
  // Properties of a source: LIBRARY, LANGUAGE, FILENAME_HEAD, FILENAME_TAIL; of a netlist: LIBRARY.
  static const StringBase KEL_HDL_LIBRARY_PROPERTY;
  static const StringBase KEL_HDL_LANGUAGE_PROPERTY;
  static const StringBase KEL_HDL_FILENAME_HEAD_PROPERTY;
  static const StringBase KEL_HDL_FILENAME_TAIL_PROPERTY;
  static const StringBase KEL_NETLIST_LIBRARY_PROPERTY;

  // Opens the version that a key stands for, a bare core name being that core's newest. Throws
  // AppException if the index doesn't know the key, or if the core description is missing or bad;
  // KelLibrary::CreateIP turns that into a message. The index must outlive the instance.
  KelIP(const Kel_Index& index, const StringBase& key);
  ~KelIP();
  KelIP(const KelIP&) = delete;
  KelIP& operator=(const KelIP&) = delete;

  // The absolute directory of the version, its full key, the base name of its core, and its
  // version as dotted text such as "1.00.a". They stay what they were when the instance was made.
  // May throw std::bad_alloc; GetLocation throws std::filesystem::filesystem_error as well, if the
  // repository was given relative to a current directory that is gone.
  StringBase GetLocation() const;
  StringBase GetKey() const;
  StringBase GetName() const;
  StringBase GetVersion() const;

  // NAME and VERSION are those of the key; all other properties of the core are its options, those
  // of the description first, then the missing defaults. GetIPProperty gives false without a
  // message for an option whose value is empty.
  bool GetIPProperty(const StringBase& name, StringBase& value) const;
  bool ListIPProperties(StringList& list) const;

  bool GetParameterProperty(const StringBase& parameter, const StringBase& property,
                            StringBase& value) const;
  // Sets a property of that parameter alone, as QVRParser::SetParameterProperty does; the generic
  // of that name stays as it is. Whatever follows from the property changes with it: the members of
  // interfaces from BUS and IO_IF, the netlists that apply from VALUE.
  bool SetParameterProperty(const StringBase& parameter, const StringBase& property,
                            const StringBase& value);
  bool ListParameters(StringList& list) const;
  bool ListParameterProperties(const StringBase& parameter, StringList& list) const;

  // Generics are the parameters that the HDL sources see.
  bool GetGenericProperty(const StringBase& generic, const StringBase& property,
                          StringBase& value) const;
  bool ListGenerics(StringList& list) const;
  bool ListGenericProperties(const StringBase& generic, StringList& list) const;

  // DIR is a port's direction, VEC its range of bits, and DESC describes what has it: they are
  // handed on as the description states them, and so is any other property.
  bool GetPortProperty(const StringBase& port, const StringBase& property, StringBase& value) const;
  bool ListPorts(StringList& list) const;
  bool ListPortProperties(const StringBase& port, StringList& list) const;

  // The members of an interface are the parameters and ports that name it.
  bool GetBusInterfaceProperty(const StringBase& interface, const StringBase& property,
                               StringBase& value) const;
  bool ListBusInterfaces(StringList& list) const;
  bool ListBusInterfaceProperties(const StringBase& interface, StringList& list) const;
  bool ListBusInterfaceParameters(const StringBase& interface, StringList& list) const;
  bool ListBusInterfacePorts(const StringBase& interface, StringList& list) const;

  bool GetIOInterfaceProperty(const StringBase& interface, const StringBase& property,
                              StringBase& value) const;
  bool ListIOInterfaces(StringList& list) const;
  bool ListIOInterfaceProperties(const StringBase& interface, StringList& list) const;
  bool ListIOInterfaceParameters(const StringBase& interface, StringList& list) const;
  bool ListIOInterfacePorts(const StringBase& interface, StringList& list) const;

  // Only a core whose option STYLE is HDL, the default, or MIX has HDL sources; letter case does
  // not matter. Any other core has none: false without a message. The analyse order is read by the
  // first question that needs it (see LDXParser); if that fails, the next question tries again.
  //
  // Absolute paths of the sources in analyse order (compile order), and absolute directories of the
  // libraries that they belong to, in the same order.
  bool ListSynthesisSources(StringList& list) const;
  bool ListSimulationSources(StringList& list) const;
  bool ListSynthesisLibraries(StringList& list) const;
  bool ListSimulationLibraries(StringList& list) const;
  // The libraries that are given a Verilog include directory, as keys or bare names, and the
  // absolute directory of one: that one, or else the library's own directory.
  bool ListVerilogIncludeLibraries(StringList& list) const;
  bool GetVerilogIncludeLocation(const StringBase& library, StringBase& value) const;
  // LIBRARY is the key of the library that a listed source belongs to. LANGUAGE ("Verilog" or
  // "VHDL", by the extension), FILENAME_HEAD and FILENAME_TAIL follow from the path alone, listed
  // or not. False without a message if there is no such value or property. The list has all four
  // names for a source that belongs to a library, and is false without a message for any other.
  bool GetSourceProperty(const StringBase& source, const StringBase& property,
                         StringBase& value) const;
  bool ListSourceProperties(const StringBase& source, StringList& list) const;

  // Netlists, of a core whose option STYLE is BLACKBOX or MIX. Any other core has none: false
  // without a message. The table is read by the first question that needs it (see TEWParser), and
  // each answer holds for the parameters' values of that moment.
  //
  // Absolute paths of the netlists that apply, and absolute directories of their libraries, sorted,
  // each once.
  bool ListNetlists(StringList& list) const;
  bool ListNetlistLibraries(StringList& list) const;
  // LIBRARY is the key of the library that a netlist belongs to; a netlist that does not
  // apply is an error, here and in ListNetlistProperties. False without a message for any other
  // property; the list is that one name.
  bool GetNetlistProperty(const StringBase& netlist, const StringBase& property,
                          StringBase& value) const;
  bool ListNetlistProperties(const StringBase& netlist, StringList& list) const;

  // The statements, sources, includes and netlists themselves, each with the file and line that
  // states it. They answer, fail and are cleared as the operations above do, with the same
  // messages: those for sources as ListSynthesisSources, ListSimulationSources and
  // ListVerilogIncludeLibraries, that for the table as ListNetlists.
  //
  // All statements of the description, in the order of the file.
  bool GetStatements(std::vector<KelStatement>& statements) const;
  // The sources in analyse order (compile order).
  bool GetSynthesisSources(std::vector<KelSource>& sources) const;
  bool GetSimulationSources(std::vector<KelSource>& sources) const;
  bool GetVerilogIncludeDirectories(std::vector<KelIncludeDirectory>& directories) const;
  // The cores whose whole order the core's own file takes over, in the order of its lines.
  bool GetIncludes(std::vector<KelInclude>& includes) const;
  // The whole table, with the rows that apply at the present values marked.
  bool GetNetlistTable(KelNetlistTable& table) const;

  // Replace the list by the names of all properties that have a meaning for a kind of element, the
  // same for every core. Always true; may throw std::bad_alloc.
  bool ListAllParameterProperties(StringList& list) const;
  bool ListAllGenericProperties(StringList& list) const;
  bool ListAllPortProperties(StringList& list) const;
  bool ListAllBusInterfaceProperties(StringList& list) const;
  bool ListAllIOInterfaceProperties(StringList& list) const;
  bool ListAllSourceProperties(StringList& list) const;
  bool ListAllNetlistProperties(StringList& list) const;

 private:
  std::unique_ptr<KelIPImpl> impl;
};

}  // namespace Tarvo

#endif
