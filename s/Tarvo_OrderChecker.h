#ifndef TARVO_ORDERCHECKER_H
#define TARVO_ORDERCHECKER_H

#include <unordered_map>
#include <unordered_set>
#include <vector>

#include "Port_FileName.h"
#include "Tarvo_AnalyseOrder.h"
#include "Tarvo_KelDiagnostic.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

class Kel_Index;

// The name of a file for a text: from the directory of its version on. The version is the one that
// the key stands for.
StringBase ShortName(const Kel_Index& index, const Kel_Key& key, const Port::FileName& file);

// Checks analyse orders, one after another, and what they have to do with each other. Tells what is
// wrong to the collector of this thread.
class OrderChecker {
 public:
  explicit OrderChecker(const Kel_Index& theIndex) : index(theIndex) {}

  // Checks the order of a version, with what it takes in.
  void Check(const Port::FileName& file, const Kel_Key& key, const StringBase& language);

  // Checks that no order takes in two versions of one core: once, behind the others.
  void CheckVersions();

  // Whether a listed file is known to be there; each is looked at once.
  bool IsThere(const Port::FileName& file);
  bool IsListed(const Port::FileName& file) const;
  // Whether a directory is given to Verilog compilers, whatever it holds.
  bool IsIncludeDirectory(const Port::FileName& directory) const;

 private:
  // An entry that brings another core in.
  struct Edge {
    Kel_Key core;
    KelPlace place;
    bool isWhole;  // with all that the other core takes in
  };
  using Edges = std::vector<Edge>;
  // How a core was come to: the edge, and the text of the key in whose order it stands.
  struct Step {
    const Edge* edge;
    StringBase from;
  };
  using Steps = std::unordered_map<StringBase, Step>;

  void CheckSources(const AnalyseOrder::SourceList& sources);
  void CheckNames(const AnalyseOrder::SourceList& sources);
  void CheckIncludeDirectories(const AnalyseOrder& order, const Kel_Key& key);
  void AddEdges(const AnalyseOrder& order, const Kel_Key& key);
  static void AddSingleSources(const AnalyseOrder::Library& library,
                               const std::unordered_map<StringBase, Kel_Key>& cores,
                               std::unordered_map<StringBase, Edges>& own);
  void CheckVersionsOf(const StringBase& top);
  Steps FindSteps(const StringBase& top, std::vector<StringBase>& met) const;
  static void TellVersions(const Steps& steps, const StringBase& top, const StringBase& older,
                           const StringBase& newer);

  const Kel_Index& index;
  std::unordered_map<StringBase, bool> files;  // by name, and whether they are there
  std::unordered_set<StringBase> listed;       // the same, however their entries write them
  std::unordered_set<StringBase> includeDirectories;
  std::unordered_map<StringBase, Edges> edges;  // by the text of the including core's key
  std::vector<StringBase> tops;
};

}  // namespace Tarvo

#endif
