// The verb `show`. A section is asked from the library as a document; tables are made of that.

#include <algorithm>
#include <filesystem>
#include <iostream>
#include <set>
#include <string_view>

#include "Tarvo_KelLibrary_Utils.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_QVRParser.h"
#include "Text.h"
#include "Verb.h"

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
  // The library answers for the first of namesakes alone, so a second line would show it twice.
  std::set<StringBase> seen;
  for (const StringBase& name : names) {
    if (seen.insert(name).second) visit(name);
  }
}

// The questions for one kind of record.
using List = bool (KelIP::*)(StringList&) const;
using ListOf = bool (KelIP::*)(const StringBase&, StringList&) const;
using Get = bool (KelIP::*)(const StringBase&, const StringBase&, StringBase&) const;

template <class Question, class... Record>
StringList Ask(const KelIP& ip, Question question, const Record&... record) {
  StringList names;
  (ip.*question)(record..., names);
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
// As the port writes them, whether anything declares them or not: `check` tells of those that
// nobody does.
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
// In the order in which they are shown.
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

// A section is an object of names and values, or a list of records, whose members are its columns.
// Of namesakes the first alone counts, for records, properties and options alike.
struct Section {
  const char* name;
  Json (*make)(const KelLibrary& library, const KelIP& ip);
  std::vector<std::string> columns;
};
const Section kSections[] = {
    {"place", Place, {"name", "value"}},
    {"options", OfInstance<Options>, {"name", "value"}},
    {"parameters",
     OfInstance<Parameters>,
     {"name", "value", "default_value", "generic", "description"}},
    {"ports", OfInstance<Ports>, {"name", "direction", "vector", "interfaces", "description"}},
    {"interfaces", OfInstance<Interfaces>, {"name", "kind", "parameters", "ports", "description"}}};

Choices Sections() {
  Choices choices;
  for (const Section& section : kSections) choices.push_back({section.name, Join(section.columns)});
  return choices;
}

// The key, and a member for each section that the request names, or for all of them.
Json Describe(const KelLibrary& library, const Request& request, const KelIP& ip) {
  Json core = {{"key", Text(ip.GetKey())}};
  const std::vector<std::string>& chosen = request.Values("--section");
  for (const Section& section : kSections) {
    const bool isWanted =
        chosen.empty() || std::find(chosen.begin(), chosen.end(), section.name) != chosen.end();
    if (isWanted) core[section.name] = section.make(library, ip);
  }
  return core;
}

// A heading begins with a mark that no name begins with. A section that stands alone needs none.
void WriteTables(const Json& core, bool withHeadings) {
  for (const Section& section : kSections) {
    if (!core.contains(section.name)) continue;
    const Json& members = core[section.name];
    // A heading without rows helps nobody.
    if (members.empty()) continue;
    if (withHeadings) std::cout << "# " << section.name << ": " << Join(section.columns) << '\n';
    TableOf(members, section.columns).Write();
  }
}

Status Show(const KelLibrary& library, const Request& request) {
  const std::unique_ptr<KelIP> ip = OpenCore(library, request.Value("KEY"));
  if (!ip) return StatusFindings;
  const Json core = Describe(library, request, *ip);
  if (request.Has("--json")) {
    WriteJson(core);
  } else {
    WriteTables(core, request.Values("--section").size() != 1);
  }
  return StatusClean;
}

}  // namespace

Verb DescribeShow() {
  return {.name = "show",
          .help = "Shows all about a core: place, options, parameters, ports, interfaces",
          .words = {KeyWord(),
                    {.name = "--section",
                     .value = "SECTION",
                     .help = "Show this section only; may be repeated",
                     .isRepeated = true,
                     .choices = Sections}},
          .example = "show event_station --section ports",
          .answer = Show};
}
