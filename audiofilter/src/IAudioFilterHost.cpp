#include "audiofilter/IAudioFilterHost.h"

namespace zebaudiofilterhost
{

IAudioFilterHost::~IAudioFilterHost() = default;

} // namespace zebaudiofilterhost
