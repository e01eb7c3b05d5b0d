#pragma once

#include <cstddef>
#include <cstdint>
#include <random>

namespace soak
{

/// All that a run decides by chance, from one start: the same start gives the same run.
class Dice
{
public:
    explicit Dice(std::uint64_t randomStart) : mEngine(randomStart) {}

    std::size_t Below(std::size_t count) { return static_cast<std::size_t>(mEngine() % count); }
    int Between(int least, int most)
    {
        return least + static_cast<int>(Below(static_cast<std::size_t>(most - least) + 1));
    }
    bool OneIn(std::size_t count) { return Below(count) == 0; }
    float Unit() { return static_cast<float>(mEngine() >> 40U) / static_cast<float>(1U << 24U); }

    template <typename Container>
    const auto& Pick(const Container& items)
    {
        return items[Below(items.size())];
    }

    std::mt19937_64& Engine() { return mEngine; }

private:
    std::mt19937_64 mEngine;
};

} // namespace soak
