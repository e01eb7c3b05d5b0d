#pragma once

#include "output/Console.h"
#include "scan/LineBuffer.h"

#include <string>
#include <string_view>

namespace zebhost
{

// What plug-ins print in the worker process. However much it is, little is kept.
class WorkerOutput
{
public:
    // With `show` lines go on to standard error, up to a bound for each plug-in.
    WorkerOutput(Console& console, bool show);

    // The next plug-in's begins.
    void Begin();
    void Take(std::string_view piece);
    // Bytes since Begin.
    std::size_t Amount() const { return mAmount; }
    // The last line that is not blank, without anything unprintable; cut if it is long.
    std::string LastLine() const;

private:
    void Show(std::string_view piece);

    Console& mConsole;
    bool mShow;
    std::size_t mAmount = 0;
    std::string mTail;
    LineBuffer mLines;
};

} // namespace zebhost
