#pragma once

#include "AudioToolbox/AudioUnitUtilities.h"

#include <atomic>
#include <cstddef>
#include <functional>
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
    ~ListenerTable();
    ListenerTable(const ListenerTable&) = delete;
    ListenerTable& operator=(const ListenerTable&) = delete;

    /// [any but process]
    void Append(AUListenerBase* listener, const Interest& interest);
    /// Nobody tells the listener of what is taken out from the return on. [any but process]
    void Remove(const std::function<bool(const Row&)>& isOut);

    /// Calls `visit` for each row, which must neither block nor change the table. Neither allocates nor locks. [any]
    template <typename Visit>
    void ForEach(const Visit& visit) const
    {
        const Reading reading(mReaders); // also until a unit that is asked for its value throws
        const Rows& rows = *mRows.load(std::memory_order_seq_cst);
        const std::size_t count = rows.mCount.load(std::memory_order_acquire); // with what Append wrote before it
        for (std::size_t index = 0; index < count; ++index)
            visit(rows.mRows[index]);
    }

private:
    // In one order with the exchange and the look at the readers in Replace: either this reader is seen there, or it
    // sees the new array. An acquire-release pair could miss both.
    class Reading
    {
    public:
        explicit Reading(std::atomic<int>& readers) : mReaders(readers)
        {
            mReaders.fetch_add(1, std::memory_order_seq_cst);
        }
        ~Reading() { mReaders.fetch_sub(1, std::memory_order_release); }
        Reading(const Reading&) = delete;
        Reading& operator=(const Reading&) = delete;

    private:
        std::atomic<int>& mReaders;
    };

    struct Rows
    {
        explicit Rows(std::size_t capacity) : mRows(capacity) {}

        std::vector<Row> mRows; // of a fixed size
        std::atomic<std::size_t> mCount = 0;
    };

    void Replace(std::size_t capacity, const std::function<bool(const Row&)>& isOut);

    mutable std::atomic<int> mReaders = 0;
    std::atomic<Rows*> mRows;
    std::mutex mChanging; // one at a time
};

} // namespace zebaudiofilterhost::xau
