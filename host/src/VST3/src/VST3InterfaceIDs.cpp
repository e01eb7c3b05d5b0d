// IDs of the VST 3 interfaces which some versions of the SDK declare and define nowhere. Weak, so that a definition
// of the SDK's wins where there is one; both have the value that the interface's own header declares. Part of the
// SDK's target, and so of each plug-in that is built with it here.

#include <pluginterfaces/base/funknown.h>
#include <pluginterfaces/base/ibstream.h>
#include <pluginterfaces/base/ipluginbase.h>
#include <pluginterfaces/gui/iplugview.h>
#include <pluginterfaces/gui/iplugviewcontentscalesupport.h>

#define ZEB_DEFINE_MISSING_ID(Interface) [[gnu::weak]] DEF_CLASS_IID(Interface)

namespace Steinberg
{

ZEB_DEFINE_MISSING_ID(IBStream)
ZEB_DEFINE_MISSING_ID(IPluginFactory2)
ZEB_DEFINE_MISSING_ID(IPluginFactory3)
ZEB_DEFINE_MISSING_ID(IPlugView)
ZEB_DEFINE_MISSING_ID(IPlugFrame)
ZEB_DEFINE_MISSING_ID(IPlugViewContentScaleSupport)

#if SMTG_OS_LINUX
namespace Linux
{

ZEB_DEFINE_MISSING_ID(IRunLoop)
ZEB_DEFINE_MISSING_ID(IEventHandler)
ZEB_DEFINE_MISSING_ID(ITimerHandler)

} // namespace Linux
#endif

} // namespace Steinberg
