// The one timer of the library.
#pragma once

#include "foundation/zebcore/Export.h"

#include <boost/signals2/connection.hpp>
#include <boost/signals2/slot.hpp>

#include <memory>

namespace zebaudiofilterhost
{

/// Ticks on the main thread while somebody listens. A tick is queued 20 ms after the slots of the one before have
/// run, so the period is 20 ms plus the time that the slots take.
class ZEB_EXPORT ModuleUITimer
{
public:
    /// Made at first use, lives until process exit. [any]
    static ModuleUITimer& GetInstance();

    ModuleUITimer(const ModuleUITimer&) = delete;
    ModuleUITimer& operator=(const ModuleUITimer&) = delete;

    /// Connects a slot, which runs on the main thread, and starts the timer if it stands still. [main]
    boost::signals2::connection ConnectTick(const boost::signals2::slot<void()>& slot);

private:
    class Impl;

    ModuleUITimer();
    ~ModuleUITimer();

    std::unique_ptr<Impl> mImpl;
};

} // namespace zebaudiofilterhost
