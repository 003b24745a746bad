#ifndef TARVO_KEL_INDEX_CANDIDATE_H
#define TARVO_KEL_INDEX_CANDIDATE_H

#include "Port_FileName.h"
#include "Tarvo_Existence.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"

namespace Tarvo {

// A walk asks the disk once for most versions: a description that is there shows that its location
// is there too, and a directory.
struct Kel_Index::Candidate {
  Candidate(const Kel_Key& theKey, const Port::FileName& theLocation)
      : key(theKey),
        location(theLocation),
        description(GetDataFile(location, key, KEL_QVR_EXTENSION)),
        described(LookFor(description)) {}

  const Kel_Key& key;
  const Port::FileName& location;
  Port::FileName description;
  Existence described;
};

}  // namespace Tarvo

#endif
