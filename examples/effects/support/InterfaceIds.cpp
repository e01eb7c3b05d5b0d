// Interface IDs that the SDK declares, and some versions of it define nowhere. Weak, so that a version that does
// define them links as well.
#include "examples/effects/support/Vst3.h"

namespace Steinberg
{

[[gnu::weak]] const FUID IPlugView::iid(IPlugView_iid);
[[gnu::weak]] const FUID IPlugFrame::iid(IPlugFrame_iid);

#if SMTG_OS_LINUX
namespace Linux
{
[[gnu::weak]] const FUID IEventHandler::iid(IEventHandler_iid);
[[gnu::weak]] const FUID ITimerHandler::iid(ITimerHandler_iid);
[[gnu::weak]] const FUID IRunLoop::iid(IRunLoop_iid);
} // namespace Linux
#endif

} // namespace Steinberg
