#pragma once

#include "utility/CommonTypes.h"

namespace zebaudiofilterhost
{

/// The Library folder of the user, or of the machine; a default Dir if the system names none. [main]
Dir GetMacLibraryFolder(bool user);

} // namespace zebaudiofilterhost
