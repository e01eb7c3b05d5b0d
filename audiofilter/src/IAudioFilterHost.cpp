#include "audiofilter/IAudioFilterHost.h"

namespace zebaudiofilterhost
{

IAudioFilterHost::~IAudioFilterHost()
{
}

} // namespace zebaudiofilterhost
