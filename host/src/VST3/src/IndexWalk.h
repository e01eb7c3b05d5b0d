#pragma once

namespace zebaudiofilterhost::vst3
{

/// What was found at one index of a list that a plug-in keeps.
enum class IndexWalk
{
    kFound,
    kMissing, ///< the plug-in gave nothing here
    kStop     ///< the walk has what it wants
};

/// No list of a plug-in is longer; what lies beyond is not seen, since some plug-ins answer for any index.
inline constexpr int kMaxListLength = 32768;
/// So many indices in a row without anything show that the list has ended, whatever its count says.
inline constexpr int kMaxMissingInARow = 1024;

/// Visits the indices of a list from 0 while they are below `count()`, asked anew each time. Plug-ins lie about their
/// counts: the walk ends where the list does, too. Returns how many indices belong to the list.
template <class Count, class Visit>
int WalkList(Count count, Visit visit)
{
    int missing = 0;
    int index = 0;
    for (; index < kMaxListLength && index < count(); ++index)
    {
        const IndexWalk result = visit(index);
        if (result == IndexWalk::kStop)
            return index + 1;
        missing = result == IndexWalk::kFound ? 0 : missing + 1;
        if (missing == kMaxMissingInARow)
            return index + 1 - missing;
    }
    return index;
}

} // namespace zebaudiofilterhost::vst3
