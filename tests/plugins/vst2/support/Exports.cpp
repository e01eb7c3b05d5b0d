// What a test reaches in a fixture's binary.
#include "tests/plugins/vst2/support/HostCalls.h"
#include "tests/plugins/vst2/support/Instance.h"
#include "tests/plugins/vst2/support/MakeInstance.h"

#include <functional>
#include <thread>

#define ZEB_EXPORTED extern "C" __attribute__((visibility("default")))

namespace vst2fixture
{

namespace
{

bool TakePrefix(std::string& command, std::string_view prefix)
{
    const bool has = command.starts_with(prefix);
    if (has)
        command.erase(0, prefix.size());
    return has;
}

// "[thread ][noEffect ]audioMaster... arguments"
std::string CarryOut(std::string command)
{
    const bool onThread = TakePrefix(command, "thread ");
    HostAccess access{LatestHost(), nullptr};
    if (!TakePrefix(command, "noEffect "))
    {
        Instance* instance = Instance::Newest();
        if (instance == nullptr)
            return "none";
        access = instance->Host();
    }
    if (access.host == nullptr)
        return "none";
    std::string answer;
    const auto call = [&]
    {
        answer = CallHost(access, command);
    };
    if (onThread)
        std::thread(call).join();
    else
        call();
    return answer;
}

} // namespace

} // namespace vst2fixture

ZEB_EXPORTED int ZebFixtureSet(const char* name, double value)
{
    const auto knob = vst2fixture::KnobCalled(name);
    if (knob)
        vst2fixture::Set(*knob, value);
    vst2fixture::Instance::RefreshAll();
    return knob ? 1 : 0;
}

ZEB_EXPORTED double ZebFixtureGet(const char* name)
{
    const auto knob = vst2fixture::KnobCalled(name);
    return knob ? vst2fixture::Get(*knob) : 0.0;
}

ZEB_EXPORTED void ZebFixtureReset()
{
    vst2fixture::ResetKnobs();
    vst2fixture::Instance::RefreshAll();
}

ZEB_EXPORTED const char* ZebFixtureDo(const char* command)
{
    static std::string sAnswer;
    sAnswer = vst2fixture::CarryOut(command);
    return sAnswer.c_str();
}
