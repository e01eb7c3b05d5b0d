#include "tests/host/FakeTechnology.h"

#include "host/AudioFilterDescriptorManager.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginTechnology.h"

#include <algorithm>
#include <stdexcept>
#include <utility>

namespace zebaudiofilterhost::testing
{

namespace
{

boost::intrusive_ptr<PluginTechnology> MakeTechnology(TechnologyType type, bool hasDirectories)
{
    const auto collect = [type](const Dir& dir)
    {
        std::vector<PluginLocator> found;
        for (const FakePlugin& plugin : FakeMachine::GetInstance().plugins)
        {
            if (plugin.locator.GetTechnologyType() == type && plugin.locator.GetPath().starts_with(dir.FullPath()) &&
                !BannedPluginManager::GetInstance().IsPluginBanned(plugin.locator))
            {
                found.push_back(plugin.locator);
            }
        }
        return found;
    };
    return new PluginTechnology(
        type, collect, [](const std::vector<Dir>&) { return new FakeScanContext; },
        [] { return std::vector<UTF16String>{u"/std"}; },
        [](const UTF16String& path) { return path == u"/nameless" ? UTF16String() : u"Shown " + path; },
        hasDirectories);
}

} // namespace

FakePlugin* FakeMachine::Find(const PluginLocator& locator)
{
    const auto found = std::find_if(plugins.begin(), plugins.end(),
                                    [&locator](const FakePlugin& plugin) { return plugin.locator == locator; });
    return found == plugins.end() ? nullptr : &*found;
}

FakeMachine& FakeMachine::GetInstance()
{
    static FakeMachine sMachine;
    return sMachine;
}

void FakeScanContext::SetPluginLocators(const std::vector<PluginLocator>& locators, bool skipCategory)
{
    mLocators = locators;
    mSkipCategory = skipCategory;
}

bool FakeScanContext::GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, unsigned long& index) const
{
    if (mPosition >= mLocators.size() || !FakeMachine::GetInstance().tellsProgress)
    {
        return false;
    }
    locator = mLocators[mPosition];
    detail.clear();
    if (mPlugin != nullptr && mPlugin->filters.size() > 1)
    {
        const auto digit = [](std::size_t number)
        {
            return static_cast<char16_t>(u'0' + number);
        };
        detail = UTF16String(u" (") + digit(mFilterIndex + 1) + u"/" + digit(mPlugin->filters.size()) + u")";
    }
    index = mPosition;
    return true;
}

bool FakeScanContext::Continue()
{
    if (!mInProgress)
    {
        Load();
    }
    if (mPlugin != nullptr && mFilterIndex < mPlugin->filters.size())
    {
        MakeFilter(mPlugin->filters[mFilterIndex]);
        ++mFilterIndex;
    }
    if (mPlugin == nullptr || mFilterIndex >= mPlugin->filters.size())
    {
        FinishPlugin();
    }
    return mPosition < mLocators.size();
}

void FakeScanContext::Load()
{
    FakeMachine& machine = FakeMachine::GetInstance();
    machine.log.push_back("load " + Text(mLocators[mPosition]));
    FakePlugin* const plugin = machine.Find(mLocators[mPosition]);
    mPlugin = plugin != nullptr && plugin->loads ? plugin : nullptr;
    mInProgress = true;
}

void FakeScanContext::MakeFilter(FakeFilter& filter)
{
    if (std::exchange(filter.throws, false))
    {
        throw std::runtime_error("the plug-in threw");
    }
    FakeMachine::GetInstance().log.push_back("make " + Text(filter.id));
    if (!filter.synth)
    {
        const AudioFilterCategory category = mSkipCategory ? kCategoryNotQueried : kCategoryVST3Delay;
        mDescriptors.push_back(new AudioFilterDescriptor(mPlugin->locator, filter.name, u"V", 1, category, filter.id,
                                                         Guid(), filter.synth));
    }
}

void FakeScanContext::FinishPlugin()
{
    if (mPlugin != nullptr)
    {
        const InfoPtr info = MakeInfo(mPlugin->locator, true);
        info->SetHasAnyNonSynthEffect(!mDescriptors.empty());
        PluginModuleInfoManager::GetInstance().AddPluginModuleInfo(info);
    }
    for (const DescriptorPtr& descriptor : mDescriptors)
    {
        AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(descriptor);
    }
    mDescriptors.clear();
    mPlugin = nullptr;
    mInProgress = false;
    mFilterIndex = 0;
    ++mPosition;
}

FakeTechnologyFixture::FakeTechnologyFixture()
{
    mMachine = FakeMachine();
    PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
    // Out of order, and VST 3 twice: the catalogue sorts them and keeps the first.
    manager.AddPluginTechnology(MakeTechnology(kTechnologyAudioUnit, false));
    manager.AddPluginTechnology(MakeTechnology(kTechnologyVST3, false));
    manager.AddPluginTechnology(MakeTechnology(kTechnologyVST3, true));
    manager.AddPluginTechnology(MakeTechnology(kTechnologyVST, true));
    manager.GetPluginTechnology(kTechnologyVST)->AddPluginDirectories({u"/vst"});
}

} // namespace zebaudiofilterhost::testing
