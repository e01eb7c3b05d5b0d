#pragma once

#include "AudioToolbox/AudioUnitUtilities.h"
#include "utility/src/Published.h"

#include <atomic>
#include <cstddef>
#include <functional>
#include <memory>
#include <mutex>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// What a listener wants to hear.
struct Interest
{
    AudioUnitEvent mEvent;
    void* mObject;

    bool operator==(const Interest& other) const;
};

/// Whether both name the same change of the same thing.
bool IsSameEvent(const AudioUnitEvent& a, const AudioUnitEvent& b);

/// Who listens to one unit. Those that tell read rows that never change; more are appended behind the ones that they
/// see, and what is taken out is left out of another array, which is put in the place of the first when nobody reads
/// that any more.
class ListenerTable
{
public:
    struct Row
    {
        AUListenerBase* mListener = nullptr;
        Interest mInterest = {};
    };

    ListenerTable();

    /// [any but process]
    void Append(AUListenerBase* listener, const Interest& interest);
    /// Nobody tells the listener of what is taken out from the return on. [any but process]
    void Remove(const std::function<bool(const Row&)>& isOut);

    /// Calls `visit` for each row, which must neither block nor change the table. Neither allocates nor locks. [any]
    template <typename Visit>
    void ForEach(const Visit& visit) const
    {
        const Published<RowsPtr>::Reader reader(mRows); // also until a unit that is asked for its value throws
        const Rows& rows = **reader;
        const std::size_t count = rows.mCount.load(std::memory_order_acquire); // with what Append wrote before it
        for (std::size_t index = 0; index < count; ++index)
            visit(rows.mRows[index]);
    }

private:
    struct Rows
    {
        explicit Rows(std::size_t capacity) : mRows(capacity) {}

        std::vector<Row> mRows; // of a fixed size
        std::atomic<std::size_t> mCount = 0;
    };

    using RowsPtr = std::shared_ptr<Rows>;

    /// Of whoever holds the lock: only that side replaces or adds.
    Rows& GetRows() const { return **Published<RowsPtr>::Reader(mRows); }
    void Replace(std::size_t capacity, const std::function<bool(const Row&)>& isOut);

    Published<RowsPtr> mRows;
    std::mutex mChanging; // one at a time
};

} // namespace zebaudiofilterhost::xau
