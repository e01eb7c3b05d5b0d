#pragma once

#include "utility/src/MemoryOrder.h"

#include <atomic>
#include <memory>
#include <thread>
#include <utility>

namespace zebaudiofilterhost
{

/// A value that any thread may replace as a whole while any other reads it, the process thread included.
///
/// Reading takes no lock, waits for nobody and frees nothing. A replaced value is kept until FreeRetired finds a
/// moment without a reader.
template <typename T>
class Published
{
    struct Node
    {
        T value;
        Node* next;
    };

public:
    /// Keeps the value that was current at its construction alive and unchanged while it exists. [any]
    class Reader
    {
    public:
        explicit Reader(const Published& published) : mReaders(published.mReaders)
        {
            // Both in the one total order: whoever finds no reader after unlinking a value knows that all later ones
            // load a newer pointer.
            mReaders.fetch_add(1, OrderAt(OrderSite::kPublishedEnter, std::memory_order_seq_cst));
            mValue = &published.mCurrent.load(OrderAt(OrderSite::kPublishedLoad, std::memory_order_seq_cst))->value;
        }
        ~Reader()
        {
            // Release: what was read here comes before what is done by whoever finds no reader.
            mReaders.fetch_sub(1, OrderAt(OrderSite::kPublishedLeave, std::memory_order_release));
        }
        Reader(const Reader&) = delete;
        Reader& operator=(const Reader&) = delete;

        const T& operator*() const { return *mValue; }
        const T* operator->() const { return mValue; }

    private:
        std::atomic<unsigned int>& mReaders;
        const T* mValue;
    };

    Published() : mCurrent(new Node{T(), nullptr}) {}
    ~Published()
    {
        // Acquire: whoever made a value current has retired another after that.
        Free(mRetired.load(OrderAt(OrderSite::kPublishedDestroy, std::memory_order_acquire)));
        Free(mCurrent.load(std::memory_order_relaxed));
    }
    Published(const Published&) = delete;
    Published& operator=(const Published&) = delete;

    /// Makes `value` the current one. Allocates. [any]
    void Publish(T value)
    {
        auto* node = new Node{std::move(value), nullptr};
        Retire(mCurrent.exchange(node, OrderAt(OrderSite::kPublishedPublish, std::memory_order_seq_cst)));
    }

    /// Destroys what was replaced, unless somebody reads just now: then a later call does. [any but process]
    void FreeRetired()
    {
        // Acquire: these values were unlinked before the readers are counted.
        Node* retired =
            mRetired.exchange(nullptr, OrderAt(OrderSite::kPublishedTakeRetired, std::memory_order_acquire));
        if (mReaders.load(OrderAt(OrderSite::kPublishedAskReaders, std::memory_order_seq_cst)) == 0)
            Free(retired);
        else
            RetireAll(retired);
    }

    /// Returns when nobody reads any more what was replaced before the call. A reader that waits for the caller
    /// meanwhile never lets it return. [any but process]
    void AwaitReaders() const
    {
        while (mReaders.load(OrderAt(OrderSite::kPublishedAwaitReaders, std::memory_order_seq_cst)) != 0)
            std::this_thread::yield();
    }

private:
    void Retire(Node* node)
    {
        node->next = mRetired.load(std::memory_order_relaxed);
        // Release: with the value and with what was unlinked. Nobody looks into the next one here.
        while (!mRetired.compare_exchange_weak(node->next, node,
                                               OrderAt(OrderSite::kPublishedRetire, std::memory_order_release),
                                               std::memory_order_relaxed))
        {
        }
    }

    void RetireAll(Node* node)
    {
        while (node != nullptr)
            Retire(std::exchange(node, node->next));
    }

    static void Free(Node* node)
    {
        while (node != nullptr)
            std::unique_ptr<Node>(std::exchange(node, node->next));
    }

    std::atomic<Node*> mCurrent;
    std::atomic<Node*> mRetired = nullptr;
    mutable std::atomic<unsigned int> mReaders = 0;
};

} // namespace zebaudiofilterhost
