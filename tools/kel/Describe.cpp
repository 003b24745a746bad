#include "Describe.h"

#include <algorithm>
#include <filesystem>
#include <set>
#include <string_view>

#include "Tarvo_KelLibrary_Utils.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_QVRParser.h"
#include "Text.h"

namespace {

namespace fs = std::filesystem;
using Tarvo::Kel_Key;
using Tarvo::KelIP;
using Tarvo::KelLibrary;
using Tarvo::QVRParser;
using Tarvo::StringBase;
using Tarvo::StringList;

// Gives `visit` each name once.
template <class Visit>
void ForEachName(const StringList& names, const Visit& visit) {
  std::set<StringBase> seen;
  for (const StringBase& name : names) {
    if (seen.insert(name).second) visit(name);
  }
}

// The questions for one kind of record.
using List = bool (KelIP::*)(StringList&) const;
using ListOf = bool (KelIP::*)(const StringBase&, StringList&) const;
using Get = bool (KelIP::*)(const StringBase&, const StringBase&, StringBase&) const;

StringList Ask(const KelIP& ip, List list) {
  StringList names;
  (ip.*list)(names);
  return names;
}

StringList Ask(const KelIP& ip, ListOf list, const StringBase& record) {
  StringList names;
  (ip.*list)(record, names);
  return names;
}

Json Properties(const KelIP& ip, ListOf list, Get get, const StringBase& record) {
  Json properties = Json::object();
  ForEachName(Ask(ip, list, record), [&](const StringBase& name) {
    StringBase value;
    (ip.*get)(record, name, value);
    properties[Text(name)] = Text(value);
  });
  return properties;
}

// The value of a property that a record may have.
std::string Value(const Json& properties, const StringBase& name) {
  return properties.value(Text(name), std::string());
}

Json Options(const KelIP& ip) {
  Json options = Json::object();
  ForEachName(Ask(ip, &KelIP::ListIPProperties), [&](const StringBase& name) {
    StringBase value;
    ip.GetIPProperty(name, value);
    options[Text(name)] = Text(value);
  });
  return options;
}

Json Parameters(const KelIP& ip) {
  const StringList generics = Ask(ip, &KelIP::ListGenerics);
  const std::set<StringBase> isGeneric(generics.begin(), generics.end());
  Json parameters = Json::array();
  ForEachName(Ask(ip, &KelIP::ListParameters), [&](const StringBase& name) {
    const Json properties =
        Properties(ip, &KelIP::ListParameterProperties, &KelIP::GetParameterProperty, name);
    parameters.push_back({{"name", Text(name)},
                          {"value", Value(properties, QVRParser::QVR_PROPERTY_VALUE)},
                          {"default_value", Value(properties, QVRParser::QVR_PROPERTY_DEFAULT)},
                          {"generic", isGeneric.contains(name)},
                          {"properties", properties}});
  });
  return parameters;
}

// The interfaces that a port names, bus interfaces first.
Json InterfacesOf(const Json& port) {
  Json names = Json::array();
  for (const StringBase* key : {&QVRParser::QVR_BUS_IF_NAME, &QVRParser::QVR_IO_IF_NAME}) {
    const StringBase value(std::string_view(Value(port, *key)));
    for (const StringBase& name : Tarvo::KelLibrary_Utils::GetInterfaceVector(value)) {
      names.push_back(Text(name));
    }
  }
  return names;
}

Json Ports(const KelIP& ip) {
  Json ports = Json::array();
  ForEachName(Ask(ip, &KelIP::ListPorts), [&](const StringBase& name) {
    const Json properties =
        Properties(ip, &KelIP::ListPortProperties, &KelIP::GetPortProperty, name);
    ports.push_back({{"name", Text(name)},
                     {"direction", Value(properties, "DIR")},
                     {"vector", Value(properties, QVRParser::QVR_PORT_VEC)},
                     {"default", Value(properties, QVRParser::QVR_BUS_IF_ROLE_NAME)},
                     {"interfaces", InterfacesOf(properties)},
                     {"properties", properties}});
  });
  return ports;
}

// Bus and I/O interfaces are asked for by the same questions.
struct InterfaceKind {
  const char* name;
  List list;
  ListOf listProperties;
  Get get;
  ListOf listParameters;
  ListOf listPorts;
};
const InterfaceKind kInterfaceKinds[] = {
    {"bus", &KelIP::ListBusInterfaces, &KelIP::ListBusInterfaceProperties,
     &KelIP::GetBusInterfaceProperty, &KelIP::ListBusInterfaceParameters,
     &KelIP::ListBusInterfacePorts},
    {"io", &KelIP::ListIOInterfaces, &KelIP::ListIOInterfaceProperties,
     &KelIP::GetIOInterfaceProperty, &KelIP::ListIOInterfaceParameters,
     &KelIP::ListIOInterfacePorts}};

Json Interfaces(const KelIP& ip) {
  Json interfaces = Json::array();
  for (const InterfaceKind& kind : kInterfaceKinds) {
    ForEachName(Ask(ip, kind.list), [&](const StringBase& name) {
      interfaces.push_back({{"name", Text(name)},
                            {"kind", kind.name},
                            {"parameters", Texts(Ask(ip, kind.listParameters, name))},
                            {"ports", Texts(Ask(ip, kind.listPorts, name))},
                            {"properties", Properties(ip, kind.listProperties, kind.get, name)}});
    });
  }
  return interfaces;
}

Json Place(const KelLibrary& library, const KelIP& ip) {
  const Kel_Key key(ip.GetKey());
  const std::string location = Text(ip.GetLocation());
  Json hidden = Json::array();
  for (const Port::FileName& directory : library.GetIndex().GetHiddenLocations(key)) {
    hidden.push_back(Text(directory.GetAbsolutePath()));
  }
  Json others = Json::array();
  StringList keys;
  library.ListAllIPKeys(keys);
  for (const StringBase& text : keys) {
    const Kel_Key other(text);
    if (other.GetName() == key.GetName() && other != key) others.push_back(Text(text));
  }
  return {{"name", Text(ip.GetName())},
          {"version", Text(ip.GetVersion())},
          {"location", location},
          {"repository", fs::path(location).parent_path().parent_path().string()},
          {"hides", hidden},
          {"other_versions", others}};
}

// A section that the instance alone can tell.
template <Json (*Tell)(const KelIP&)>
Json OfInstance(const KelLibrary& /*library*/, const KelIP& ip) {
  return Tell(ip);
}

struct Section {
  const char* name;
  Json (*make)(const KelLibrary& library, const KelIP& ip);
};
const Section kMakers[] = {{"place", Place},
                           {"options", OfInstance<Options>},
                           {"parameters", OfInstance<Parameters>},
                           {"ports", OfInstance<Ports>},
                           {"interfaces", OfInstance<Interfaces>}};

}  // namespace

std::vector<std::string> SectionNames() {
  std::vector<std::string> names;
  for (const Section& section : kMakers) names.emplace_back(section.name);
  return names;
}

Json Describe(const KelLibrary& library, const Call& call, const KelIP& ip) {
  Json core = {{"key", Text(ip.GetKey())}};
  for (const Section& section : kMakers) {
    const auto& chosen = call.sections;
    const bool isWanted =
        chosen.empty() || std::find(chosen.begin(), chosen.end(), section.name) != chosen.end();
    if (isWanted) core[section.name] = section.make(library, ip);
  }
  return core;
}
