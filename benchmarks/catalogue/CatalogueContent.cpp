#include "benchmarks/catalogue/CatalogueContent.h"

#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"

#include <unistd.h>

#include <algorithm>
#include <numeric>
#include <random>
#include <stdexcept>
#include <string>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

constexpr int kPluginsPerVendor = 25;
constexpr unsigned int kVersion = 0x00010203;

using zebcore::utility::UTF16FromNarrow;

std::string Vendor(int index)
{
    return "Maker of Sound No. " + std::to_string(index / kPluginsPerVendor);
}

std::string Name(int index)
{
    return "Stereo Effect " + std::to_string(index);
}

std::string Path(int index)
{
    return "/usr/local/lib/vst3/" + Vendor(index) + "/" + Name(index) + ".vst3";
}

class OwnFolder
{
public:
    OwnFolder()
    {
        namespace fs = std::filesystem;
        const fs::path memory = "/dev/shm";
        const fs::path parent = access(memory.c_str(), W_OK) == 0 ? memory : fs::temp_directory_path();
        std::string pattern = parent / "zeb-bench-XXXXXX";
        if (mkdtemp(pattern.data()) == nullptr)
        {
            throw std::runtime_error("cannot make " + pattern);
        }
        mPath = pattern;
    }
    ~OwnFolder()
    {
        std::error_code error;
        std::filesystem::remove_all(mPath, error);
    }
    OwnFolder(const OwnFolder&) = delete;
    OwnFolder& operator=(const OwnFolder&) = delete;

    const std::filesystem::path& Path() const { return mPath; }

private:
    std::filesystem::path mPath;
};

} // namespace

PluginLocator LocatorOf(int index)
{
    return {kTechnologyVST3, UTF16FromNarrow(Path(index))};
}

UTF16String FilterIDOf(int index)
{
    const std::string digits = std::to_string(index);
    return u"3:" + UTF16FromNarrow(std::string(32 - digits.size(), '0') + digits);
}

boost::intrusive_ptr<PluginModuleInfo> RecordOf(int index)
{
    boost::intrusive_ptr<PluginModuleInfo> record(new PluginModuleInfo(LocatorOf(index), UTF16FromNarrow(Name(index)),
                                                                       UTF16FromNarrow(Vendor(index)), kVersion,
                                                                       kTechnologyVST3, true, false));
    record->SetHasAnyNonSynthEffect(true);
    return record;
}

boost::intrusive_ptr<AudioFilterDescriptor> DescriptorOf(int index)
{
    boost::intrusive_ptr<AudioFilterDescriptor> descriptor(new AudioFilterDescriptor(
        LocatorOf(index), UTF16FromNarrow(Name(index)), UTF16FromNarrow(Vendor(index)), kVersion, kCategoryVST3Delay,
        FilterIDOf(index), Guid(1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11), false));
    descriptor->SetSupportsMono(true);
    descriptor->SetSupportsStereo(true);
    return descriptor;
}

PeerCatalogue::Plugin PeerPluginOf(int index)
{
    return {Name(index), Vendor(index), "1.2.3", "Fx|Delay", Path(index), index};
}

void EmptyCatalogue()
{
    PluginModuleInfoManager::GetInstance().ClearAll(true);
}

void FillCatalogue(int plugins)
{
    EmptyCatalogue();
    for (int index = 0; index < plugins; ++index)
    {
        PluginModuleInfoManager::GetInstance().AddPluginModuleInfo(RecordOf(index));
        AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(DescriptorOf(index));
    }
}

bool CatalogueHolds(int plugins)
{
    const PluginModuleInfoManager& records = PluginModuleInfoManager::GetInstance();
    const auto infos = AudioFilterDescriptorManager::GetInstance().GetExternalInfos();
    int index = 0;
    const bool same = std::equal(records.PluginInfoBegin(), records.PluginInfoEnd(), infos.begin(), infos.end(),
                                 [&index](const auto& record, const auto& descriptor)
                                 {
                                     const bool right =
                                         record->GetLocator() == LocatorOf(index) && record->IsEnabled() &&
                                         descriptor->GetUniqueID() == FilterIDOf(index) &&
                                         descriptor->GetVendorString() == UTF16FromNarrow(Vendor(index)) &&
                                         descriptor->GetSupportsStereo() && record->GetVersion() == kVersion;
                                     ++index;
                                     return right;
                                 });
    return same && index == plugins;
}

std::vector<int> Ordered(int count)
{
    std::vector<int> numbers(static_cast<std::size_t>(count));
    std::iota(numbers.begin(), numbers.end(), 0);
    return numbers;
}

std::vector<int> Shuffled(int count)
{
    std::vector<int> numbers = Ordered(count);
    std::shuffle(numbers.begin(), numbers.end(), std::mt19937(1));
    return numbers;
}

const std::filesystem::path& WorkFolder()
{
    static const OwnFolder sFolder;
    return sFolder.Path();
}

} // namespace zebaudiofilterhost::benchmarks
