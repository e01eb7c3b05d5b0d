#pragma once

#include "host/PluginLocator.h"
#include "host/PluginModuleInfo.h"
#include "host/PluginScanContext.h"
#include "tests/host/CatalogueFixture.h"

#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

struct FakeFilter
{
    UTF16String id;
    bool synth = false;
    bool throws = false; // when it is made, for the first time only
    UTF16String name = u"N";
};

struct FakePlugin
{
    PluginLocator locator;
    bool loads = true;
    std::vector<FakeFilter> filters = {};
};

/// What is installed on the imaginary machine, and what has been done to it.
struct FakeMachine
{
    std::vector<FakePlugin> plugins;
    std::vector<std::string> log;
    bool tellsProgress = true;

    FakePlugin* Find(const PluginLocator& locator);
    static FakeMachine& GetInstance();
};

/// Works through plug-ins as a real technology does: loads one, makes its filters one by one, and enters them into
/// the catalogue together.
class FakeScanContext : public PluginScanContext
{
public:
    void SetPluginLocators(const std::vector<PluginLocator>& locators, bool skipCategory) override;
    bool GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, unsigned long& index) const override;
    bool Continue() override;

private:
    void Load();
    void MakeFilter(FakeFilter& filter);
    void FinishPlugin();

    std::vector<PluginLocator> mLocators;
    bool mSkipCategory = false;
    std::size_t mPosition = 0;
    bool mInProgress = false;
    FakePlugin* mPlugin = nullptr;
    std::size_t mFilterIndex = 0;
    std::vector<DescriptorPtr> mDescriptors;
};

/// A catalogue with VST 2 (directories "/vst" and what the test adds), VST 3 and Audio Unit, all fake.
class FakeTechnologyFixture : public CatalogueFixture
{
protected:
    FakeTechnologyFixture();

    FakeMachine& mMachine = FakeMachine::GetInstance();
};

} // namespace zebaudiofilterhost::testing
