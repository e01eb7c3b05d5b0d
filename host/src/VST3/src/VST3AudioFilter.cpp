#include "host/src/VST3/src/VST3AudioFilter.h"

#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/Trace.h"
#include "host/src/VST3/src/IndexWalk.h"
#include "host/src/VST3/src/PluginText.h"
#include "host/src/VST3/src/VST3FilterID.h"
#include "host/src/VST3/src/VST3MemoryStream.h"

#include <pluginterfaces/vst/ivstmessage.h>

#include <algorithm>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::kResultOk;
using Steinberg::Vst::IConnectionPoint;
using zebcore::utility::UTF16FromNarrow;

namespace
{

// In bytes; a longer display name is a lie.
constexpr int32 kMaxDisplayNameLength = 65536;

// Asks for class infos of one kind until one has this ID. False if there is none.
template <class Info, class Get>
bool FindClass(Steinberg::IPluginFactory& factory, const char* classID, Info& info, Get get)
{
    bool found = false;
    WalkList([&] { return factory.countClasses(); },
             [&](int index)
             {
                 info = Info();
                 if (get(index, &info) != kResultOk)
                     return IndexWalk::kMissing;
                 found = std::equal(info.cid, info.cid + sizeof(info.cid), classID);
                 return found ? IndexWalk::kStop : IndexWalk::kFound;
             });
    return found;
}

void ReadDisplayName(IVST3CorvaneVendorSpecificComponent& component, UTF16String& name)
{
    const int32 length = component.GetDisplayNameLength();
    if (length <= 0 || length > kMaxDisplayNameLength)
        return;
    std::string text(static_cast<std::size_t>(length) + 1, '\0');
    component.GetDisplayName(text.data());
    text.back() = '\0';
    name = UTF16FromNarrow(text.c_str());
}

} // namespace

VST3AudioFilter::VST3AudioFilter(Steinberg::IPluginFactory* factory, const Steinberg::PClassInfo& classInfo)
    : AudioFilter(EncodeFilterID(classInfo.cid), UTF16String())
    , mFactory(PluginPtr<Steinberg::IPluginFactory>::Retain(factory))
{
    std::copy(std::begin(classInfo.cid), std::end(classInfo.cid), mClassID.begin());
    // From the start, so that a flush ahead of the first Resume delivers what it takes out of the transfer.
    mProcessData.inputParameterChanges = &mInputChanges;
    mProcessData.outputParameterChanges = &mOutputChanges;
    try
    {
        BringUp(classInfo);
    }
    catch (...) // no destructor follows, and threads of the plug-in's own may know this object
    {
        TakeDown();
        throw;
    }
}

VST3AudioFilter::~VST3AudioFilter()
{
    TakeDown();
}

void VST3AudioFilter::BringUp(const Steinberg::PClassInfo& classInfo)
{
    UTF16String name = ReadClassInfo(classInfo);
    const bool ok = CreatePlugin(name);
    ConnectController();
    SetDisplayName(name);
    mInitialized = ok;
    mRestarts.Open(); // what a thread of the plug-in's own told earlier is found out now
    BuildParameterInfos();
    TakeOfferedQueues();
    BuildIOConfiguration();
    if (mProcessor)
        mLatency = static_cast<int>(mProcessor->getLatencySamples());
    FindFactoryPresets();
    CreateEditor();
    mProcessContext = {};
}

void VST3AudioFilter::TakeDown()
{
    ZEB_TRACE("~VST3AudioFilter", "entry");
    mRestarts.Close();
    ReleaseParameters();
    if (mVendorEffect)
    {
        ZEB_TRACE("~VST3AudioFilter", "releasing vendor specific controller");
        mVendorEffect.Reset();
    }
    mEditor.reset();
    mInputEvents.Reset();
    mOutputEvents.Reset();
    ZEB_TRACE("~VST3AudioFilter", "disconnecting processor/controller");
    DisconnectController();
    FreeBusBuffers();
    mUnitInfo.Reset();
    ZEB_TRACE("~VST3AudioFilter", "releasing controller");
    ReleaseController();
    ZEB_TRACE("~VST3AudioFilter", "releasing audio processor");
    mProcessor.Reset();
    ZEB_TRACE("~VST3AudioFilter", "releasing component");
    ReleaseComponent();
    ZEB_TRACE("~VST3AudioFilter", "releasing factory");
    mFactory.Reset();
    ZEB_TRACE("~VST3AudioFilter", "exit");
}

// The display name, and vendor and sub-categories into the fields.
UTF16String VST3AudioFilter::ReadClassInfo(const Steinberg::PClassInfo& classInfo)
{
    UTF16String name;
    Steinberg::PFactoryInfo factoryInfo;
    if (mFactory->getFactoryInfo(&factoryInfo) == kResultOk)
    {
        if (const auto factory3 = PluginPtr<Steinberg::IPluginFactory3>::Query(mFactory))
            name = ReadUnicodeClassInfo(*factory3);
        else if (const auto factory2 = PluginPtr<Steinberg::IPluginFactory2>::Query(mFactory))
            name = ReadClassInfo2(*factory2);
        if (mVendor.empty())
            mVendor = UTF16FromNarrow(BoundedText(factoryInfo.vendor));
    }
    if (name.empty())
    {
        ZEB_TRACE("VST3AudioFilter", "VST3AudioFilter: Display name empty, using class info");
        name = UTF16FromNarrow(BoundedText(classInfo.name));
    }
    ZEB_TRACE("VST3AudioFilter", "VST3AudioFilter: Display name = " << name);
    return name;
}

// Both texts keep the zero padding of their 64 units: saved settings know these filters by such names.
UTF16String VST3AudioFilter::ReadUnicodeClassInfo(Steinberg::IPluginFactory3& factory)
{
    Steinberg::PClassInfoW info;
    if (!FindClass(factory, mClassID.data(), info,
                   [&](int index, auto* target) { return factory.getClassInfoUnicode(index, target); }))
        return {};
    mVendor = PaddedText(info.vendor);
    mSubCategories = BoundedText(info.subCategories);
    return PaddedText(info.name);
}

UTF16String VST3AudioFilter::ReadClassInfo2(Steinberg::IPluginFactory2& factory)
{
    Steinberg::PClassInfo2 info;
    if (!FindClass(factory, mClassID.data(), info,
                   [&](int index, auto* target) { return factory.getClassInfo2(index, target); }))
        return {};
    mVendor = UTF16FromNarrow(BoundedText(info.vendor));
    mSubCategories = BoundedText(info.subCategories);
    return UTF16FromNarrow(BoundedText(info.name));
}

// False if the plug-in did not come up. Without a processor or component nothing else is made.
bool VST3AudioFilter::CreatePlugin(UTF16String& name)
{
    mComponent = PluginPtr<Steinberg::Vst::IComponent>::Create(*mFactory, mClassID.data());
    if (!mComponent || mComponent->initialize(HostContext()) != kResultOk)
        return false;
    const auto vendorComponent = PluginPtr<IVST3CorvaneVendorSpecificComponent>::Query(mComponent);
    if (vendorComponent)
        ReadDisplayName(*vendorComponent, name);
    mProcessor = PluginPtr<Steinberg::Vst::IAudioProcessor>::Query(mComponent);
    return mProcessor && CreateController();
}

// True without a controller too: the plug-in then has no parameters. False if one was made and did not come up.
bool VST3AudioFilter::CreateController()
{
    using Steinberg::Vst::IEditController;
    mController = PluginPtr<IEditController>::Query(mComponent);
    if (mController)
        return true;
    Steinberg::TUID controllerID = {};
    if (mComponent->getControllerClassId(controllerID) != kResultOk ||
        !Steinberg::FUID::fromTUID(controllerID).isValid())
        return true;
    mController = PluginPtr<IEditController>::Create(*mFactory, controllerID);
    if (!mController)
        return true;
    mControllerIsSeparate = true;
    return mController->initialize(HostContext()) == kResultOk;
}

void VST3AudioFilter::ConnectController()
{
    if (!mController)
        return;
    mUnitInfo = PluginPtr<Steinberg::Vst::IUnitInfo>::Query(mController);
    mController->setComponentHandler(this);
    const auto processorPoint = PluginPtr<IConnectionPoint>::Query(mProcessor);
    const auto controllerPoint = PluginPtr<IConnectionPoint>::Query(mController);
    if (processorPoint && controllerPoint)
    {
        processorPoint->connect(controllerPoint.Get());
        controllerPoint->connect(processorPoint.Get());
        mConnected = true;
    }
    VST3MemoryStream stream;
    if (mComponent->getState(&stream) != kResultOk)
        return;
    stream.seek(0, Steinberg::IBStream::kIBSeekSet, nullptr);
    mController->setComponentState(&stream);
}

void VST3AudioFilter::CreateEditor()
{
    if (!mController)
        return;
    if (auto view =
            PluginPtr<Steinberg::IPlugView>::Adopt(mController->createView(Steinberg::Vst::ViewType::kEditor)))
        mEditor = new VST3AudioFilterEditor(mController.Get(), view.Get());
    mVendorEffect = PluginPtr<IVST3CorvaneVendorSpecificEffect>::Query(mController);
}

bool VST3AudioFilter::HasCustomEditor() const
{
    return mEditor && mEditor->HasSupportedView();
}

// The same one each time.
boost::intrusive_ptr<AudioFilterEditor> VST3AudioFilter::CreateCustomEditor()
{
    return mEditor;
}

void VST3AudioFilter::ReleaseParameters()
{
    mParameters.Publish({});
    mParameters.FreeRetired();
    FreeSpentQueues();
    const std::unique_ptr<QueueSet> offered(mOfferedQueues.exchange(nullptr));
}

void VST3AudioFilter::DisconnectController()
{
    if (!mConnected)
        return;
    const auto processorPoint = PluginPtr<IConnectionPoint>::Query(mProcessor);
    const auto controllerPoint = PluginPtr<IConnectionPoint>::Query(mController);
    if (!processorPoint || !controllerPoint)
        return;
    processorPoint->disconnect(controllerPoint.Get());
    controllerPoint->disconnect(processorPoint.Get());
}

// A controller that is the component itself is terminated as the component.
void VST3AudioFilter::ReleaseController()
{
    if (!mController)
        return;
    mController->setComponentHandler(nullptr);
    if (mControllerIsSeparate)
    {
        mController->terminate();
        mRunLoop.ForgetAll(); // ahead of the release: handlers may be parts of the object that goes with it
    }
    mController.Reset();
}

void VST3AudioFilter::ReleaseComponent()
{
    if (!mComponent)
        return;
    mComponent->terminate();
    mRunLoop.ForgetAll();
    mComponent.Reset();
}

Steinberg::FUnknown* VST3AudioFilter::HostContext()
{
    return static_cast<Steinberg::Vst::IHostApplication*>(this);
}

} // namespace zebaudiofilterhost::vst3
