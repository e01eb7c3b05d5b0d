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

/// Such as "123.4 MB".
std::string Megabytes(double bytes);

} // namespace soak
