#include "tests/plugins/vst2/support/MakeInstance.h"

#include "tests/plugins/support/Recorder.h"
#include "tests/plugins/vst2/FixtureID.h"
#include "tests/plugins/vst2/support/Instance.h"

#include <atomic>
#include <vector>

namespace vst2fixture
{

namespace
{

std::atomic<audioMasterCallback> sLatestHost{nullptr};

// A shell asks which of its members is wanted; null for the shell itself.
const Member* WantedMember(audioMasterCallback host, std::int32_t& id, bool& isKnown)
{
    const Behaviour& behaviour = TheBehaviour();
    isKnown = true;
    if (!behaviour.isShell)
        return nullptr;
    const auto wanted = static_cast<std::int32_t>(host(nullptr, audioMasterCurrentId, 0, 0, nullptr, 0.0F));
    fixture::Record("entry.audioMasterCurrentId ->", static_cast<std::uint32_t>(wanted));
    if (wanted == 0)
        return nullptr;
    const auto place = static_cast<std::size_t>(static_cast<std::uint32_t>(wanted) - static_cast<std::uint32_t>(id));
    isKnown = place < behaviour.members.size();
    id = wanted;
    return isKnown ? &behaviour.members[place] : nullptr;
}

// A host that looks at the magic number closes none of those without: they stay where a leak check finds them.
void KeepUnclosed(const Instance* instance)
{
    static auto* sKept = new std::vector<const Instance*>; // to the end of the process
    sKept->push_back(instance);
}

} // namespace

AEffect* MakeInstance(const char* entry, audioMasterCallback host)
{
    sLatestHost = host;
    fixture::Record(entry, host != nullptr ? 1 : 0);
    Happen(TheBehaviour().atEntry);
    if (IsOn(Knob::kCallsInEntry))
        CallHostForEverything({host, nullptr}, "entry");
    if (IsOn(Knob::kEntryNull))
        return nullptr;
    auto id = static_cast<std::int32_t>(zebtest::VST2FixtureID(kFixtureName));
    bool isKnown = true;
    const Member* member = WantedMember(host, id, isKnown);
    if (!isKnown)
        return nullptr;
    auto* instance = new Instance(host, id, member);
    if (instance->Effect()->magic != kEffectMagic)
        KeepUnclosed(instance);
    if (IsOn(Knob::kCallsInEntry))
        CallHostForEverything(instance->Host(), "made");
    return instance->Effect();
}

audioMasterCallback LatestHost()
{
    return sLatestHost;
}

} // namespace vst2fixture
