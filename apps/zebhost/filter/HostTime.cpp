#include "filter/HostTime.h"

#include "cli/Failure.h"
#include "output/Numbers.h"
#include "output/Strings.h"

#include <cmath>

namespace zebhost
{

namespace
{

int WholeNumber(const std::string& text)
{
    const double value = ParseNumber(text).value_or(0);
    return value >= 1 && value <= 256 && value == std::floor(value) ? static_cast<int>(value) : 0;
}

} // namespace

void ReadTimeSignature(const std::string& text, MusicalTime& time)
{
    const std::vector<std::string> parts = Split(text, '/');
    const int numerator = parts.size() == 2 ? WholeNumber(parts[0]) : 0;
    const int denominator = parts.size() == 2 ? WholeNumber(parts[1]) : 0;
    const bool isPowerOfTwo = denominator > 0 && (denominator & (denominator - 1)) == 0;
    if (numerator == 0 || !isPowerOfTwo)
    {
        throw Failure(ExitCode::Usage, "--time-sig " + text + ": give two numbers such as 4/4 or 6/8");
    }
    time.numerator = numerator;
    time.denominator = denominator;
}

HostTime::HostTime(const MusicalTime& time) : mTime(time)
{
}

bool HostTime::GetTimeInfo(zebaudiofilterhost::utility::TimecodeFormat&, int&, int&) const
{
    return false;
}

bool HostTime::GetTempo(zebaudiofilterhost::utility::Tempo& tempo) const
{
    tempo.mTempo = mTime.tempo;
    tempo.mNumerator = mTime.numerator;
    tempo.mDenominator = mTime.denominator;
    return true;
}

bool HostTime::GetTransportState(bool& playing, bool& recording, bool& looping) const
{
    playing = true;
    recording = false;
    looping = false;
    return true;
}

} // namespace zebhost
