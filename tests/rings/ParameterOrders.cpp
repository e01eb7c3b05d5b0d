// What the orders of the parameter ring and of the set of written rings hold up, one thing after the other.
#include "host/src/VST3/src/DirtySet.h"
#include "host/src/VST3/src/ParameterRing.h"
#include "tests/rings/Handover.h"

using namespace zebaudiofilterhost::vst3;
using zebaudiofilterhost::testing::DoOnTwoThreads;

namespace
{

constexpr std::size_t kNumbers = 5000; // three levels
constexpr std::size_t kNumber = 4700;

void AddAndTake()
{
    int written = 0;
    DirtySet set(kNumbers);
    DoOnTwoThreads(
        [&]
        {
            written = 1;
            set.Add(kNumber);
        },
        [&] { set.TakeAll([&](std::size_t) { ++written; }); });
}

void AddAndRemove()
{
    int written = 0;
    DirtySet set(kNumbers);
    DoOnTwoThreads(
        [&]
        {
            written = 1;
            set.Add(kNumber);
        },
        [&]
        {
            set.Remove(kNumber);
            ++written;
        });
}

void WriteAndRead()
{
    int written = 0;
    ParameterRing ring;
    DoOnTwoThreads(
        [&]
        {
            written = 1;
            ring.Write({.5, 3});
        },
        [&]
        {
            ParameterQueueValue value;
            if (ring.Read(value, ring.GetEnd()))
                ++written;
        });
}

} // namespace

int main()
{
    AddAndTake();
    AddAndRemove();
    WriteAndRead();
}
