// A log in the form that code hosts read. What is optional there is left out, unless a reader is
// known to use it.

#include "Sarif.h"

#include <algorithm>
#include <cstdint>
#include <map>

#include "Diagnostics.h"
#include "Tarvo_Version.h"
#include "Text.h"

namespace {

using Tarvo::KelDiagnostic;
using Tarvo::KelPlace;

const char* const kBase = "SRCROOT";

Json Message(const std::string& text) { return {{"text", text}}; }

Json Rules() {
  Json rules = Json::array();
  for (const Tarvo::KelDiagnosticCode& code : Codes()) {
    // All codes, found or not, so that a host can explain each.
    rules.push_back({{"id", code.code},
                     {"shortDescription", Message(code.title)},
                     {"fullDescription", Message(code.help)},
                     {"help", Message(code.help)},
                     {"defaultConfiguration", {{"level", SeverityWord(code.severity)}}}});
  }
  return rules;
}

// A path as an address has it.
std::string Encoded(const std::string& path) {
  std::string encoded;
  for (const char c : path) encoded += IsPlain(c, "-._~/") ? std::string(1, c) : "%" + Hex(c);
  return encoded;
}

// The same number for the same bytes, in every version and on every machine.
std::string Hash(const std::string& text) {
  // FNV-1a: short, and known to everybody.
  std::uint64_t hash = 14695981039346656037U;
  for (const char c : text) hash = (hash ^ static_cast<unsigned char>(c)) * 1099511628211U;
  return std::to_string(hash);
}

// All diagnostics have a code of the list.
std::ptrdiff_t RuleIndex(const KelDiagnostic& found) {
  const auto isRule = [&](const auto& code) { return Text(found.code) == code.code; };
  return std::find_if(Codes().begin(), Codes().end(), isRule) - Codes().begin();
}

class Writer {
 public:
  explicit Writer(std::string root) : directory(std::move(root)) {}

  Json Result(const KelDiagnostic& found) {
    const std::string hint = Text(found.hint);
    Json result = {{"ruleId", Text(found.code)}, {"ruleIndex", RuleIndex(found)}};
    result["level"] = SeverityWord(found.severity);
    result["message"] = Message(Text(found.text) + (hint.empty() ? "" : "\nhelp: " + hint));
    result["locations"] = Json::array({Location(found.place)});
    Json related = Json::array();
    for (const auto& other : found.related) {
      related.push_back(Location(other.place));
      related.back()["message"] = Message(Text(other.text));
    }
    if (!related.empty()) result["relatedLocations"] = related;
    result["partialFingerprints"] = {{"kelFinding/v1", Fingerprint(found)}};
    return result;
  }

 private:
  // What lies outside of the directory keeps its whole path. No place is the directory itself.
  Json Address(const KelPlace& place) const {
    const std::string relative = RelativeTo(directory, place.file);
    if (relative == ".." || relative.starts_with("../"))
      return {{"uri", "file://" + Encoded(Text(place.file))}};
    return {{"uri", relative.empty() ? "." : Encoded(relative)}, {"uriBaseId", kBase}};
  }

  Json Location(const KelPlace& place) {
    Json physical = {{"artifactLocation", Address(place)}};
    // A finding of a whole file has no region.
    if (place.line > 0) physical["region"] = Region(place);
    return {{"physicalLocation", physical}};
  }

  Json Region(const KelPlace& place) {
    Json region = {{"startLine", place.line}};
    const std::optional<std::string_view> line = lines.Find(place);
    if (place.column == 0 || !line || place.column > line->size() + 1) return region;
    // Columns are characters here, cells for people and bytes in the library.
    const std::size_t start = CountCodePoints(line->substr(0, place.column - 1)) + 1;
    region["startColumn"] = start;
    if (place.length == 0) return region;
    region["endColumn"] = start + CountCodePoints(line->substr(place.column - 1, place.length));
    return region;
  }

  // Equal findings of a file are told apart by their order.
  std::string Fingerprint(const KelDiagnostic& found) {
    const std::string address = Address(found.place)["uri"].get<std::string>();
    const std::string what = Text(found.code) + '\n' + address + '\n' + Text(found.text);
    return Hash(what + '\n' + std::to_string(counts[what]++));
  }

  std::string directory;
  FileLines lines;
  std::map<std::string, int> counts;
};

}  // namespace

Json SarifLog(const std::vector<KelDiagnostic>& found, const std::string& directory) {
  Writer writer(directory);
  Json results = Json::array();
  for (const KelDiagnostic& diagnostic : found) results.push_back(writer.Result(diagnostic));
  const Json driver = {
      {"name", "kel"}, {"version", Tarvo::GetLibraryVersion()}, {"rules", Rules()}};
  const std::string root = "file://" + Encoded(directory) + (directory == "/" ? "" : "/");
  const Json run = {{"tool", {{"driver", driver}}},
                    {"columnKind", "unicodeCodePoints"},
                    {"originalUriBaseIds", {{kBase, {{"uri", root}}}}},
                    {"results", results}};
  return {{"version", "2.1.0"}, {"runs", Json::array({run})}};
}
