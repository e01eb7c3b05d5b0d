#pragma once

#include <cstdint>
#include <string>

namespace soak
{

/// Lets the calling thread tell of its own stack's overflow too.
void UseSignalStack();

/// Should the process crash or hang, says where the run stood. [main]
class CrashNote
{
public:
    /// `descriptor` gets the sentence.
    CrashNote(int descriptor, std::uint64_t randomStart);

    /// To be called ahead of each step; a step that takes minutes counts as a hang.
    void Step(const std::string& name, const char* operation, unsigned long number);
    void Done();

private:
    std::uint64_t mRandomStart;
};

} // namespace soak
