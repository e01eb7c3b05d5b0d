#pragma once

#include <audiofilter/IAudioFilterHost.h>

#include <string>

namespace zebhost
{

struct MusicalTime
{
    double tempo = 120;
    int numerator = 4;
    int denominator = 4;
};

// Reads "6/8" into `time`; throws a usage Failure for anything else.
void ReadTimeSignature(const std::string& text, MusicalTime& time);

// Tells a plug-in a fixed tempo, and that the transport plays from the beginning.
class HostTime : public zebaudiofilterhost::IAudioFilterHost
{
public:
    explicit HostTime(const MusicalTime& time);

    bool GetTimeInfo(zebaudiofilterhost::utility::TimecodeFormat& format, int& first, int& second) const override;
    bool GetTempo(zebaudiofilterhost::utility::Tempo& tempo) const override;
    bool GetTransportState(bool& playing, bool& recording, bool& looping) const override;

private:
    MusicalTime mTime;
};

} // namespace zebhost
