#include "scan/LineBuffer.h"

namespace zebhost
{

std::optional<std::string> LineBuffer::Next()
{
    const std::size_t end = mText.find('\n', mSearched);
    if (end == std::string::npos)
    {
        mText.erase(0, mStart);
        mStart = 0;
        mSearched = mText.size();
        return std::nullopt;
    }
    std::string line = mText.substr(mStart, end - mStart);
    mStart = end + 1;
    mSearched = mStart;
    return line;
}

} // namespace zebhost
