#include "tests/persistence/SaveFaults.h"

#include <ostream>

#include <unistd.h>

using Calls = zebcore::filesupport::FileSystemCalls;

void PrintTo(const SaveFault& fault, std::ostream* out)
{
    *out << fault.mName;
}

namespace
{

ssize_t WriteOneByte(int descriptor, const void* data, std::size_t /*size*/)
{
    return write(descriptor, data, 1);
}

void FailSecondClose(Calls& calls)
{
    calls.mClose = [good = 1](int descriptor) mutable
    {
        close(descriptor);
        if (good-- > 0)
            return 0;
        errno = EDQUOT;
        return -1;
    };
}

void WriteNothing(Calls& calls)
{
    calls.mWrite = [](int, const void*, std::size_t)
    {
        return ssize_t{0};
    };
}

void WriteOneByteThenFillUp(Calls& calls)
{
    calls.mWrite = FailAfter(1, ENOSPC, std::function<ssize_t(int, const void*, std::size_t)>(WriteOneByte));
}

} // namespace

const std::vector<SaveFault>& SaveFaults()
{
    static const std::vector<SaveFault> sFaults = {
        {"no room for the temporary file", [](Calls& calls) { calls.mOpen = FailAfter(0, ENOSPC, calls.mOpen); },
         ENOSPC, false},
        {"folder is read-only", [](Calls& calls) { calls.mOpen = FailAfter(0, EROFS, calls.mOpen); }, EROFS, false},
        {"disk full at once", [](Calls& calls) { calls.mWrite = FailAfter(0, ENOSPC, calls.mWrite); }, ENOSPC, false},
        {"disk full after a short write", WriteOneByteThenFillUp, ENOSPC, false},
        {"nothing written, no reason given", WriteNothing, ENOSPC, false},
        {"quota found out at close", FailSecondClose, EDQUOT, false},
        {"flush fails", [](Calls& calls) { calls.mFlush = FailAfter(0, EIO, calls.mFlush); }, EIO, false},
        {"rename fails", [](Calls& calls) { calls.mRename = FailAfter(0, EIO, calls.mRename); }, EIO, false},
        {"rename finds no room", [](Calls& calls) { calls.mRename = FailAfter(0, ENOSPC, calls.mRename); }, ENOSPC,
         false},
        {"old file is immutable", [](Calls& calls) { calls.mRename = FailAfter(0, EPERM, calls.mRename); }, EPERM,
         true},
        {"old file is another's", [](Calls& calls) { calls.mRename = FailAfter(0, EACCES, calls.mRename); }, EACCES,
         true},
    };
    return sFaults;
}

InjectedFault::InjectedFault(const std::function<void(Calls&)>& inject)
{
    inject(zebcore::filesupport::FileSystem());
}

InjectedFault::~InjectedFault()
{
    zebcore::filesupport::FileSystem() = Calls();
}
