// The catalogues of property names that KelIP exports. They are the vocabulary of the core
// description; no reader asks them, only the checker.

#include <iterator>
#include <utility>

#include "Tarvo_KelIP.h"
#include "Tarvo_PropertyNames.h"
#include "Tarvo_QVRParser.h"

namespace Tarvo {

namespace {

using Q = QVRParser;

// A name of a catalogue: an exported constant where there is one, so that both stay one text.
class Name {
 public:
  constexpr Name(const StringBase& exported) : constant(&exported) {}
  constexpr Name(const char* text) : literal(text) {}
  operator StringBase() const { return constant ? *constant : StringBase(literal); }

 private:
  const StringBase* constant = nullptr;
  const char* literal = nullptr;
};

const Name kCoreProperties[] = {"NAME",
                                "VERSION",
                                "ALERT",
                                "ARCH_SUPPORT",
                                "ARCH_SUPPORT_MAP",
                                "BUS_STD",
                                "CORE_STATE",
                                "DESC",
                                "EARLY_ACCESS_ARCH_SUPPORT",
                                "HDL",
                                "IMP_NETLIST",
                                "IP_GROUP",
                                "IPLEVEL_DRC_PROC",
                                "IPTYPE",
                                "LAST_UPDATED",
                                "LONG_DESC",
                                "MAX_MASTERS",
                                "MAX_SLAVES",
                                "RUN_TRAMFOLD",
                                "SPECIAL",
                                "STYLE",
                                "SYSLEVEL_DRC_PROC",
                                "TCL_FILE",
                                "USAGE_LEVEL"};

const Name kParameterProperties[] = {Q::QVR_PROPERTY_NAME,
                                     Q::QVR_PROPERTY_VALUE,
                                     Q::QVR_PROPERTY_DEFAULT,
                                     "ADDRESS",
                                     "ADDR_TYPE",
                                     "ASSIGNMENT",
                                     "BRIDGE_TO",
                                     Q::QVR_BUS_IF_NAME,
                                     "CACHEABLE",
                                     "CLK_PORT",
                                     "CLK_UNIT",
                                     "DESC",
                                     "DT",
                                     Q::QVR_IO_IF_NAME,
                                     Q::QVR_IO_IF_ROLE_NAME,
                                     "IPLEVEL_UPDATE_PROC",
                                     "ISVALID",
                                     "LONG_DESC",
                                     "MIN_SIZE",
                                     "PAIR",
                                     "PERMIT",
                                     "RANGE",
                                     "SYSLEVEL_UPDATE_PROC",
                                     Q::QVR_PARAMETER_TYPE,
                                     "VALUES"};

const Name kPortProperties[] = {Q::QVR_PROPERTY_NAME,
                                "ASSIGNMENT",
                                "BUFFER_TYPE",
                                Q::QVR_BUS_IF_NAME,
                                Q::QVR_BUS_IF_ROLE_NAME,
                                "CLK_FACTOR",
                                "CLK_INPORT",
                                "CLK_PHASE",
                                "DESC",
                                "DIR",
                                "ENABLE",
                                "ENDIAN",
                                "INITIALVAL",
                                "INTERRUPT_PRIORITY",
                                Q::QVR_IO_IF_NAME,
                                Q::QVR_IO_IF_ROLE_NAME,
                                "IOB_STATE",
                                "ISVALID",
                                "LONG_DESC",
                                "PERMIT",
                                "SENSITIVITY",
                                "SIGIS",
                                "THREE_STATE",
                                "TRI_I",
                                "TRI_O",
                                "TRI_T",
                                "VEC"};

const Name kBusInterfaceProperties[] = {
    Q::QVR_PROPERTY_NAME, Q::QVR_BUS_IF_NAME, "BUS_STD", "BUS_TYPE",  "DESC",
    "EXCLUDE_BUSIF",      "GENERATE_BURSTS",  "ISVALID", "LONG_DESC", "SHARES_ADDR"};

const Name kIOInterfaceProperties[] = {Q::QVR_PROPERTY_NAME, Q::QVR_IO_IF_NAME, "IO_TYPE",  "DESC",
                                       "EXCLUDE_IOIF",       "ISVALID",         "LONG_DESC"};

const Name kSourceProperties[] = {KelIP::KEL_HDL_LIBRARY_PROPERTY, KelIP::KEL_HDL_LANGUAGE_PROPERTY,
                                  KelIP::KEL_HDL_FILENAME_HEAD_PROPERTY,
                                  KelIP::KEL_HDL_FILENAME_TAIL_PROPERTY};

const Name kNetlistProperties[] = {KelIP::KEL_NETLIST_LIBRARY_PROPERTY};

template <class Catalogue>
StringList ListOf(const Catalogue& catalogue) {
  return StringList(std::begin(catalogue), std::end(catalogue));
}

bool Give(StringList&& names, StringList& list) {
  list = std::move(names);
  return true;
}

}  // namespace

StringList PropertyNames::OfCores() { return ListOf(kCoreProperties); }

StringList PropertyNames::OfParameters() { return ListOf(kParameterProperties); }

StringList PropertyNames::OfPorts() { return ListOf(kPortProperties); }

StringList PropertyNames::OfBusInterfaces() { return ListOf(kBusInterfaceProperties); }

StringList PropertyNames::OfIoInterfaces() { return ListOf(kIOInterfaceProperties); }

// Questions to an instance like the others, though their answers need none of it.
// NOLINTBEGIN(readability-convert-member-functions-to-static)

bool KelIP::ListAllParameterProperties(StringList& list) const {
  return Give(PropertyNames::OfParameters(), list);
}

bool KelIP::ListAllGenericProperties(StringList& list) const {
  return Give(PropertyNames::OfParameters(), list);
}

bool KelIP::ListAllPortProperties(StringList& list) const {
  return Give(PropertyNames::OfPorts(), list);
}

bool KelIP::ListAllBusInterfaceProperties(StringList& list) const {
  return Give(PropertyNames::OfBusInterfaces(), list);
}

bool KelIP::ListAllIOInterfaceProperties(StringList& list) const {
  return Give(PropertyNames::OfIoInterfaces(), list);
}

bool KelIP::ListAllSourceProperties(StringList& list) const {
  return Give(ListOf(kSourceProperties), list);
}

bool KelIP::ListAllNetlistProperties(StringList& list) const {
  return Give(ListOf(kNetlistProperties), list);
}

// NOLINTEND(readability-convert-member-functions-to-static)

}  // namespace Tarvo
