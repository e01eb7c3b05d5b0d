#pragma once

#include "foundation/zebcore/internal/FileSystemCalls.h"

#include <cerrno>
#include <functional>
#include <iosfwd>
#include <vector>

// What can go wrong while a file is saved.
struct SaveFault
{
    const char* mName;
    std::function<void(zebcore::filesupport::FileSystemCalls&)> mInject;
    int mError;      // what the caller is told
    bool mIsRefusal; // by the system, to give up the old file
};

void PrintTo(const SaveFault& fault, std::ostream* out);

// Those after which the old file is there.
const std::vector<SaveFault>& SaveFaults();

// Injects a fault for as long as it lives.
class InjectedFault
{
public:
    explicit InjectedFault(const std::function<void(zebcore::filesupport::FileSystemCalls&)>& inject);
    ~InjectedFault();
    InjectedFault(const InjectedFault&) = delete;
    InjectedFault& operator=(const InjectedFault&) = delete;
};

// Fails the calls that follow `good` good ones.
template <typename Result, typename... Arguments>
std::function<Result(Arguments...)> FailAfter(int good, int error, std::function<Result(Arguments...)> call)
{
    return [good, error, call](Arguments... arguments) mutable
    {
        if (good-- > 0)
            return call(arguments...);
        errno = error;
        return Result{-1};
    };
}
