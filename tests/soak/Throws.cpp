#include "Throws.h"

#include <algorithm>
#include <cstdlib>
#include <memory>

#include <cxxabi.h>

namespace soak
{

namespace
{

std::string Demangled(const char* name)
{
    int status = 0;
    const std::unique_ptr<char, void (*)(void*)> text(abi::__cxa_demangle(name, nullptr, nullptr, &status),
                                                      std::free);
    return text == nullptr ? name : text.get();
}

std::string NamesOf(Throws::Cast suspects)
{
    std::sort(suspects.begin(), suspects.end(), [](const Subject* a, const Subject* b) { return a->name < b->name; });
    suspects.erase(std::unique(suspects.begin(), suspects.end()), suspects.end());
    std::string names = suspects.size() > 1 ? "one of " : "";
    for (const Subject* subject : suspects)
    {
        names += (subject == suspects.front() ? "" : ", ") + subject->name;
    }
    return names;
}

} // namespace

Thrown DescribeCurrentException()
{
    Thrown thrown{Demangled(abi::__cxa_current_exception_type()->name()), ""};
    try
    {
        throw;
    }
    catch (const std::exception& exception)
    {
        thrown.what = exception.what();
    }
    catch (...) // the type says all
    {
    }
    return thrown;
}

bool Throws::Try(const Subject& subject, const std::string& step, const Cast& inUse,
                 const std::function<void()>& work)
{
    try
    {
        work();
        return true;
    }
    catch (const Fault& fault)
    {
        throw Fault(subject.name + ", " + step + ": " + fault.what());
    }
    catch (const LoopError& error)
    {
        Add(inUse, step, error.GetThrown());
    }
    catch (...)
    {
        Add({&subject}, step, DescribeCurrentException());
    }
    return false;
}

void Throws::Add(const Cast& suspects, const std::string& step, const Thrown& thrown)
{
    // The same effects were in use alone too, which tells whose it is: several are ours only if none is another's.
    const bool own =
        std::all_of(suspects.begin(), suspects.end(), [](const Subject* subject) { return subject->own; });
    const std::string effect = NamesOf(suspects);
    auto entry = std::find_if(mEntries.begin(), mEntries.end(),
                              [&](const Entry& known)
                              { return known.effect == effect && known.step == step && known.thrown == thrown; });
    if (entry == mEntries.end())
    {
        entry = mEntries.insert(entry, {effect, step, thrown, own});
    }
    ++entry->times;
}

unsigned long Throws::Count(bool own) const
{
    unsigned long times = 0;
    for (const Entry& entry : mEntries)
    {
        times += entry.own == own ? entry.times : 0;
    }
    return times;
}

} // namespace soak
