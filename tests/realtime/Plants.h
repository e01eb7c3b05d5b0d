#pragma once

#include "tests/support/RealtimeGuard.h"

#include <functional>
#include <string>
#include <vector>

namespace realtimeguard
{

// A violation that is planted to see that its net reports it.
struct Plant
{
    std::string name;
    Violation violation;
    std::function<void()> act;
};

const std::vector<Plant>& Plants();

// Says so on stderr if the build or the kernel lacks the net.
bool CanSee(Violation violation);

} // namespace realtimeguard
