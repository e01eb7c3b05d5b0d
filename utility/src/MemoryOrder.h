#pragma once

#include <atomic>

/// A build of the tests names one site here, which then works without its order: ThreadSanitizer has to notice.
#ifndef ZEB_WEAKEN
#define ZEB_WEAKEN kNone
#endif

namespace zebaudiofilterhost
{

/// The places of the rings, and of what they share, whose memory order holds something up. What is relaxed in the
/// code is not among them.
enum class OrderSite
{
    kNone,
    kMessagePushLooks,
    kMessagePushPublishes,
    kMessagePopLooks,
    kMessagePopGivesBack,
    kMessageSetState,
    kMessageGetState,
    kPublishedEnter,
    kPublishedLoad,
    kPublishedLeave,
    kPublishedPublish,
    kPublishedRetire,
    kPublishedTakeRetired,
    kPublishedAskReaders,
    kPublishedAwaitReaders,
    kPublishedDestroy,
    kDirtySetAdd,
    kDirtySetTake,
    kDirtySetRemove,
    kParameterPut,
    kParameterTake
};

/// `order`, unless this build weakens the site.
consteval std::memory_order OrderAt(OrderSite site, std::memory_order order)
{
    return site == OrderSite::ZEB_WEAKEN ? std::memory_order_relaxed : order;
}

} // namespace zebaudiofilterhost
