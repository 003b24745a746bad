// Each operation is a guarded row: the output, the failure in its own words, and the question to a
// parser. Parsers are made at the first question that needs them.

#include "Tarvo_KelIP.h"

#include <algorithm>

#include "Port_FileName.h"
#include "Tarvo_Guard.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_KnownProperties.h"
#include "Tarvo_LDXParser.h"
#include "Tarvo_LDXParser_Hdl.h"
#include "Tarvo_QVRParser.h"
#include "Tarvo_Report.h"
#include "Tarvo_TEWParser.h"
#include "Tarvo_Word.h"

namespace Tarvo {

const StringBase KelIP::KEL_IP_NAME = "NAME";
const StringBase KelIP::KEL_IP_VERSION = "VERSION";
const StringBase KelIP::KEL_STYLE_OPTION_NAME = "STYLE";
const StringBase KelIP::KEL_STYLE_OPTION_VALUE_HDL = "HDL";
const StringBase KelIP::KEL_STYLE_OPTION_VALUE_BLACKBOX = "BLACKBOX";
const StringBase KelIP::KEL_STYLE_OPTION_VALUE_MIX = "MIX";
const StringBase KelIP::KEL_LANGUAGE_OPTION_NAME = kLanguageOption;
const StringBase KelIP::KEL_HDL_LIBRARY_PROPERTY = "LIBRARY";
const StringBase KelIP::KEL_HDL_LANGUAGE_PROPERTY = "LANGUAGE";
const StringBase KelIP::KEL_HDL_FILENAME_HEAD_PROPERTY = "FILENAME_HEAD";
const StringBase KelIP::KEL_HDL_FILENAME_TAIL_PROPERTY = "FILENAME_TAIL";
const StringBase KelIP::KEL_NETLIST_LIBRARY_PROPERTY = "LIBRARY";

namespace {

constexpr Report::Module kModule{"s/Tarvo_KelIP", "1.0"};

// Replaces the output by a parser's answer. False without a parser.
template <class Output, class Parser>
bool Answer(Output& output, const Parser* parser, Output (Parser::*question)() const) {
  if (parser) output = (parser->*question)();
  return parser != nullptr;
}

// Failures that two operations share: one lists texts, the other also the places.
constexpr char kNoSynthesisOrder[] = "Unable to list synthesis analyse order for IP %s\n%s\n";
constexpr char kNoSimulationOrder[] = "Unable to list simulation analyse order for IP %s\n%s\n";
constexpr char kNoIncludeLibraries[] = "Unable to list Verilog include libraries for IP %s\n%s\n";
constexpr char kNoNetlists[] = "Unable to list netlists for IP %s\n%s\n";

// Empty for a source that is not listed, if that is needed, and for an unknown property.
StringBase SourceProperty(const LDXParser& order, const StringBase& source,
                          const StringBase& property) {
  // Sources are known by absolute paths, and callers may give others.
  const Port::FileName file(Port::FileName(source).GetAbsolutePath());
  if (property == KelIP::KEL_HDL_LIBRARY_PROPERTY) return order.GetFileLibrary(file).GetKey();
  if (property == KelIP::KEL_HDL_LANGUAGE_PROPERTY) return order.GetFileLanguage(file);
  if (property == KelIP::KEL_HDL_FILENAME_HEAD_PROPERTY) return file.GetHead();
  if (property == KelIP::KEL_HDL_FILENAME_TAIL_PROPERTY) return file.GetTail();
  return {};
}

}  // namespace

// What an instance holds. Name and version come from the index, not from the text that a caller
// gave.
class KelIPImpl {
 public:
  KelIPImpl(const Kel_Index& theIndex, const StringBase& text);

  StringBase GetProperty(const StringBase& name) const;
  StringList ListProperties() const;

  // The parsers, made when they are first asked for; null if the core's style has no such files. If
  // making one throws, there is none, and the next call tries again.
  const LDXParser* GetLDXParser();
  const TEWParser* GetTEWParser();

  const Kel_Index& index;
  const Port::FileName location;
  const Kel_Key key;
  std::unique_ptr<QVRParser> qvrParser;

 private:
  bool HasStyle(const StringBase& style) const;
  StringBase GetLanguage() const;

  std::unique_ptr<LDXParser> ldxParser;
  std::unique_ptr<TEWParser> tewParser;
};

KelIPImpl::KelIPImpl(const Kel_Index& theIndex, const StringBase& text)
    : index(theIndex),
      location(index.GetIPLocation(Kel_Key(text))),
      key(index.GetIPKey(Kel_Key(text))) {
  TARVO_TRACE("Constructing IP instance %s v%s from path %s\n", key.GetName(), key.GetVersion(),
              location.GetAbsolutePath());
  qvrParser = std::make_unique<QVRParser>(index, key);
  TARVO_TRACE("Finished constructing IP instance %s v%s\n", key.GetName(), key.GetVersion());
}

StringBase KelIPImpl::GetProperty(const StringBase& name) const {
  // Those of the version, whatever the description states for them.
  if (name == KelIP::KEL_IP_NAME) return key.GetName();
  if (name == KelIP::KEL_IP_VERSION) return key.GetVersion();
  return qvrParser->GetOptionValue(name);
}

StringList KelIPImpl::ListProperties() const {
  StringList names = qvrParser->ListOptions();
  names.insert(names.begin(), {KelIP::KEL_IP_NAME, KelIP::KEL_IP_VERSION});
  return names;
}

// Whether the style is this one, or the one that has everything.
bool KelIPImpl::HasStyle(const StringBase& style) const {
  const StringBase value = qvrParser->GetOptionValue(KelIP::KEL_STYLE_OPTION_NAME);
  return EqualsIgnoringCase(value, style) ||
         EqualsIgnoringCase(value, KelIP::KEL_STYLE_OPTION_VALUE_MIX);
}

// Asked for only if it is stated, in this very letter case: a description has no default for it.
StringBase KelIPImpl::GetLanguage() const {
  const StringList options = qvrParser->ListOptions();
  const auto stated = std::find(options.begin(), options.end(), KelIP::KEL_LANGUAGE_OPTION_NAME);
  return stated == options.end() ? DefaultLanguage() : qvrParser->GetOptionValue(*stated);
}

const LDXParser* KelIPImpl::GetLDXParser() {
  if (!ldxParser && HasStyle(KelIP::KEL_STYLE_OPTION_VALUE_HDL)) {
    ldxParser = std::make_unique<LDXParser>(index, key, Kel_Key(), GetLanguage());
  }
  return ldxParser.get();
}

const TEWParser* KelIPImpl::GetTEWParser() {
  if (!tewParser && HasStyle(KelIP::KEL_STYLE_OPTION_VALUE_BLACKBOX)) {
    tewParser = std::make_unique<TEWParser>(index, key, qvrParser.get());
  }
  return tewParser.get();
}

KelIP::KelIP(const Kel_Index& index, const StringBase& key)
    : impl(std::make_unique<KelIPImpl>(index, key)) {}

KelIP::~KelIP() = default;

StringBase KelIP::GetLocation() const { return impl->location.GetAbsolutePath(); }

StringBase KelIP::GetKey() const { return impl->key.GetKey(); }

StringBase KelIP::GetName() const { return impl->key.GetName(); }

StringBase KelIP::GetVersion() const { return impl->key.GetVersion(); }

bool KelIP::GetIPProperty(const StringBase& name, StringBase& value) const {
  return Guard(
      value,
      Failure(kModule, "Unable to access property %s for IP %s\n%s\n", name, impl->key.GetKey())
          .With(ForUnknown::EmptyText),
      [&] {
        value = impl->GetProperty(name);
        // An empty option is no answer, but nothing went wrong either: no message.
        return value.GetLength() > 0;
      });
}

bool KelIP::ListIPProperties(StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list properties for IP %s\n%s\n", impl->key.GetKey()),
               [&] { list = impl->ListProperties(); });
}

bool KelIP::GetParameterProperty(const StringBase& parameter, const StringBase& property,
                                 StringBase& value) const {
  return Guard(value,
               Failure(kModule, "Unable to get parameter %s property %s for IP %s\n%s\n", parameter,
                       property, impl->key.GetKey())
                   .With(Severity::Warning),
               [&] { value = impl->qvrParser->GetParameterProperty(parameter, property); });
}

bool KelIP::SetParameterProperty(const StringBase& parameter, const StringBase& property,
                                 const StringBase& value) {
  return Guard(NoOutput(),
               Failure(kModule, "Unable to set IP %s parameter %s property %s to %s\n%s\n",
                       impl->key.GetKey(), parameter, property, value)
                   .With(Severity::Warning),
               [&] { impl->qvrParser->SetParameterProperty(parameter, property, value); });
}

bool KelIP::ListParameters(StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list parameters for IP %s\n%s\n", impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListParameters(); });
}

bool KelIP::ListParameterProperties(const StringBase& parameter, StringList& list) const {
  return Guard(
      list,
      Failure(kModule, "Unable to list parameter properties for IP %s\n%s\n", impl->key.GetKey()),
      [&] { list = impl->qvrParser->ListParameterProperties(parameter); });
}

bool KelIP::GetGenericProperty(const StringBase& generic, const StringBase& property,
                               StringBase& value) const {
  return Guard(value,
               Failure(kModule, "Unable to get generic %s property %s for IP %s\n%s\n", generic,
                       property, impl->key.GetKey())
                   .With(Severity::Warning),
               [&] { value = impl->qvrParser->GetGenericProperty(generic, property); });
}

bool KelIP::ListGenerics(StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list generics for IP %s\n%s\n", impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListGenerics(); });
}

bool KelIP::ListGenericProperties(const StringBase& generic, StringList& list) const {
  return Guard(
      list,
      Failure(kModule, "Unable to list generic properties for IP %s\n%s\n", impl->key.GetKey()),
      [&] { list = impl->qvrParser->ListGenericProperties(generic); });
}

bool KelIP::GetPortProperty(const StringBase& port, const StringBase& property,
                            StringBase& value) const {
  return Guard(value,
               Failure(kModule, "Unable to get port %s property %s for IP %s\n%s\n", port, property,
                       impl->key.GetKey())
                   .With(Severity::Warning),
               [&] { value = impl->qvrParser->GetPortProperty(port, property); });
}

bool KelIP::ListPorts(StringList& list) const {
  return Guard(list, Failure(kModule, "Unable to list ports for IP %s\n%s\n", impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListPorts(); });
}

bool KelIP::ListPortProperties(const StringBase& port, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list port %s properties for IP %s\n%s\n", port,
                       impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListPortProperties(port); });
}

bool KelIP::GetBusInterfaceProperty(const StringBase& interface, const StringBase& property,
                                    StringBase& value) const {
  return Guard(value,
               Failure(kModule, "Unable to get bus interface %s property %s for IP %s\n%s\n",
                       interface, property, impl->key.GetKey())
                   .With(Severity::Warning),
               [&] { value = impl->qvrParser->GetBusInterfaceProperty(interface, property); });
}

bool KelIP::ListBusInterfaces(StringList& list) const {
  return Guard(
      list, Failure(kModule, "Unable to list bus interfaces for IP %s\n%s\n", impl->key.GetKey()),
      [&] { list = impl->qvrParser->ListBusInterfaces(); });
}

bool KelIP::ListBusInterfaceProperties(const StringBase& interface, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list bus interface %s properties for IP %s\n%s\n",
                       interface, impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListBusInterfaceProperties(interface); });
}

bool KelIP::ListBusInterfaceParameters(const StringBase& interface, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list bus interface %s parameters for IP %s\n%s\n",
                       interface, impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListBusInterfaceParameters(interface); });
}

bool KelIP::ListBusInterfacePorts(const StringBase& interface, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list bus interface %s ports for IP %s\n%s\n", interface,
                       impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListBusInterfacePorts(interface); });
}

bool KelIP::GetIOInterfaceProperty(const StringBase& interface, const StringBase& property,
                                   StringBase& value) const {
  return Guard(value,
               Failure(kModule, "Unable to get I/O interface %s property %s for IP %s\n%s\n",
                       interface, property, impl->key.GetKey())
                   .With(Severity::Warning),
               [&] { value = impl->qvrParser->GetIoInterfaceProperty(interface, property); });
}

bool KelIP::ListIOInterfaces(StringList& list) const {
  return Guard(
      list, Failure(kModule, "Unable to list I/O interfaces for IP %s\n%s\n", impl->key.GetKey()),
      [&] { list = impl->qvrParser->ListIoInterfaces(); });
}

bool KelIP::ListIOInterfaceProperties(const StringBase& interface, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list I/O interface %s properties for IP %s\n%s\n",
                       interface, impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListIoInterfaceProperties(interface); });
}

bool KelIP::ListIOInterfaceParameters(const StringBase& interface, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list I/O interface %s parameters for IP %s\n%s\n",
                       interface, impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListIoInterfaceParameters(interface); });
}

bool KelIP::ListIOInterfacePorts(const StringBase& interface, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list I/O interface %s ports for IP %s\n%s\n", interface,
                       impl->key.GetKey()),
               [&] { list = impl->qvrParser->ListIoInterfacePorts(interface); });
}

bool KelIP::ListSynthesisSources(StringList& list) const {
  return Guard(list, Failure(kModule, kNoSynthesisOrder, impl->key.GetKey()), [&] {
    return Answer(list, impl->GetLDXParser(), &LDXParser::ListSynthesisAnalyseOrder);
  });
}

bool KelIP::ListSimulationSources(StringList& list) const {
  return Guard(list, Failure(kModule, kNoSimulationOrder, impl->key.GetKey()), [&] {
    return Answer(list, impl->GetLDXParser(), &LDXParser::ListSimulationAnalyseOrder);
  });
}

bool KelIP::ListSynthesisLibraries(StringList& list) const {
  return Guard(
      list,
      Failure(kModule, "Unable to list synthesis libraries for IP %s\n%s\n", impl->key.GetKey()),
      [&] { return Answer(list, impl->GetLDXParser(), &LDXParser::ListSynthesisLibraries); });
}

bool KelIP::ListSimulationLibraries(StringList& list) const {
  return Guard(
      list,
      Failure(kModule, "Unable to list simulation libraries for IP %s\n%s\n", impl->key.GetKey()),
      [&] { return Answer(list, impl->GetLDXParser(), &LDXParser::ListSimulationLibraries); });
}

bool KelIP::ListVerilogIncludeLibraries(StringList& list) const {
  return Guard(list, Failure(kModule, kNoIncludeLibraries, impl->key.GetKey()), [&] {
    return Answer(list, impl->GetLDXParser(), &LDXParser::ListVerilogIncludeLibraryKeys);
  });
}

bool KelIP::GetVerilogIncludeLocation(const StringBase& library, StringBase& value) const {
  return Guard(value,
               Failure(kModule, "Unable to locate Verilog include library %s for IP %s\n%s\n",
                       library, impl->key.GetKey()),
               [&] {
                 const LDXParser* const order = impl->GetLDXParser();
                 if (order) value = order->GetVerilogIncludeLocation(library);
                 return order != nullptr;
               });
}

bool KelIP::GetSourceProperty(const StringBase& source, const StringBase& property,
                              StringBase& value) const {
  return Guard(value,
               Failure(kModule, "Unable to get property %s for source %s in IP %s\n%s\n", property,
                       source, impl->key.GetKey()),
               [&] {
                 const LDXParser* const order = impl->GetLDXParser();
                 // Without an order there is no source to ask for: false, but nothing to tell.
                 if (order) value = SourceProperty(*order, source, property);
                 return order != nullptr && value.GetLength() > 0;
               });
}

bool KelIP::ListSourceProperties(const StringBase& source, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list source %s properties for IP %s\n%s\n", source,
                       impl->key.GetKey()),
               [&] {
                 StringBase library;
                 // First of all, so that an order that can't be read is told in the words of this
                 // question.
                 if (!impl->GetLDXParser()) return false;
                 if (!GetSourceProperty(source, KEL_HDL_LIBRARY_PROPERTY, library)) return false;
                 return ListAllSourceProperties(list);
               });
}

bool KelIP::ListNetlists(StringList& list) const {
  return Guard(list, Failure(kModule, kNoNetlists, impl->key.GetKey()),
               [&] { return Answer(list, impl->GetTEWParser(), &TEWParser::ListFiles); });
}

bool KelIP::ListNetlistLibraries(StringList& list) const {
  return Guard(
      list,
      Failure(kModule, "Unable to list netlist libraries for IP %s\n%s\n", impl->key.GetKey()),
      [&] { return Answer(list, impl->GetTEWParser(), &TEWParser::ListLibraries); });
}

bool KelIP::GetNetlistProperty(const StringBase& netlist, const StringBase& property,
                               StringBase& value) const {
  return Guard(value,
               Failure(kModule, "Unable to get netlist %s property %s for IP %s\n%s\n", netlist,
                       property, impl->key.GetKey()),
               [&] {
                 const TEWParser* const table = impl->GetTEWParser();
                 // The only property that netlists have.
                 if (!table || property != KEL_NETLIST_LIBRARY_PROPERTY) return false;
                 // Only a netlist that applies at present has one.
                 value = table->GetFileLibrary(Port::FileName(netlist)).GetKey();
                 return true;
               });
}

bool KelIP::ListNetlistProperties(const StringBase& netlist, StringList& list) const {
  return Guard(list,
               Failure(kModule, "Unable to list netlist %s properties for IP %s\n%s\n", netlist,
                       impl->key.GetKey()),
               [&] {
                 StringBase library;
                 if (!impl->GetTEWParser()) return false;
                 if (!GetNetlistProperty(netlist, KEL_NETLIST_LIBRARY_PROPERTY, library))
                   return false;
                 return ListAllNetlistProperties(list);
               });
}

bool KelIP::GetStatements(std::vector<KelStatement>& statements) const {
  return Guard(statements,
               Failure(kModule, "Unable to list statements for IP %s\n%s\n", impl->key.GetKey()),
               [&] { statements = impl->qvrParser->GetStatements(); });
}

bool KelIP::GetSynthesisSources(std::vector<KelSource>& sources) const {
  return Guard(sources, Failure(kModule, kNoSynthesisOrder, impl->key.GetKey()), [&] {
    return Answer(sources, impl->GetLDXParser(), &LDXParser::GetSynthesisSources);
  });
}

bool KelIP::GetSimulationSources(std::vector<KelSource>& sources) const {
  return Guard(sources, Failure(kModule, kNoSimulationOrder, impl->key.GetKey()), [&] {
    return Answer(sources, impl->GetLDXParser(), &LDXParser::GetSimulationSources);
  });
}

bool KelIP::GetVerilogIncludeDirectories(std::vector<KelIncludeDirectory>& directories) const {
  return Guard(directories, Failure(kModule, kNoIncludeLibraries, impl->key.GetKey()), [&] {
    return Answer(directories, impl->GetLDXParser(), &LDXParser::GetVerilogIncludeDirectories);
  });
}

bool KelIP::GetIncludes(std::vector<KelInclude>& includes) const {
  return Guard(includes, Failure(kModule, kNoIncludeLibraries, impl->key.GetKey()),
               [&] { return Answer(includes, impl->GetLDXParser(), &LDXParser::GetIncludes); });
}

bool KelIP::GetNetlistTable(KelNetlistTable& table) const {
  return Guard(table, Failure(kModule, kNoNetlists, impl->key.GetKey()),
               [&] { return Answer(table, impl->GetTEWParser(), &TEWParser::GetTable); });
}

// Questions to an instance like the others, though their answers need none of it. Each makes its
// list apart: if memory runs out, the caller's one is as it was.
// NOLINTBEGIN(readability-convert-member-functions-to-static)

bool KelIP::ListAllParameterProperties(StringList& list) const {
  list = NamesOf(KnownProperties::OfParameters());
  return true;
}

bool KelIP::ListAllGenericProperties(StringList& list) const {
  return ListAllParameterProperties(list);
}

bool KelIP::ListAllPortProperties(StringList& list) const {
  list = NamesOf(KnownProperties::OfPorts());
  return true;
}

bool KelIP::ListAllBusInterfaceProperties(StringList& list) const {
  list = NamesOf(KnownProperties::OfBusInterfaces());
  return true;
}

bool KelIP::ListAllIOInterfaceProperties(StringList& list) const {
  list = NamesOf(KnownProperties::OfIoInterfaces());
  return true;
}

bool KelIP::ListAllSourceProperties(StringList& list) const {
  list = StringList{KEL_HDL_LIBRARY_PROPERTY, KEL_HDL_LANGUAGE_PROPERTY,
                    KEL_HDL_FILENAME_HEAD_PROPERTY, KEL_HDL_FILENAME_TAIL_PROPERTY};
  return true;
}

bool KelIP::ListAllNetlistProperties(StringList& list) const {
  list = StringList{KEL_NETLIST_LIBRARY_PROPERTY};
  return true;
}

// NOLINTEND(readability-convert-member-functions-to-static)

}  // namespace Tarvo
