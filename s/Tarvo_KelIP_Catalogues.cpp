// The catalogues of property names that KelIP exports. They are the vocabulary of the core
// description, and nothing in the library reads them.

#include <iterator>

#include "Tarvo_KelIP.h"
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
bool Give(const Catalogue& catalogue, StringList& list) {
  list.assign(std::begin(catalogue), std::end(catalogue));
  return true;
}

}  // namespace

// Questions to an instance like the others, though their answers need none of it.
// NOLINTBEGIN(readability-convert-member-functions-to-static)

bool KelIP::ListAllParameterProperties(StringList& list) const {
  return Give(kParameterProperties, list);
}

bool KelIP::ListAllGenericProperties(StringList& list) const {
  return Give(kParameterProperties, list);
}

bool KelIP::ListAllPortProperties(StringList& list) const { return Give(kPortProperties, list); }

bool KelIP::ListAllBusInterfaceProperties(StringList& list) const {
  return Give(kBusInterfaceProperties, list);
}

bool KelIP::ListAllIOInterfaceProperties(StringList& list) const {
  return Give(kIOInterfaceProperties, list);
}

bool KelIP::ListAllSourceProperties(StringList& list) const {
  return Give(kSourceProperties, list);
}

bool KelIP::ListAllNetlistProperties(StringList& list) const {
  return Give(kNetlistProperties, list);
}

// NOLINTEND(readability-convert-member-functions-to-static)

}  // namespace Tarvo
