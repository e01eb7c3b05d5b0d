// An application's chain of effects over several starts, while one of its plug-ins goes and comes back.

#include "tests/chain/EffectChain.h"

#include "audiofilter/AudioFilterProxy.h"
#include "foundation/zebcore/NativePath.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginModuleScanner.h"
#include "module/Module.h"
#include "tests/plugins/FixturePaths.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <bit>
#include <cstdint>
#include <cstring>
#include <exception>
#include <fstream>
#include <functional>
#include <iterator>
#include <random>

#include <sys/wait.h>
#include <unistd.h>

namespace chain
{

namespace
{

namespace fs = std::filesystem;
using namespace zebaudiofilterhost;
using ::testing::Each;

constexpr std::size_t kBlocks = 96;
constexpr std::size_t kSilentFrom = 64;    // the input's last third
constexpr unsigned long long kFront = 0x3; // L and R
const std::vector<std::u16string> kNames = {u"Zeb Gain", u"Zeb Delay", u"Zeb Compressor", u"ZebGain2"};

Channels Noise()
{
    std::minstd_rand random;
    std::uniform_real_distribution<float> noise(-0.5F, 0.5F);
    Channels channels(kChannels, std::vector<float>(kBlocks * kFrames));
    for (std::vector<float>& channel : channels)
    {
        std::generate_n(channel.begin(), kSilentFrom * kFrames, [&] { return noise(random); });
    }
    return channels;
}

// Bit for bit; tells where the first difference is.
::testing::AssertionResult IsSameSound(const Channels& a, const Channels& b)
{
    for (std::size_t channel = 0; channel < kChannels; ++channel)
    {
        for (std::size_t frame = 0; frame < kBlocks * kFrames; ++frame)
        {
            if (std::bit_cast<std::uint32_t>(a[channel][frame]) != std::bit_cast<std::uint32_t>(b[channel][frame]))
            {
                return ::testing::AssertionFailure() << "channel " << channel << ", frame " << frame << ": "
                                                     << a[channel][frame] << " and " << b[channel][frame];
            }
        }
    }
    return ::testing::AssertionSuccess();
}

bool IsSilent(const std::vector<float>& channel)
{
    return std::all_of(channel.begin(), channel.end(), [](float sample) { return sample == 0.0F; });
}

std::string Read(const fs::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

void WriteSound(const fs::path& file, const Channels& sound)
{
    std::ofstream stream(file, std::ios::binary);
    for (const std::vector<float>& channel : sound)
    {
        stream.write(static_cast<const char*>(static_cast<const void*>(channel.data())),
                     static_cast<std::streamsize>(channel.size() * sizeof(float)));
    }
}

Channels ReadSound(const fs::path& file)
{
    const std::string bytes = Read(file);
    Channels sound(kChannels, std::vector<float>(kBlocks * kFrames));
    const std::size_t size = kBlocks * kFrames * sizeof(float);
    for (std::size_t channel = 0; channel < sound.size() && bytes.size() == kChannels * size; ++channel)
    {
        std::memcpy(sound[channel].data(), bytes.data() + channel * size, size);
    }
    return sound;
}

// A machine of the test's own, with four plug-ins, on which an application is started again and again.
class ChainTest : public ::testing::Test
{
protected:
    ChainTest()
    {
        std::string pattern = (fs::temp_directory_path() / "zeb-chain-XXXXXX").string();
        mFolder = mkdtemp(pattern.data());
        fs::create_directories(mFolder / "plug-ins");
        const fs::path vst2 = zebtest::EffectFolder().parent_path() / "vst2";
        for (const fs::path& bundle : {zebtest::EffectBundle("ZebGain"), zebtest::EffectBundle("ZebDelay"),
                                       zebtest::EffectBundle("ZebCompressor"), vst2 / "ZebGain2.vst"})
        {
            fs::copy(bundle, mFolder / "plug-ins" / bundle.filename(), fs::copy_options::recursive);
        }
        for (const char* const variable : {"VST3_PATH", "VST_PATH"})
        {
            setenv(variable, (mFolder / "plug-ins").c_str(), 1);
        }
    }

    ~ChainTest() override
    {
        std::error_code ignored;
        fs::remove_all(mFolder, ignored);
    }

    // A start is a process of its own: in one that has loaded a plug-in, nothing of it ever goes.
    void Start(const std::function<void()>& work) const
    {
        std::fflush(nullptr);
        const pid_t child = fork();
        if (child == 0)
        {
            Work(work);
        }
        int status = -1;
        ASSERT_EQ(waitpid(child, &status, 0), child);
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << "status " << status;
    }

    // What is new comes into the catalogue, what has gone leaves it.
    static void Rescan()
    {
        PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
        std::vector<PluginLocator> gone;
        const std::vector<PluginLocator> found = manager.CollectPotentialPlugins(true, gone);
        manager.RemovePluginLocators(gone);
        const boost::intrusive_ptr<PluginModuleScanner> scanner(new PluginModuleScanner(found, false));
        scanner->BeginScan();
        while (scanner->ContinueScan())
        {
        }
        scanner->EndScan();
    }

    // One of each technology.
    void RemovePlugins() const
    {
        for (const char* const name : {"ZebDelay.vst3", "ZebGain2.vst"})
        {
            fs::rename(mFolder / "plug-ins" / name, mFolder / name);
        }
    }
    void BringThemBack() const
    {
        for (const char* const name : {"ZebDelay.vst3", "ZebGain2.vst"})
        {
            fs::rename(mFolder / name, mFolder / "plug-ins" / name);
        }
    }

    fs::path Path(const char* name) const { return mFolder / name; }

    // The chain as the user has set it up.
    static EffectChain SetUpChain(float feedback = 0.5F)
    {
        EffectChain chain(kNames);
        const std::vector<std::vector<float>> values = {
            {0.7F}, {0.05F, feedback, 0.6F, 0.25F}, {0.3F, 0.8F, 0.1F}, {0.6F}};
        for (std::size_t index = 0; index < chain.Count(); ++index)
        {
            AudioFilter& filter = *chain[index];
            FitIn(filter);
            // The compressor is on the surround channels; the other channels pass it by.
            const int first = index == 2 ? 4 : 0;
            for (const auto direction : {AudioFilter::kDirection_Input, AudioFilter::kDirection_Output})
            {
                filter.AssignChannelMapping(direction, 0, kChannels - 1); // The map gets as long as the track
                for (int channel = 0; channel < kChannels; ++channel)
                {
                    const bool isUsed = channel >= first && channel < first + 2;
                    filter.AssignChannelMapping(direction, isUsed ? channel - first : -1, channel);
                }
            }
            for (std::size_t parameter = 0; parameter < values[index].size(); ++parameter)
            {
                filter.PostSetParameter(static_cast<int>(parameter), values[index][parameter]);
            }
            filter.FlushMessageQueue();
        }
        chain[1]->SetPresetNameAndDirtyState({u"Canyon & <echo>", true});
        return chain;
    }

private:
    [[noreturn]] void Work(const std::function<void()>& work) const
    {
        try
        {
            Initialize();
            PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
            File settings(zebcore::filesupport::FromNativePath(Path("settings.xml").string()));
            manager.LoadConfiguration(settings);
            Rescan();
            work();
            manager.SaveConfiguration(settings, true);
            Terminate();
        }
        catch (const std::exception& error)
        {
            ADD_FAILURE() << error.what();
        }
        std::fflush(nullptr);
        _exit(HasFailure() ? 1 : 0);
    }

    fs::path mFolder;
};

} // namespace

TEST_F(ChainTest, SoundsAsBeforeWhenAMissingPluginIsBack)
{
    Start(
        [this]
        {
            EffectChain chain = SetUpChain();
            EXPECT_TRUE(chain[1]->DoPresetsUseChunkData() && !chain[3]->DoPresetsUseChunkData());
            const Rendered before = chain.Render(Noise());
            EXPECT_FALSE(IsSilent(before.sound[0]));
            EXPECT_FALSE(IsSameSound(before.sound, SetUpChain(0.9F).Render(Noise()).sound)) << "settings are heard";
            WriteSound(Path("before"), before.sound);
            chain.Save(Path("chain.xml"));
        });

    RemovePlugins();
    Start(
        [this]
        {
            EffectChain chain = EffectChain::Load(Path("chain.xml"));
            ASSERT_EQ(chain.Count(), 4U);
            EXPECT_FALSE(chain[0]->IsProxy() || chain[2]->IsProxy());
            EXPECT_TRUE(chain[3]->IsProxy());
            EXPECT_FALSE(chain[3]->DoPresetsUseChunkData());
            const auto proxy = boost::dynamic_pointer_cast<AudioFilterProxy>(chain[1]);
            ASSERT_TRUE(proxy);
            EXPECT_FALSE(proxy->CreateAudioFilterFromZombieState());
            EXPECT_EQ(proxy->GetParameterCount(), 4);
            EXPECT_TRUE(proxy->GetDisplayName().starts_with(u"Zeb Delay"));

            const Channels input = Noise();
            const Rendered rendered = chain.Render(input);
            // Nothing comes out of the proxy's channels, and what passes it by has no latency to wait for.
            EXPECT_THAT(rendered.silent[1], Each(kFront));
            EXPECT_THAT(rendered.silent[3], Each(kFront));
            EXPECT_TRUE(IsSilent(rendered.sound[0]) && IsSilent(rendered.sound[1]));
            for (const std::size_t channel : {2U, 3U})
            {
                EXPECT_TRUE(rendered.sound[channel] == input[channel]) << channel;
            }
            EXPECT_FALSE(IsSilent(rendered.sound[4])) << "the compressor behind it goes on";

            // Whatever the user turns on the proxy, what was saved of the plug-in is saved again.
            proxy->SetParameter(0, 1.0F);
            proxy->SetParameterDisplayName(0, u"Time");
            chain.Save(Path("saved with the proxy.xml"));
        });
    EXPECT_EQ(Read(Path("saved with the proxy.xml")), Read(Path("chain.xml")));

    BringThemBack();
    Start(
        [this]
        {
            EffectChain chain = EffectChain::Load(Path("saved with the proxy.xml"));
            ASSERT_EQ(chain.Count(), 4U);
            EXPECT_FALSE(chain[1]->IsProxy() || chain[3]->IsProxy());
            EXPECT_TRUE(IsSameSound(chain.Render(Noise()).sound, ReadSound(Path("before"))));
            chain.Save(Path("saved with the plug-in.xml"));
        });
    EXPECT_EQ(Read(Path("saved with the plug-in.xml")), Read(Path("chain.xml")));
}

TEST_F(ChainTest, ProxyWakesWhenThePluginComesBackWhileTheApplicationRuns)
{
    Start(
        [this]
        {
            EffectChain chain = SetUpChain();
            WriteSound(Path("before"), chain.Render(Noise()).sound);
            chain.Save(Path("chain.xml"));
        });
    RemovePlugins();
    Start(
        [this]
        {
            EffectChain chain = EffectChain::Load(Path("chain.xml"));
            chain.WakeProxies();
            EXPECT_TRUE(chain[1]->IsProxy() && chain[3]->IsProxy()) << "still missing";
            chain.Render(Noise());

            BringThemBack();
            Rescan();
            chain.WakeProxies();
            EXPECT_FALSE(chain[1]->IsProxy() || chain[3]->IsProxy());
            EXPECT_TRUE(chain[1]->GetPresetNameAndDirtyState() ==
                        std::make_pair(UTF16String(u"Canyon & <echo>"), true));
            EXPECT_TRUE(IsSameSound(chain.Render(Noise()).sound, ReadSound(Path("before"))));
        });
}

TEST_F(ChainTest, FilterPutToSleepWakesAsItWas)
{
    Start(
        []
        {
            EffectChain chain = SetUpChain();
            const Rendered before = chain.Render(Noise());
            for (std::size_t index = 0; index < chain.Count(); ++index)
            {
                const FilterPtr asleep(new AudioFilterProxy(chain[index]));
                asleep->SetMainTargetBus(chain[index]->GetMainTargetBus());
                chain[index] = asleep;
            }
            const Rendered silence = chain.Render(Noise());
            EXPECT_THAT(silence.silent[0], Each(kFront));
            EXPECT_TRUE(IsSilent(silence.sound[0]) && IsSilent(silence.sound[5]));
            EXPECT_TRUE(silence.sound[2] == Noise()[2]) << "no effect is on the centre";
            chain.WakeProxies();
            EXPECT_TRUE(IsSameSound(chain.Render(Noise()).sound, before.sound));
        });
}

} // namespace chain
