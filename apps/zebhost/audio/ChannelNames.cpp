#include "audio/ChannelNames.h"

#include "cli/Failure.h"
#include "output/Numbers.h"
#include "output/Strings.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

namespace zebhost
{

using namespace zebmediatypes;

namespace
{

constexpr std::array<std::pair<AudioChannelLabel, const char*>, 32> kNames = {{
    {kAudioChannelLabel_Left, "L"},
    {kAudioChannelLabel_Right, "R"},
    {kAudioChannelLabel_Center, "C"},
    {kAudioChannelLabel_LFE, "LFE"},
    {kAudioChannelLabel_LeftSurround, "Ls"},
    {kAudioChannelLabel_RightSurround, "Rs"},
    {kAudioChannelLabel_CenterSurround, "Cs"},
    {kAudioChannelLabel_LeftCenter, "Lc"},
    {kAudioChannelLabel_RightCenter, "Rc"},
    {kAudioChannelLabel_SideLeft, "Sl"},
    {kAudioChannelLabel_SideRight, "Sr"},
    {kAudioChannelLabel_TopCenter, "Tc"},
    {kAudioChannelLabel_TopFrontLeft, "Tfl"},
    {kAudioChannelLabel_TopFrontRight, "Tfr"},
    {kAudioChannelLabel_TopFrontCenter, "Tfc"},
    {kAudioChannelLabel_TopRearLeft, "Trl"},
    {kAudioChannelLabel_TopRearRight, "Trr"},
    {kAudioChannelLabel_TopRearCenter, "Trc"},
    {kAudioChannelLabel_LeftWide, "Lw"},
    {kAudioChannelLabel_RightWide, "Rw"},
    {kAudioChannelLabel_TopSideLeft, "Tsl"},
    {kAudioChannelLabel_TopSideRight, "Tsr"},
    {kAudioChannelLabel_RearLeftSurround, "Rls"},
    {kAudioChannelLabel_RearRightSurround, "Rrs"},
    {kAudioChannelLabel_LFE2, "LFE2"},
    {kAudioChannelLabel_AmbisonicW, "W"},
    {kAudioChannelLabel_AmbisonicX, "X"},
    {kAudioChannelLabel_AmbisonicY, "Y"},
    {kAudioChannelLabel_AmbisonicZ, "Z"},
    {kAudioChannelLabel_BottomFrontLeft, "Bfl"},
    {kAudioChannelLabel_BottomFrontCenter, "Bfc"},
    {kAudioChannelLabel_BottomFrontRight, "Bfr"},
}};

ChannelLayout SideSurround71()
{
    return {kAudioChannelLabel_Left,     kAudioChannelLabel_Right,        kAudioChannelLabel_Center,
            kAudioChannelLabel_LFE,      kAudioChannelLabel_LeftSurround, kAudioChannelLabel_RightSurround,
            kAudioChannelLabel_SideLeft, kAudioChannelLabel_SideRight};
}

int IndexOfName(const std::string& name, const std::vector<std::string>& names)
{
    const std::optional<double> number = ParseNumber(name);
    if (number && *number == std::floor(*number) && *number >= 1 && *number <= static_cast<double>(names.size()))
    {
        return static_cast<int>(*number) - 1;
    }
    const auto found = std::find_if(names.begin(), names.end(),
                                    [&name](const std::string& each) { return EqualIgnoringCase(each, name); });
    return found == names.end() ? -1 : static_cast<int>(found - names.begin());
}

} // namespace

std::vector<std::string> ChannelNames(const ChannelLayout& layout)
{
    std::vector<std::string> names;
    for (const AudioChannelDescription& channel : layout)
    {
        const auto found = std::find_if(kNames.begin(), kNames.end(),
                                        [&channel](const auto& name) { return name.first == channel.GetLabel(); });
        names.push_back(found != kNames.end() ? std::string(found->second) : std::to_string(names.size() + 1));
    }
    if (layout.size() == 1 && layout.front().GetLabel() == kAudioChannelLabel_None)
    {
        names.front() = "mono";
    }
    return names;
}

ChannelLayout UsualLayout(int channels)
{
    switch (channels)
    {
    case 1:
        return CreateMonoChannelLayout();
    case 2:
        return CreateStereoChannelLayout();
    case 3:
        return Create_L_R_C_ChannelLayout();
    case 4:
        return CreateQuadraphonicChannelLayout();
    case 5:
        return Create_L_R_C_Ls_Rs_ChannelLayout();
    case 6:
        return CreateBroadcast51ChannelLayout();
    case 7:
        return Create_L_R_C_LFE_Ls_Rs_Cs_ChannelLayout();
    case 8:
        return SideSurround71();
    default:
        return ChannelLayout(static_cast<std::size_t>(std::max(channels, 0)));
    }
}

std::vector<ChannelLayout> OtherLayouts(int channels)
{
    if (channels == 8)
    {
        return {Create7_1ChannelLayout(), Create7_1ItuChannelLayout()};
    }
    if (channels == 4)
    {
        return {Create_L_R_C_Cs_ChannelLayout(), CreateAmbisonicsBFormatChannelLayout()};
    }
    return {};
}

std::vector<int> ParseChannels(const std::string& text, const ChannelLayout& layout)
{
    const std::vector<std::string> names = ChannelNames(layout);
    std::vector<int> channels;
    for (const std::string& piece : Split(text, ','))
    {
        const int index = IndexOfName(std::string(Trimmed(piece)), names);
        if (index < 0)
        {
            throw Failure(ExitCode::Usage, "--on " + text + ": there is no channel '" + piece + "'; the file has " +
                                               Joined(names, ", ") + ", which are 1 to " +
                                               std::to_string(names.size()));
        }
        if (std::find(channels.begin(), channels.end(), index) != channels.end())
        {
            throw Failure(ExitCode::Usage, "--on " + text + ": channel '" + piece + "' stands there twice");
        }
        channels.push_back(index);
    }
    return channels;
}

} // namespace zebhost
