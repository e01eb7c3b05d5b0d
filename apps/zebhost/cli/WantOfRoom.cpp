#include "cli/WantOfRoom.h"

#include <cerrno>

namespace zebhost
{

bool IsWantOfRoom(int error)
{
    return error == ENOSPC || error == EDQUOT || error == EFBIG;
}

} // namespace zebhost
