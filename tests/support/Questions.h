#ifndef KEL_TESTS_QUESTIONS_H
#define KEL_TESTS_QUESTIONS_H

#include "Tarvo_KelIP.h"
#include "Tarvo_QVRParser.h"

// The operations of an instance and of its description by what they ask for, so that whoever asks
// everything does so in a loop.
namespace Questions {

using Tarvo::KelIP;
using Tarvo::QVRParser;
using Tarvo::StringBase;
using Tarvo::StringList;

using List = bool (KelIP::*)(StringList&) const;
using ListOf = bool (KelIP::*)(const StringBase&, StringList&) const;
using Get = bool (KelIP::*)(const StringBase&, const StringBase&, StringBase&) const;
using ParserListOf = StringList (QVRParser::*)(const StringBase&) const;
using ParserGet = StringBase (QVRParser::*)(const StringBase&, const StringBase&) const;

// The questions for one kind of element, to an instance and to its description.
struct Kind {
  const char* name;
  const char* noun;  // what messages call one
  List list;
  ListOf listProperties;
  Get get;
  List listAll;
  StringList (QVRParser::*parserList)() const;
  ParserListOf parserListProperties;
  ParserGet parserGet;
};
inline const Kind kKinds[] = {
    {"parameter", "Parameter", &KelIP::ListParameters, &KelIP::ListParameterProperties,
     &KelIP::GetParameterProperty, &KelIP::ListAllParameterProperties, &QVRParser::ListParameters,
     &QVRParser::ListParameterProperties, &QVRParser::GetParameterProperty},
    {"generic", "Generic", &KelIP::ListGenerics, &KelIP::ListGenericProperties,
     &KelIP::GetGenericProperty, &KelIP::ListAllGenericProperties, &QVRParser::ListGenerics,
     &QVRParser::ListGenericProperties, &QVRParser::GetGenericProperty},
    {"port", "Port", &KelIP::ListPorts, &KelIP::ListPortProperties, &KelIP::GetPortProperty,
     &KelIP::ListAllPortProperties, &QVRParser::ListPorts, &QVRParser::ListPortProperties,
     &QVRParser::GetPortProperty},
    {"bus", "Bus Interface", &KelIP::ListBusInterfaces, &KelIP::ListBusInterfaceProperties,
     &KelIP::GetBusInterfaceProperty, &KelIP::ListAllBusInterfaceProperties,
     &QVRParser::ListBusInterfaces, &QVRParser::ListBusInterfaceProperties,
     &QVRParser::GetBusInterfaceProperty},
    {"io", "I/O Interface", &KelIP::ListIOInterfaces, &KelIP::ListIOInterfaceProperties,
     &KelIP::GetIOInterfaceProperty, &KelIP::ListAllIOInterfaceProperties,
     &QVRParser::ListIoInterfaces, &QVRParser::ListIoInterfaceProperties,
     &QVRParser::GetIoInterfaceProperty}};

struct Members {
  const char* name;
  List interfaces;
  ListOf list;
  StringList (QVRParser::*parserInterfaces)() const;
  ParserListOf parserList;
};
inline const Members kMembers[] = {
    {"bus parameters", &KelIP::ListBusInterfaces, &KelIP::ListBusInterfaceParameters,
     &QVRParser::ListBusInterfaces, &QVRParser::ListBusInterfaceParameters},
    {"bus ports", &KelIP::ListBusInterfaces, &KelIP::ListBusInterfacePorts,
     &QVRParser::ListBusInterfaces, &QVRParser::ListBusInterfacePorts},
    {"io parameters", &KelIP::ListIOInterfaces, &KelIP::ListIOInterfaceParameters,
     &QVRParser::ListIoInterfaces, &QVRParser::ListIoInterfaceParameters},
    {"io ports", &KelIP::ListIOInterfaces, &KelIP::ListIOInterfacePorts,
     &QVRParser::ListIoInterfaces, &QVRParser::ListIoInterfacePorts}};

}  // namespace Questions

#endif
