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
        for (const char16_t unit : value)
            mText.append({static_cast<char>(unit >> 8U), static_cast<char>(unit & 255U)});
    }

    void VisitValue(const UTF8String& key, const UTF8String& value) override
    {
        Begin('c', key, value.size());
        mText.append(value.begin(), value.end());
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
            mText += std::to_string(std::bit_cast<std::uint32_t>(number)) + ' ';
    }

    void VisitSubList(const UTF8String& key, const PropList& subList) override
    {
        Begin('l', key, 0);
        subList.Visit(*this);
        mText += '}';
    }

    std::string mText;

private:
    // Lengths come first, so that no content can pass for the end of its entry or list.
    void Begin(char type, const UTF8String& key, std::size_t number)
    {
        mText += type + std::to_string(key.size()) + ':';
        mText.append(key.begin(), key.end());
        mText += std::to_string(number) + '=';
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
