// One function that takes foreign bytes, known by its name.
#pragma once

#include <cstdint>
#include <span>
#include <stdexcept>
#include <vector>

namespace zebfuzz
{

using Bytes = std::span<const std::uint8_t>;

// Made once in the file of each target. A fuzzer holds one, the test of the corpus all of them.
class Target
{
public:
    using Function = void (*)(Bytes);

    Target(const char* name, Function run);
    Target(const Target&) = delete;
    Target& operator=(const Target&) = delete;

    const char* Name() const { return mName; }
    void Run(Bytes bytes) const { mRun(bytes); }

    static const std::vector<const Target*>& All();

private:
    const char* mName;
    Function mRun;
};

// What a target throws when the library did not do what it promises. Nothing between takes it, so a fuzzer ends
// there.
class Finding : public std::logic_error
{
    using std::logic_error::logic_error;
};

// `promise` is what should hold.
void Expect(bool holds, const char* promise);

} // namespace zebfuzz
