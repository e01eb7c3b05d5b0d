#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringStreams.h"
#include "foundation/zebcore/StringTypes.h"

#include <boost/function.hpp>

#include <atomic>
#include <cstdint>
#include <string_view>

namespace zebcore::debug
{

/// Level of all trace points of the library.
inline constexpr int kTraceLevel = 6;

/// Takes UTF-8 text. Called from whatever thread traces, one call at a time.
using TraceSink = boost::function<void(std::string_view)>;

// What an application sets. At the start no category traces.

/// Switches one category, until the next SetAllTraceEnabled. [any but process]
ZEB_EXPORT void SetTraceCategoryEnabled(std::string_view category, bool enabled);
/// Switches every category, also those switched one by one before. [any but process]
ZEB_EXPORT void SetAllTraceEnabled(bool enabled);
/// Where trace lines go, each with its line feed. An empty function restores stderr. [any but process]
ZEB_EXPORT void SetTraceSink(TraceSink sink);
/// Where DebugTrace's text goes. An empty function restores stderr. [any but process]
ZEB_EXPORT void SetDebugTraceSink(TraceSink sink);

// What a trace point uses.

/// Changes with each change of the trace configuration. One atomic read. [any]
ZEB_EXPORT std::uint32_t TraceChangeCount() noexcept;
/// Whether this category traces at this level. mayWait is false at the trace points of the process path; the answer
/// needs neither lock nor allocation in either case. [any]
ZEB_EXPORT bool TraceEnabled(const unsigned char* category, int level, bool mayWait) noexcept;
/// Writes one line, as it stands. [any]
ZEB_EXPORT void Trace(const unsigned char* line);
/// Writes text to the debug output, as it stands. [any]
ZEB_EXPORT void DebugTrace(const unsigned char* text);

/// The two words that a trace point keeps. They need no order between them: racing threads lose at most one update of
/// the flag, which then stays as it was until the configuration changes again.
struct TracePoint
{
    std::atomic<bool> mEnabled{false};
    std::atomic<std::uint32_t> mTraceChangeCount{0};
};

/// One counter read, until somebody changes the configuration. [any]
inline bool IsTracePointEnabled(TracePoint& point, const char* category, bool mayWait) noexcept
{
    const std::uint32_t count = TraceChangeCount();
    if (point.mTraceChangeCount.load(std::memory_order_relaxed) != count)
    {
        point.mEnabled.store(TraceEnabled(reinterpret_cast<const unsigned char*>(category), kTraceLevel, mayWait),
                             std::memory_order_relaxed);
        point.mTraceChangeCount.store(count, std::memory_order_relaxed);
    }
    return point.mEnabled.load(std::memory_order_relaxed);
}

/// Writes "<thread ID> <category> <6> message" and a line feed. [any]
ZEB_EXPORT void WriteTraceLine(const char* category, const UTF8String& message);

} // namespace zebcore::debug

#define ZEB_TRACE_POINT_(category, mayWait, ...)                                                                     \
    do                                                                                                               \
    {                                                                                                                \
        static constinit ::zebcore::debug::TracePoint sTracePoint;                                                   \
        if (::zebcore::debug::IsTracePointEnabled(sTracePoint, category, mayWait)) [[unlikely]]                      \
        {                                                                                                            \
            ::zebcore::utility::oUTF8StringStream traceMessage_;                                                     \
            traceMessage_ << __VA_ARGS__;                                                                            \
            ::zebcore::debug::WriteTraceLine(category, traceMessage_.str());                                         \
        }                                                                                                            \
    } while (false)

/// A trace point: ZEB_TRACE("VST3", "Path:" << path). The message is not evaluated unless its category traces. The
/// category is a string literal.
#define ZEB_TRACE(category, ...) ZEB_TRACE_POINT_(category, true, __VA_ARGS__)
/// The same for the two sites on the process path.
#define ZEB_TRACE_REALTIME(category, ...) ZEB_TRACE_POINT_(category, false, __VA_ARGS__)
