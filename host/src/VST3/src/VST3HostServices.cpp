// The filter as the host application that its plug-in sees.

#include "host/PluginModule.h"
#include "host/src/VST3/src/HostAttributeList.h"
#include "host/src/VST3/src/HostMessage.h"
#include "host/src/VST3/src/VST3AudioFilter.h"

#include <algorithm>
#include <array>
#include <string_view>

namespace zebaudiofilterhost::vst3
{

using Steinberg::FUID;
using Steinberg::int32;
using Steinberg::kNoInterface;
using Steinberg::kResultFalse;
using Steinberg::kResultOk;
using Steinberg::tresult;
using Steinberg::TUID;
using Steinberg::uint32;

namespace
{

bool IsInterface(const TUID iid, const FUID& known)
{
    return Steinberg::FUnknownPrivate::iidEqual(iid, known);
}

} // namespace

// Every face answers for all, FUnknown by that of the host application.
tresult PLUGIN_API VST3AudioFilter::queryInterface(const TUID interfaceID, void** obj)
{
    using namespace Steinberg::Vst;
    if (!obj)
        return Steinberg::kInvalidArgument;
    *obj = nullptr;
    if (!interfaceID)
        return kNoInterface;
    if (IsInterface(interfaceID, Steinberg::FUnknown::iid) || IsInterface(interfaceID, IHostApplication::iid))
        *obj = static_cast<IHostApplication*>(this);
    else if (IsInterface(interfaceID, IComponentHandler::iid))
        *obj = static_cast<IComponentHandler*>(this);
    else if (IsInterface(interfaceID, IUnitHandler::iid))
        *obj = static_cast<IUnitHandler*>(this);
    else if (IsInterface(interfaceID, IVST3CorvaneVendorSpecificHost::iid))
        *obj = static_cast<IVST3CorvaneVendorSpecificHost*>(this);
    else
        return mRunLoop.QueryInterface(interfaceID, obj);
    addRef();
    return kResultOk;
}

uint32 PLUGIN_API VST3AudioFilter::addRef()
{
    return 1;
}

uint32 PLUGIN_API VST3AudioFilter::release()
{
    return 1;
}

// Without a terminator: the rest of the buffer stays as the plug-in passed it.
tresult PLUGIN_API VST3AudioFilter::getName(Steinberg::Vst::String128 name)
{
    constexpr std::u16string_view kName = u"Larkspur";
    std::copy(kName.begin(), kName.end(), name);
    return kResultOk;
}

tresult PLUGIN_API VST3AudioFilter::createInstance(TUID classID, TUID interfaceID, void** obj)
{
    using namespace Steinberg::Vst;
    if (!obj)
        return Steinberg::kInvalidArgument;
    *obj = nullptr;
    const auto bothAre = [wanted = FUID::fromTUID(classID), face = FUID::fromTUID(interfaceID)](const FUID& known)
    {
        return wanted == known && face == known;
    };
    if (bothAre(IMessage::iid))
        *obj = static_cast<IMessage*>(new HostMessage);
    else if (bothAre(IAttributeList::iid))
        *obj = static_cast<IAttributeList*>(new HostAttributeList);
    return *obj ? kResultOk : kResultFalse;
}

tresult PLUGIN_API VST3AudioFilter::notifyUnitSelection(Steinberg::Vst::UnitID /*unitID*/)
{
    return kResultOk;
}

tresult PLUGIN_API VST3AudioFilter::notifyProgramListChange(Steinberg::Vst::ProgramListID /*listID*/,
                                                            int32 /*programIndex*/)
{
    return kResultOk;
}

int32 PLUGIN_API VST3AudioFilter::GetUILanguage()
{
    // The code is the place in this list; 0 is any other language.
    constexpr std::array<std::string_view, 7> kLocales = {"de_DE", "fr_FR", "ja_JP", "es_ES",
                                                          "it_IT", "ko_KR", "zh_CN"};
    const auto* found = std::find(kLocales.begin(), kLocales.end(), PluginModule::GetLocaleIdentifier());
    return found == kLocales.end() ? 0 : static_cast<int32>(found - kLocales.begin()) + 1;
}

// Plug-ins of this technology get no theme, although the application may have set one.
int32 PLUGIN_API VST3AudioFilter::GetThemeXMLLength()
{
    return 0;
}

void PLUGIN_API VST3AudioFilter::GetThemeXML(unsigned char* /*buffer*/)
{
}

void PLUGIN_API VST3AudioFilter::GainFocus(long direction)
{
    if (mEditor)
        mEditor->GetAdvanceFocusSignal()(direction == 1);
}

const char* PLUGIN_API VST3AudioFilter::GetUILanguageString()
{
    return PluginModule::GetLocaleIdentifier();
}

} // namespace zebaudiofilterhost::vst3
