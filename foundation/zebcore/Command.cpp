#include "foundation/zebcore/Command.h"

namespace zebcore::console
{

Command::Command(const UTF16String& name, const UTF16String& description) : mName(name), mDescription(description)
{
}

Command::~Command() = default;

} // namespace zebcore::console
