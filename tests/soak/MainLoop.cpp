#include "MainLoop.h"

#include "Throws.h"
#include "foundation/zebcore/MainThreadLoop.h"

namespace soak
{

namespace
{

template <typename Work>
void NameTheLoop(const Work& work)
{
    try
    {
        work();
    }
    catch (...)
    {
        throw LoopError(DescribeCurrentException());
    }
}

} // namespace

void ServeLoop()
{
    NameTheLoop([] { zebcore::threads::PumpMainThread(); });
}

void Settle(unsigned int milliseconds)
{
    NameTheLoop([milliseconds] { zebcore::threads::RunMainThreadUntil({}, milliseconds); });
}

} // namespace soak
