#include "module/ModuleSteps.h"

#include <algorithm>

namespace zebaudiofilterhost
{

ModuleSteps::ModuleSteps() = default;

ModuleSteps& ModuleSteps::GetInstance()
{
    static ModuleSteps sInstance;
    return sInstance;
}

bool ModuleSteps::Add(ModuleStepOrder order, const Step& initialize, const Step& terminate)
{
    const auto position =
        std::find_if(mEntries.begin(), mEntries.end(), [order](const Entry& entry) { return entry.order > order; });
    mEntries.insert(position, Entry{order, initialize, terminate});
    return true;
}

void ModuleSteps::RunInitialize() const
{
    for (const Entry& entry : mEntries)
        entry.initialize();
}

void ModuleSteps::RunTerminate() const
{
    const auto run = [](const Entry& entry)
    {
        if (entry.terminate)
            entry.terminate();
    };
    std::for_each(mEntries.rbegin(), mEntries.rend(), run);
}

} // namespace zebaudiofilterhost
