#pragma once

#include "examples/effects/support/PluginFactory.h"

#include <atomic>

namespace fixture
{

using namespace effects;

// The factory of a fixture: its classes as the behaviour says, its answers as the knobs say.
class FixtureFactory : public PluginFactory
{
public:
    FixtureFactory();

    uint32 PLUGIN_API addRef() override;
    uint32 PLUGIN_API release() override;
    tresult PLUGIN_API getFactoryInfo(PFactoryInfo* info) override;
    int32 PLUGIN_API countClasses() override;
    tresult PLUGIN_API getClassInfo(int32 index, PClassInfo* info) override;
    tresult PLUGIN_API createInstance(FIDString classID, FIDString interfaceID, void** object) override;

private:
    static PluginDescription Describe();

    std::atomic<uint32> mReferences{1};
};

} // namespace fixture
