#include "Tarvo_KnownProperties.h"

#include "Tarvo_LDXParser_Hdl.h"
#include "Tarvo_OptionScanner.h"
#include "Tarvo_QVRParser.h"

namespace Tarvo {

namespace {

using O = OptionScanner;
using Q = QVRParser;

bool IsVector(const PropertyList& port) {
  const StringBase* const range = FindValue(port, Q::QVR_PORT_VEC);
  return range != nullptr && range->GetLength() > 0;
}

bool IsInterrupt(const PropertyList& port) {
  const StringBase* const signal = FindValue(port, Q::QVR_PORT_SIGIS);
  return signal != nullptr && EqualsIgnoringCase(*signal, Q::QVR_PORT_SIGIS_INTERRUPT);
}

// A row for each property, {name, default, when the default counts}; most have a name alone. Their
// order is that of the lists that callers get.

const KnownProperty kOptions[] = {
    "NAME",
    "VERSION",
    "ALERT",
    "ARCH_SUPPORT",
    "ARCH_SUPPORT_MAP",
    "BUS_STD",
    "CORE_STATE",
    "DESC",
    "EARLY_ACCESS_ARCH_SUPPORT",
    kLanguageOption,
    {Q::QVR_OPTION_IMP_NETLIST, &Q::QVR_FALSE},
    "IP_GROUP",
    "IPLEVEL_DRC_PROC",
    "IPTYPE",
    "LAST_UPDATED",
    "LONG_DESC",
    "MAX_MASTERS",
    "MAX_SLAVES",
    {Q::QVR_OPTION_RUN_TRAMFOLD, &Q::QVR_FALSE},
    "SPECIAL",
    {Q::QVR_OPTION_STYLE, &Q::QVR_OPTION_STYLE_HDL},
    "SYSLEVEL_DRC_PROC",
    "TCL_FILE",
    {Q::QVR_OPTION_USAGE_LEVEL, &O::QVR_OPTION_USAGE_LEVEL_ADVANCED},
};

const KnownProperty kParameter[] = {
    Q::QVR_PROPERTY_NAME,
    Q::QVR_PROPERTY_VALUE,
    Q::QVR_PROPERTY_DEFAULT,
    "ADDRESS",
    "ADDR_TYPE",
    {Q::QVR_ASSIGNMENT, &Q::QVR_ASSIGNMENT_OPTIONAL},
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
    {Q::QVR_ISVALID, &Q::QVR_TRUE},
    "LONG_DESC",
    "MIN_SIZE",
    "PAIR",
    {Q::QVR_PERMIT, &Q::QVR_PERMIT_ADVANCED_USER},
    "RANGE",
    "SYSLEVEL_UPDATE_PROC",
    {Q::QVR_PARAMETER_TYPE, &Q::QVR_PARAMETER_TYPE_HDL},
    "VALUES",
};

const KnownProperty kPort[] = {
    Q::QVR_PROPERTY_NAME,
    {Q::QVR_ASSIGNMENT, &Q::QVR_ASSIGNMENT_OPTIONAL},
    "BUFFER_TYPE",
    Q::QVR_BUS_IF_NAME,
    Q::QVR_BUS_IF_ROLE_NAME,
    "CLK_FACTOR",
    "CLK_INPORT",
    "CLK_PHASE",
    "DESC",
    "DIR",
    {Q::QVR_PORT_ENABLE, &Q::QVR_PORT_ENABLE_SINGLE},
    {Q::QVR_PORT_ENDIAN, &Q::QVR_PORT_ENDIAN_BIG, IsVector},
    {Q::QVR_PORT_INITIALVAL, &Q::QVR_PORT_INITIALVAL_GND},
    {Q::QVR_PORT_INTERRUPT_PRIORITY, &Q::QVR_PORT_INTERRUPT_PRIORITY_MEDIUM, IsInterrupt},
    Q::QVR_IO_IF_NAME,
    Q::QVR_IO_IF_ROLE_NAME,
    "IOB_STATE",
    {Q::QVR_ISVALID, &Q::QVR_TRUE},
    "LONG_DESC",
    {Q::QVR_PERMIT, &Q::QVR_PERMIT_ADVANCED_USER},
    "SENSITIVITY",
    Q::QVR_PORT_SIGIS,
    "THREE_STATE",
    "TRI_I",
    "TRI_O",
    "TRI_T",
    Q::QVR_PORT_VEC,
};

const KnownProperty kBusInterface[] = {
    Q::QVR_PROPERTY_NAME,
    Q::QVR_BUS_IF_NAME,
    "BUS_STD",
    "BUS_TYPE",
    "DESC",
    "EXCLUDE_BUSIF",
    "GENERATE_BURSTS",
    {Q::QVR_ISVALID, &Q::QVR_TRUE},
    "LONG_DESC",
    {Q::QVR_BUS_INTERFACE_SHARES_ADDR, &Q::QVR_BUS_INTERFACE_SHARES_ADDR_ALL},
};

const KnownProperty kIoInterface[] = {
    Q::QVR_PROPERTY_NAME,           Q::QVR_IO_IF_NAME, "IO_TYPE", "DESC", "EXCLUDE_IOIF",
    {Q::QVR_ISVALID, &Q::QVR_TRUE}, "LONG_DESC",
};

}  // namespace

KnownPropertyRows KnownProperties::OfCores() { return kOptions; }

KnownPropertyRows KnownProperties::OfParameters() { return kParameter; }

KnownPropertyRows KnownProperties::OfPorts() { return kPort; }

KnownPropertyRows KnownProperties::OfBusInterfaces() { return kBusInterface; }

KnownPropertyRows KnownProperties::OfIoInterfaces() { return kIoInterface; }

}  // namespace Tarvo
