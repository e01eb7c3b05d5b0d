#include "tests/vst3/FakePlugin.h"

#include "tests/vst3/FakeObject.h"
#include "utility/ThreadUtils.h"

#include <algorithm>

namespace fakeplugin
{

const FUID kComponentClass(0x01020304, 0x00000005, 0x0000ff00, 0x0000000a);
const FUID kControllerClass(0x11020304, 0x00000005, 0x0000ff00, 0x0000000b);

namespace
{

class FakeFactory final : public IPluginFactory3
{
public:
    explicit FakeFactory(FakePlugin& plugin) : mPlugin(plugin), mCount(plugin, "factory") {}

    tresult PLUGIN_API queryInterface(const TUID asked, void** obj) override
    {
        const bool answered = Answer<IPluginFactory>(asked, this, obj) ||
                              (mPlugin.level >= FactoryLevel::kTwo && Answer<IPluginFactory2>(asked, this, obj)) ||
                              (mPlugin.level >= FactoryLevel::kThree && Answer<IPluginFactory3>(asked, this, obj));
        return answered ? kResultOk : kNoInterface;
    }
    uint32 PLUGIN_API addRef() override { return mCount.Add(); }
    uint32 PLUGIN_API release() override { return mCount.Release(this); }

    tresult PLUGIN_API getFactoryInfo(PFactoryInfo* info) override
    {
        *info = mPlugin.factoryInfo;
        return mPlugin.factoryInfoResult;
    }
    int32 PLUGIN_API countClasses() override { return mPlugin.classCount; }
    tresult PLUGIN_API getClassInfo(int32 index, PClassInfo* info) override
    {
        return Give(index, mPlugin.classInfo, info);
    }
    tresult PLUGIN_API getClassInfo2(int32 index, PClassInfo2* info) override
    {
        mPlugin.Call("factory.getClassInfo2");
        return Give(index, mPlugin.classInfo2, info);
    }
    tresult PLUGIN_API getClassInfoUnicode(int32 index, PClassInfoW* info) override
    {
        return Give(index, mPlugin.classInfoW, info);
    }
    tresult PLUGIN_API setHostContext(FUnknown* /*context*/) override
    {
        mPlugin.Call("factory.setHostContext");
        return kResultOk;
    }
    tresult PLUGIN_API createInstance(FIDString classID, FIDString asked, void** obj) override
    {
        *obj = nullptr;
        if (Is(classID, kComponentClass) && Is(asked, IComponent::iid) && mPlugin.createsComponent)
            *obj = MakeFakeComponent(mPlugin);
        else if (Is(classID, kControllerClass) && Is(asked, IEditController::iid) && mPlugin.createsController)
            *obj = MakeFakeController(mPlugin);
        return *obj ? kResultOk : kResultFalse;
    }

private:
    // Only the last class is there: what comes before must be stepped over.
    template <class Info>
    tresult Give(int32 index, const Info& source, Info* target)
    {
        if (index != std::min<int32>(mPlugin.classCount, 3) - 1)
            return kResultFalse;
        *target = source;
        return kResultOk;
    }

    FakePlugin& mPlugin;
    FakeCount mCount;
};

} // namespace

FakePlugin::FakePlugin()
    : classInfo(kComponentClass, PClassInfo::kManyInstances, kVstAudioEffectClass, "Class One")
    , factoryInfo("Factory Vendor", "", "", 0)
    , classInfo2(kComponentClass, PClassInfo::kManyInstances, kVstAudioEffectClass, "Class Two", 0, "Fx|Delay",
                 "Vendor Two", "1", "VST 3.7.2")
    , classInfoW(kComponentClass, PClassInfo::kManyInstances, kVstAudioEffectClass, u"Class Three", 0, "Fx|Reverb",
                 u"Vendor Three", u"1", u"VST 3.7.2")
{
    zebaudiofilterhost::InitializeMainThreadID();
}

FakePlugin::~FakePlugin() = default;

IPluginFactory* FakePlugin::MakeFactory()
{
    return new FakeFactory(*this);
}

boost::intrusive_ptr<zebaudiofilterhost::vst3::VST3AudioFilter> FakePlugin::MakeFilter()
{
    const auto factory = zebaudiofilterhost::vst3::PluginPtr<IPluginFactory>::Adopt(MakeFactory());
    return new zebaudiofilterhost::vst3::VST3AudioFilter(factory.Get(), classInfo);
}

void FakePlugin::Call(const std::string& text)
{
    if (!recording)
        return;
    {
        const std::lock_guard lock(mMutex);
        mCalls.push_back(text);
    }
    if (called)
        called(text);
}

std::vector<std::string> FakePlugin::Calls() const
{
    const std::lock_guard lock(mMutex);
    return mCalls;
}

std::vector<std::string> FakePlugin::CallsTo(const std::string& prefix) const
{
    std::vector<std::string> calls = Calls();
    std::erase_if(calls, [&](const std::string& call) { return call.rfind(prefix, 0) != 0; });
    return calls;
}

void FakePlugin::ClearCalls()
{
    const std::lock_guard lock(mMutex);
    mCalls.clear();
}

} // namespace fakeplugin
