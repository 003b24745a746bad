// The one place that knows all verbs.

#include <algorithm>

#include "Verb.h"

// The table of verbs, in the order of the help. A row VERB(Name) stands for a function
// `Verb DescribeName()` in Name.cpp.
#define KEL_VERBS \
  VERB(List)      \
  VERB(Which)     \
  VERB(Show)      \
  VERB(Sources)   \
  VERB(Netlists)  \
  VERB(Check)     \
  VERB(Help)

#define VERB(name) Verb Describe##name();
KEL_VERBS
#undef VERB
#define VERB(name) Describe##name(),

const std::vector<Verb>& Verbs() {
  static const std::vector<Verb> verbs = {KEL_VERBS};
  return verbs;
}

const Verb* FindVerb(const std::string& name) {
  const auto isIt = [&](const Verb& verb) { return verb.name == name; };
  const auto found = std::find_if(Verbs().begin(), Verbs().end(), isIt);
  return found == Verbs().end() ? nullptr : &*found;
}
