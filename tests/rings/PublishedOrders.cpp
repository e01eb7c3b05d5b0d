// What the orders of a published value hold up, one thing after the other.
#include "tests/rings/Handover.h"
#include "utility/src/Published.h"

#include <memory>

using zebaudiofilterhost::Published;
using zebaudiofilterhost::testing::DoOnTwoThreads;

namespace
{

volatile int sSeen = 0; // A value that nobody wants would not be read

void Read(const Published<int>& published)
{
    sSeen = *Published<int>::Reader(published);
}

void PublishAndRead()
{
    Published<int> published;
    DoOnTwoThreads([&] { published.Publish(1); }, [&] { Read(published); });
}

void ReadAndFree()
{
    Published<int> published;
    DoOnTwoThreads([&] { Read(published); },
                   [&]
                   {
                       published.Publish(1);
                       published.FreeRetired();
                   });
}

void RetireAndFree()
{
    Published<int> published;
    DoOnTwoThreads([&] { published.Publish(1); }, [&] { published.FreeRetired(); });
}

// What the value points to is the owner's again as soon as nobody reads the value.
void ReadAndAwait()
{
    int owned = 0;
    Published<int*> published;
    published.Publish(&owned);
    DoOnTwoThreads([&] { ++**Published<int*>::Reader(published); },
                   [&]
                   {
                       published.Publish(nullptr);
                       published.AwaitReaders();
                       ++owned;
                   });
}

void PublishAndDestroy()
{
    auto published = std::make_unique<Published<int>>();
    Published<int>& shared = *published;
    DoOnTwoThreads([&] { shared.Publish(1); }, [&] { published.reset(); });
}

} // namespace

int main()
{
    PublishAndRead();
    ReadAndFree();
    RetireAndFree();
    ReadAndAwait();
    PublishAndDestroy();
}
