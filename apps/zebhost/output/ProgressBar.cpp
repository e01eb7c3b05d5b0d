#include "output/ProgressBar.h"

#include <algorithm>

namespace zebhost
{

std::string ProgressBar(long long done, long long total, const std::string& name)
{
    constexpr long long kCells = 20;
    const long long bounded = std::clamp(done, 0LL, std::max(total, 1LL));
    const auto filled = static_cast<std::size_t>(bounded * kCells / std::max(total, 1LL));
    return "[" + std::string(filled, '#') + std::string(static_cast<std::size_t>(kCells) - filled, '-') + "] " +
           std::to_string(done) + "/" + std::to_string(total) + " " + name;
}

} // namespace zebhost
