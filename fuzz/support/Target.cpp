#include "fuzz/support/Target.h"

namespace zebfuzz
{

namespace
{

std::vector<const Target*>& Targets()
{
    static std::vector<const Target*> sTargets;
    return sTargets;
}

} // namespace

Target::Target(const char* name, Function run) : mName(name), mRun(run)
{
    Targets().push_back(this);
}

const std::vector<const Target*>& Target::All()
{
    return Targets();
}

void Expect(bool holds, const char* promise)
{
    if (!holds)
        throw Finding(promise);
}

} // namespace zebfuzz
