#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <memory>
#include <mutex>
#include <utility>
#include <vector>

namespace zebaudiofilterhost::vst3
{

/// An object that threads use while another replaces it. Whoever uses it neither waits nor frees; a replaced object
/// goes at a later replacement, once nobody who can have seen it is still inside.
//
/// Users count themselves in and out of one of two counters, before they read the pointer. After the pointer was
/// exchanged, a counter that is seen at 0 has no user of the old object left, and later users find the new pointer:
/// the counters are only ever touched by read-modify-write operations, so that acquire and release order the two
/// sides. Each replacement turns new users to the other counter, so that both get to 0 in time however busy they are.
template <class T>
class SharedTable
{
public:
    /// The object as it is now, for the length of a scope. Never null.
    class Access
    {
    public:
        explicit Access(const SharedTable& owner)
            : mInside(owner.mInside[owner.mTurn.load(std::memory_order_relaxed)])
        {
            mInside.fetch_add(1, std::memory_order_acq_rel);
            mTable = owner.mCurrent.load(std::memory_order_acquire);
        }
        ~Access() { mInside.fetch_sub(1, std::memory_order_release); }

        Access(const Access&) = delete;
        Access& operator=(const Access&) = delete;

        T* operator->() const { return mTable; }
        T& operator*() const { return *mTable; }

    private:
        std::atomic<std::size_t>& mInside;
        T* mTable;
    };

    explicit SharedTable(std::unique_ptr<T> first) : mCurrent(first.release()) {}
    /// Nobody may be inside.
    ~SharedTable() { delete mCurrent.load(std::memory_order_acquire); }

    SharedTable(const SharedTable&) = delete;
    SharedTable& operator=(const SharedTable&) = delete;

    /// Several threads may do this; they take turns. Not for the process thread: locks, allocates and frees.
    void Publish(std::unique_ptr<T> next)
    {
        const std::lock_guard lock(mChange);
        mRetired.reserve(mRetired.size() + 1);
        mRetired.push_back({std::unique_ptr<T>(mCurrent.exchange(next.release(), std::memory_order_acq_rel)), {}});
        for (std::size_t turn = 0; turn < mInside.size(); ++turn)
            NoteWhoLeft(turn);
        std::erase_if(mRetired, [](const Retired& retired) { return retired.mLeft[0] && retired.mLeft[1]; });
        mTurn.store(1 - mTurn.load(std::memory_order_relaxed), std::memory_order_relaxed);
    }

private:
    struct Retired
    {
        std::unique_ptr<T> mTable;
        std::array<bool, 2> mLeft; // by counter: seen at 0 since the table was replaced
    };

    void NoteWhoLeft(std::size_t turn)
    {
        if (mInside[turn].fetch_add(0, std::memory_order_acq_rel) != 0)
            return;
        for (Retired& retired : mRetired)
            retired.mLeft[turn] = true;
    }

    std::atomic<T*> mCurrent;
    std::atomic<std::size_t> mTurn{0};
    mutable std::array<std::atomic<std::size_t>, 2> mInside{};
    std::mutex mChange; // guards mRetired, and the order of replacements
    std::vector<Retired> mRetired;
};

} // namespace zebaudiofilterhost::vst3
