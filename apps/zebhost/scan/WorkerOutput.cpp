#include "scan/WorkerOutput.h"

#include "output/PrintableText.h"
#include "output/Strings.h"

#include <algorithm>
#include <utility>

namespace zebhost
{

namespace
{

constexpr std::size_t kKept = 4096;
constexpr std::size_t kShown = std::size_t{256} * 1024;
constexpr std::size_t kLongestLine = 160;

// What a plug-in prints must not reach the terminal as commands.
std::string Shown(std::string line)
{
    std::replace(line.begin(), line.end(), '\t', ' ');
    return Printable(FromUTF8(line));
}

} // namespace

WorkerOutput::WorkerOutput(Console& console, bool show) : mConsole(console), mShow(show)
{
}

void WorkerOutput::Begin()
{
    mAmount = 0;
    mTail.clear();
    mLines = LineBuffer();
}

void WorkerOutput::Take(std::string_view piece)
{
    if (mShow && mAmount < kShown)
    {
        Show(piece.substr(0, kShown - mAmount));
    }
    mAmount += piece.size();
    mTail += piece.substr(piece.size() - std::min(piece.size(), kKept));
    mTail.erase(0, mTail.size() - std::min(mTail.size(), kKept));
}

void WorkerOutput::Show(std::string_view piece)
{
    mLines.Append(piece);
    while (auto line = mLines.Next())
    {
        mConsole.Warn(Shown(*std::move(line)));
    }
    if (mAmount + piece.size() == kShown)
    {
        mConsole.Warn("zebhost: this plug-in prints too much; the rest is left out");
    }
}

std::string WorkerOutput::LastLine() const
{
    const std::vector<std::string> lines = Split(mTail, '\n');
    for (auto line = lines.rbegin(); line != lines.rend(); ++line)
    {
        std::string text = Printable(FromUTF8(*line));
        if (!text.empty())
        {
            return text.size() <= kLongestLine ? text : Printable(FromUTF8(text.substr(0, kLongestLine))) + "...";
        }
    }
    return {};
}

} // namespace zebhost
