#include "fuzz/support/ListText.h"

#include "foundation/zebcore/PropListVisitor.h"

#include <bit>
#include <cstdint>

namespace zebfuzz
{

namespace
{

using zebcore::UTF16String;
using zebcore::UTF8String;
using zebcore::proplist::PropList;

class Teller final : public zebcore::proplist::PropListVisitor
{
public:
    void VisitValue(const UTF8String& key, const UTF16String& value) override
    {
        Begin('w', key, value.size());
        Append(value.data(), value.size() * sizeof(char16_t));
    }

    void VisitValue(const UTF8String& key, const UTF8String& value) override
    {
        Begin('c', key, value.size());
        Append(value.data(), value.size());
    }

    void VisitValue(const UTF8String& key, bool value) override { Begin('b', key, value ? 1 : 0); }
    void VisitValue(const UTF8String& key, unsigned int value) override { Begin('u', key, value); }
    void VisitValue(const UTF8String& key, int value) override { Begin('i', key, static_cast<unsigned int>(value)); }
    void VisitValue(const UTF8String& key, float value) override
    {
        Begin('f', key, std::bit_cast<std::uint32_t>(value));
    }

    void VisitValue(const UTF8String& key, const std::list<float>& value) override
    {
        Begin('F', key, value.size());
        for (const float number : value)
            Append(&number, sizeof(number));
    }

    void VisitSubList(const UTF8String& key, const PropList& subList) override
    {
        Begin('l', key, 0);
        subList.Visit(*this);
        mText += '}';
    }

    std::string mText;

private:
    void Append(const void* bytes, std::size_t size) { mText.append(static_cast<const char*>(bytes), size); }

    // Lengths come first, so that no content can pass for the end of its entry or list.
    void Begin(char type, const UTF8String& key, std::size_t number)
    {
        const std::size_t numbers[] = {key.size(), number};
        mText += type;
        Append(numbers, sizeof(numbers));
        Append(key.data(), key.size());
    }
};

} // namespace

std::string ListText(const PropList& list)
{
    Teller teller;
    list.Visit(teller);
    return std::move(teller.mText);
}

} // namespace zebfuzz
