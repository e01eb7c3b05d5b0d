// What the layers above want done when the library starts and stops.
#pragma once

#include "foundation/zebcore/Export.h"

#include <boost/function.hpp>

#include <vector>

namespace zebaudiofilterhost
{

/// Place of a step in Initialize, lowest first. All come after the main thread has been told.
enum class ModuleStepOrder
{
    kDeferredDescriptors,
    kConsoleCommands
};

/// The steps that layers above add from static initializers, so that this layer needs to know none of them.
class ZEB_EXPORT ModuleSteps
{
public:
    using Step = boost::function<void()>;

    /// Made at first use, so that static initializers may come in any order. [main]
    static ModuleSteps& GetInstance();

    ModuleSteps(const ModuleSteps&) = delete;
    ModuleSteps& operator=(const ModuleSteps&) = delete;

    /// Adds a step; steps of the same order run in the order in which they were added. `terminate` may be empty.
    /// Always true, so that a static initializer can be one call. [main]
    bool Add(ModuleStepOrder order, const Step& initialize, const Step& terminate = Step());

    /// Runs all `initialize` steps. What a step throws passes to the caller. [main]
    void RunInitialize() const;

    /// Runs all `terminate` steps, last first. [main]
    void RunTerminate() const;

private:
    struct Entry
    {
        ModuleStepOrder order;
        Step initialize;
        Step terminate;
    };

    ModuleSteps();

    std::vector<Entry> mEntries; // Sorted by order
};

} // namespace zebaudiofilterhost
