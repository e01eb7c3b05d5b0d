#pragma once

namespace zebhost
{

// While one lives, this thread takes denormal numbers as zero and makes none: they are inaudible, and cost a plug-in
// many times its usual time.
class DenormalGuard
{
public:
    DenormalGuard();
    ~DenormalGuard();
    DenormalGuard(const DenormalGuard&) = delete;
    DenormalGuard& operator=(const DenormalGuard&) = delete;

private:
    unsigned int mPrevious;
};

} // namespace zebhost
