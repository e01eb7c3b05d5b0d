#pragma once

#include "Resources.h"

#include <string>
#include <vector>

namespace soak
{

/// What was measured while nothing lived.
struct Sample
{
    double seconds = 0.0; // since the first
    Resources resources;
};

/// One thing that must hold.
struct Check
{
    enum class Outcome
    {
        Holds,
        Fails,
        NotJudged // too little was measured
    };

    std::string what;
    std::string figures;
    Outcome outcome = Outcome::Holds;
};

const char* NameOf(Check::Outcome outcome);

/// Of rows of samples: memory by quarters of the time, the rest at both ends. Empty without samples.
std::vector<Check> JudgeResources(const std::vector<Sample>& samples);

/// Whether there were effects to use, the control not counted.
Check JudgeSubjects(std::size_t effects);

/// Whether the run came to its end.
Check JudgeEnd(bool interrupted);

/// Whether any of so many effects of this project threw. Those of others may: their hosts have to live with it.
Check JudgeThrows(std::size_t own, unsigned long byOwn, unsigned long byOthers);

/// Of fixed probes that could be compared, and those of them that sounded different.
Check JudgeProbes(std::size_t compared, std::size_t different);

/// A run has passed if something was judged and nothing fails.
bool AllHold(const std::vector<Check>& checks);

/// Such as "123.4 MB".
std::string Megabytes(double bytes);

} // namespace soak
