#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace zebhost
{

// Cuts what comes in pieces into lines.
class LineBuffer
{
public:
    void Append(std::string_view piece) { mText += piece; }
    // Without its line end; none until it is complete.
    std::optional<std::string> Next();
    std::size_t Size() const { return mText.size() - mStart; }

private:
    std::string mText;
    std::size_t mStart = 0;    // of the first line not given out
    std::size_t mSearched = 0; // up to here there is no line end
};

} // namespace zebhost
