#include "foundation/zebcore/Trace.h"

#include "foundation/zebcore/Threads.h"

#include <cstdio>
#include <mutex>
#include <string>
#include <utility>

namespace zebcore::debug
{

namespace
{

enum class Setting
{
    kFollowsAll,
    kOff,
    kOn,
};

/// One category that was ever switched. Nodes are only added, never freed, so that trace points read the list without
/// a lock.
struct Category
{
    std::string mName;
    std::atomic<Setting> mSetting{Setting::kFollowsAll};
    Category* mNext = nullptr;
};

constinit std::mutex sEditMutex;
constinit std::atomic<Category*> sCategories{nullptr};
constinit std::atomic<bool> sAllEnabled{false};
constinit std::atomic<std::uint32_t> sChangeCount{0};

Category* FindCategory(std::string_view name)
{
    // Acquire: the node that the head leads to is complete.
    Category* category = sCategories.load(std::memory_order_acquire);
    while (category != nullptr && category->mName != name)
        category = category->mNext;
    return category;
}

Category& FindOrAddCategory(std::string_view name)
{
    if (Category* known = FindCategory(name))
        return *known;
    auto* added = new Category;
    added->mName = name;
    added->mNext = sCategories.load(std::memory_order_relaxed);
    sCategories.store(added, std::memory_order_release);
    return *added;
}

void AnnounceChange()
{
    // Release: a trace point that sees the new count also sees the configuration behind it.
    sChangeCount.fetch_add(1, std::memory_order_release);
}

void WriteToStandardError(std::string_view text)
{
    std::fwrite(text.data(), 1, text.size(), stderr);
}

class Output
{
public:
    void SetSink(TraceSink sink)
    {
        const std::lock_guard lock(mMutex);
        mSink = std::move(sink);
    }

    void Write(std::string_view text)
    {
        const std::lock_guard lock(mMutex);
        // A copy, since the sink may replace itself.
        const TraceSink sink = mSink;
        if (sink)
            sink(text);
        else
            WriteToStandardError(text);
    }

private:
    std::recursive_mutex mMutex;
    TraceSink mSink;
};

// Never destroyed: destructors of other statics trace.
Output& TraceOutput()
{
    static Output& output = *new Output;
    return output;
}

Output& DebugOutput()
{
    static Output& output = *new Output;
    return output;
}

} // namespace

void SetTraceCategoryEnabled(std::string_view category, bool enabled)
{
    const std::lock_guard lock(sEditMutex);
    FindOrAddCategory(category).mSetting.store(enabled ? Setting::kOn : Setting::kOff, std::memory_order_relaxed);
    AnnounceChange();
}

void SetAllTraceEnabled(bool enabled)
{
    const std::lock_guard lock(sEditMutex);
    for (Category* category = sCategories.load(std::memory_order_relaxed); category != nullptr;
         category = category->mNext)
        category->mSetting.store(Setting::kFollowsAll, std::memory_order_relaxed);
    sAllEnabled.store(enabled, std::memory_order_relaxed);
    AnnounceChange();
}

void SetTraceSink(TraceSink sink)
{
    TraceOutput().SetSink(std::move(sink));
}

void SetDebugTraceSink(TraceSink sink)
{
    DebugOutput().SetSink(std::move(sink));
}

std::uint32_t TraceChangeCount() noexcept
{
    // Acquire, for AnnounceChange. It costs what a relaxed read costs on the machines we run on.
    return sChangeCount.load(std::memory_order_acquire);
}

bool TraceEnabled(const unsigned char* category, int level, bool /*mayWait*/) noexcept
{
    if (level > kTraceLevel)
        return false;
    const Category* known = FindCategory(reinterpret_cast<const char*>(category));
    const Setting setting = known == nullptr ? Setting::kFollowsAll : known->mSetting.load(std::memory_order_relaxed);
    return setting == Setting::kFollowsAll ? sAllEnabled.load(std::memory_order_relaxed) : setting == Setting::kOn;
}

void Trace(const unsigned char* line)
{
    TraceOutput().Write(reinterpret_cast<const char*>(line));
}

void DebugTrace(const unsigned char* text)
{
    DebugOutput().Write(reinterpret_cast<const char*>(text));
}

void WriteTraceLine(const char* category, const UTF8String& message)
{
    // Names of plug-ins come padded with zero units, which would end the line before its time.
    UTF8String text = message;
    std::erase(text, u8'\0');

    utility::oUTF8StringStream line;
    line << '<' << threads::GetCurrentThreadID() << "> <" << category << "> <" << kTraceLevel << "> " << text << '\n';
    Trace(reinterpret_cast<const unsigned char*>(line.str().c_str()));
}

} // namespace zebcore::debug
