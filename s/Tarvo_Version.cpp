#include "Tarvo_Version.h"

namespace Tarvo {

const char* GetLibraryVersion() noexcept { return TARVO_KEL_VERSION; }

}  // namespace Tarvo
