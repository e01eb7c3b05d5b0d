#pragma once

#include "host/src/XAU/linux/src/ListenerRow.h"
#include "utility/src/Published.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <span>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// Who listens to one unit, by what is listened to. Those that tell read cells of which only the row ever changes, to
/// none when it is taken out. More cells are appended behind the ones that they see; what is full is replaced by a
/// larger array, and kept until nobody reads it any more.
class ListenerTable
{
public:
    ListenerTable();

    /// [any but process]
    void Append(ListenerRow& row);
    /// Nobody tells a listener of these rows from the return on. Those that are not there are nothing.
    /// [any but process]
    void Remove(std::span<ListenerRow* const> rows);
    /// Before the unit goes: takes all rows out and lets their listeners know, which may be disposed of later.
    /// [any but process]
    void Close();
    /// The unit goes, or has gone. [any]
    bool IsClosed() const { return mIsClosed.load(std::memory_order_seq_cst); }
    /// Close is done with the rows, and so is everybody who found them before: they may be freed. [any]
    bool IsEmptied() const { return mIsEmptied.load(std::memory_order_acquire); }

    /// Calls `call` unless the unit has gone; it does not go before the return. Must not close the table. [any]
    template <typename Call>
    void WhileOpen(const Call& call) const
    {
        const Published<CellsPtr>::Reader reader(mCells); // before the question, for Close asks for readers after it
        if (!IsClosed())
            call();
    }

    /// Calls `visit` for each row, which must neither block nor change the table. Neither allocates nor locks. [any]
    template <typename Visit>
    void ForEach(const Visit& visit) const
    {
        const Published<CellsPtr>::Reader reader(mCells);
        const Cells& cells = **reader;
        const std::size_t count = cells.mCount.load(std::memory_order_acquire); // with what Append wrote before it
        for (std::size_t index = 0; index < count; ++index)
            VisitCell(cells.mCells[index], visit);
    }

    /// The same for the rows of one event, without a look at the others. Both visit in the order of registration.
    template <typename Visit>
    void ForEach(const AudioUnitEvent& event, const Visit& visit) const
    {
        const Published<CellsPtr>::Reader reader(mCells);
        const Cells& cells = **reader;
        const auto visitSame = [&](ListenerRow& row)
        {
            if (IsSameEvent(row.mEvent, event))
                visit(row);
        };
        // Each cell was written before the place that leads to it.
        std::uint32_t place = cells.mBuckets[cells.BucketOf(event)].mFirst.load(std::memory_order_acquire);
        for (; place != kNoPlace; place = cells.mCells[place - 1].mNext.load(std::memory_order_acquire))
            VisitCell(cells.mCells[place - 1], visitSame);
    }

private:
    static constexpr std::uint32_t kNoPlace = 0; // places count from 1

    struct Cell
    {
        std::atomic<ListenerRow*> mRow = nullptr;
        std::atomic<std::uint32_t> mNext = kNoPlace; // of the same bucket
    };

    struct Bucket
    {
        std::atomic<std::uint32_t> mFirst = kNoPlace;
        std::uint32_t mLast = kNoPlace; // of whoever appends
    };

    struct Cells
    {
        explicit Cells(std::size_t capacity); // a power of two
        std::size_t BucketOf(const AudioUnitEvent& event) const;
        void Append(ListenerRow& row);
        void Remove(const ListenerRow& row);

        std::vector<Cell> mCells; // of a fixed size
        std::vector<Bucket> mBuckets;
        std::atomic<std::size_t> mCount = 0;
    };

    using CellsPtr = std::shared_ptr<Cells>;

    template <typename Visit>
    static void VisitCell(const Cell& cell, const Visit& visit)
    {
        if (ListenerRow* const row = cell.mRow.load(std::memory_order_seq_cst)) // after counting itself as a reader
            visit(*row);
    }

    /// Of whoever holds the lock: only that side replaces or changes.
    Cells& GetCells() const { return **Published<CellsPtr>::Reader(mCells); }
    void Replace();

    Published<CellsPtr> mCells;
    std::atomic<bool> mIsClosed = false;
    std::atomic<bool> mIsEmptied = false;
    std::mutex mChanging; // one at a time
};

} // namespace zebaudiofilterhost::xau
