#include "module/Module.h"

#include "module/ModuleSteps.h"
#include "utility/ThreadUtils.h"

#include <cstdint>

namespace zebaudiofilterhost
{

namespace
{

constinit std::uint32_t sReferenceCount = 0;

} // namespace

bool Initialize()
{
    if (sReferenceCount == 0)
    {
        InitializeMainThreadID();
        ModuleSteps::GetInstance().RunInitialize();
    }
    ++sReferenceCount;
    return true;
}

void Terminate()
{
    // A Terminate too many wraps the count, and so does not unregister a second time.
    if (sReferenceCount-- == 1)
        ModuleSteps::GetInstance().RunTerminate();
}

} // namespace zebaudiofilterhost
