#include "tests/realtime/Plants.h"

#include <array>
#include <chrono>
#include <condition_variable>
#include <cstdlib>
#include <memory>
#include <mutex>
#include <shared_mutex>
#include <sys/mman.h>
#include <thread>
#include <unistd.h>

namespace realtimeguard
{

namespace
{

void* volatile sKept = nullptr; // Keeps the compiler from leaving an allocation out
std::mutex sMutex;
std::shared_mutex sSharedMutex;
std::condition_variable sCondition;

void AllocateAligned()
{
    struct alignas(64) Aligned
    {
        char bytes[64];
    };
    const auto made = std::make_unique<Aligned>();
    sKept = made.get();
}

void TryToLock()
{
    if (sMutex.try_lock())
        sMutex.unlock();
}

void WaitForCondition()
{
    std::unique_lock<std::mutex> lock(sMutex);
    sCondition.wait_for(lock, std::chrono::microseconds(1));
}

// A page that the kernel has taken back.
void TouchFreshPage()
{
    constexpr std::size_t kPage = 4096;
    alignas(kPage) static volatile char sPage[kPage];
    madvise(const_cast<char*>(sPage), kPage, MADV_DONTNEED);
    sPage[0] = 1;
}

} // namespace

const std::vector<Plant>& Plants()
{
    static const std::vector<Plant> sPlants = {
        {"malloc", Violation::Allocation,
         []
         {
             sKept = std::malloc(100);
         }},
        {"free", Violation::Free,
         []
         {
             std::free(sKept);
         }},
        {"aligned new", Violation::Allocation, AllocateAligned},
        {"vector", Violation::Allocation,
         []
         {
             sKept = std::vector<int>(1000).data();
         }},
        {"string", Violation::Free,
         []
         {
             sKept = std::string(100, 'x').data();
         }},
        {"mutex", Violation::Lock,
         []
         {
             const std::lock_guard<std::mutex> lock(sMutex);
         }},
        {"try_lock", Violation::Lock, TryToLock},
        {"shared mutex", Violation::Lock,
         []
         {
             const std::shared_lock<std::shared_mutex> lock(sSharedMutex);
         }},
        {"condition", Violation::Lock, WaitForCondition},
        {"write", Violation::SystemCall,
         []
         {
             sKept = ::write(-1, "", 0) < 0 ? nullptr : sKept;
         }},
        {"yield", Violation::SystemCall,
         []
         {
             std::this_thread::yield();
         }},
        {"fresh page", Violation::PageFault, TouchFreshPage},
        {"sleep", Violation::VoluntarySwitch,
         []
         {
             std::this_thread::sleep_for(std::chrono::microseconds(1));
         }},
    };
    return sPlants;
}

bool CanSee(Violation violation)
{
    AnnounceWhatIsMissing();
    return violation == Violation::SystemCall ? CatchesSystemCalls() : IsActive();
}

} // namespace realtimeguard
