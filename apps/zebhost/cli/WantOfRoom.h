#pragma once

namespace zebhost
{

// Whether a system error number says that there is no room for a file: other advice helps then than for all else.
bool IsWantOfRoom(int error);

} // namespace zebhost
