#include "host/src/VST/src/VSTPluginModule.h"

#include "foundation/zebcore/StringStreams.h"
#include "foundation/zebcore/Trace.h"
#include "host/BannedPluginManager.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTEffectText.h"
#include "host/src/VST/src/VSTFilterID.h"

#include <array>
#include <unordered_set>

namespace zebaudiofilterhost::vst
{

namespace
{

constexpr int kVstMinVersion = 2300;
constexpr std::size_t kMemberNameSize = 256;
// More than any shell has: one that never ends its list must not fill the memory.
constexpr std::size_t kMaxShellMembers = 65536;

// Guards against nothing that is thrown: a plug-in that cannot even answer these questions ends its scan by what it
// throws.
int Ask(AEffect* effect, AEffectOpcodes opcode, void* ptr = nullptr)
{
    return effect->dispatcher ? static_cast<int>(effect->dispatcher(effect, opcode, 0, 0, ptr, 0.0F)) : 0;
}

unsigned int UniqueIDOf(const AEffect* effect)
{
    return static_cast<unsigned int>(effect->uniqueID);
}

UTF16String Decimal(unsigned int number)
{
    zebcore::utility::oUTF16StringStream stream;
    stream << number;
    return stream.str();
}

bool IsSynth(const AEffect* effect)
{
    return (effect->flags & effFlagsIsSynth) != 0;
}

UTF16String GetName(AEffect* effect, const UTF16String& path)
{
    const UTF16String name = GetEffectName(effect);
    return name.empty() ? File(path).GetTitle() : name;
}

// A listed instrument is kept, so that its file counts as known: none of its filters enters the catalogue anyway.
bool IsListed(const UTF16String& path, const AEffect* effect, int version)
{
    const bool isListed = BannedPluginManager::GetInstance().IsPluginBannedStatically(
        File(path).GetName(), Decimal(UniqueIDOf(effect)), Decimal(static_cast<unsigned int>(version)));
    return isListed && !IsSynth(effect);
}

// The first of each stays.
void DropRepeats(std::vector<UTF16String>& filterIDs)
{
    std::unordered_set<UTF16String> seen;
    std::erase_if(filterIDs, [&seen](const UTF16String& id) { return !seen.insert(id).second; });
}

// A list with an end is taken as it stands. One without is mostly a shell that begins again, over and over: it must
// not be opened once for each time.
std::vector<UTF16String> ListShellMembers(AEffect* effect, const UTF16String& path)
{
    std::array<char, kMemberNameSize> name{};
    std::vector<UTF16String> filterIDs;
    VSTAudioFilter::SetCurrentFilterID(0);
    while (filterIDs.size() < kMaxShellMembers)
    {
        const int uniqueID = Ask(effect, effShellGetNextPlugin, name.data());
        if (uniqueID == 0)
            break;
        filterIDs.push_back(EncodeFilterID(static_cast<unsigned int>(uniqueID), path));
    }
    if (filterIDs.size() == kMaxShellMembers)
        DropRepeats(filterIDs);
    return filterIDs;
}

} // namespace

boost::intrusive_ptr<PluginModuleInfo> VSTPluginModule::GetPluginInfo(std::vector<UTF16String>& filterIDs)
{
    std::vector<UTF16String> found;
    boost::intrusive_ptr<PluginModuleInfo> info;
    AEffect* effect = mEntryPoint ? MakeEffect(0) : nullptr;
    if (effect && effect->magic == kEffectMagic)
    {
        // Opens the plug-in, and closes it again at the end of this block.
        const boost::intrusive_ptr<VSTAudioFilter> filter(
            new VSTAudioFilter(EncodeFilterID(UniqueIDOf(effect), GetPath()), GetPath(), effect, false, true));
        info = DescribeEffect(effect, found);
    }
    else if (effect)
    {
        SetProblem(u" is not a VST 2 plug-in: its entry function gives something else.");
    }
    filterIDs.swap(found);
    return info;
}

boost::intrusive_ptr<PluginModuleInfo> VSTPluginModule::DescribeEffect(AEffect* effect,
                                                                       std::vector<UTF16String>& filterIDs)
{
    const UTF16String name = GetName(effect, GetPath());
    const UTF16String vendor = GetVendorString(effect);
    const int version = Ask(effect, effGetVstVersion);
    if (IsListed(GetPath(), effect, version))
    {
        SetProblem(u" is on the permanent block list.");
        return nullptr;
    }
    if (version < kVstMinVersion)
    {
        ZEB_TRACE("VSTPluginModule::EnumerateFilters", "version < kVstMinVersion: " << version);
        SetProblem(u" is made for an interface older than VST 2.3.");
        return nullptr;
    }
    mIsShell = Ask(effect, effGetPlugCategory) == kPlugCategShell;
    if (mIsShell)
        filterIDs = ListShellMembers(effect, GetPath());
    else if (!IsSynth(effect))
        filterIDs.push_back(EncodeFilterID(UniqueIDOf(effect), GetPath()));
    SetProblem({});
    return new PluginModuleInfo(PluginLocator(kTechnologyVST, GetPath()), name, vendor,
                                static_cast<unsigned int>(version), kTechnologyVST, true, mIsShell);
}

} // namespace zebaudiofilterhost::vst
