#pragma once

#include "foundation/zebcore/PropListVisitor.h"

#include <cstddef>
#include <functional>
#include <string_view>

namespace zebcore::proplist
{

// Appends every entry that it is shown to a text, one element a line.
class PropListWriter final : public PropListVisitor
{
public:
    // Is shown the text between two elements whenever it has grown long, and the text is emptied then.
    using Drain = std::function<void(const UTF8String& text)>;

    // `depth` is that of the list which is visited: 0 for the outermost one. Without a drain the text only grows.
    PropListWriter(UTF8String& out, std::size_t depth, const Drain* drain = nullptr)
        : mOut(out), mDepth(depth), mDrain(drain)
    {
    }

    void WriteDocument(const PropList& list);

    void VisitValue(const UTF8String& key, const UTF16String& value) override;
    void VisitValue(const UTF8String& key, const UTF8String& value) override;
    void VisitValue(const UTF8String& key, bool value) override;
    void VisitValue(const UTF8String& key, unsigned int value) override;
    void VisitValue(const UTF8String& key, int value) override;
    void VisitValue(const UTF8String& key, float value) override;
    void VisitValue(const UTF8String& key, const std::list<float>& value) override;
    void VisitSubList(const UTF8String& key, const PropList& subList) override;

private:
    void Open(std::u8string_view element, const UTF8String& key);
    void Close(std::u8string_view element);
    void Indent();

    UTF8String& mOut;
    std::size_t mDepth;
    const Drain* mDrain; // may be null
};

} // namespace zebcore::proplist
