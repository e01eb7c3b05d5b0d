#pragma once

#include "foundation/zebcore/StringTypes.h"
#include "fuzz/support/Target.h"

#include <algorithm>
#include <cstring>

namespace zebfuzz
{

// Takes values off the front of an input. An input that has run out gives zeros and empty texts.
class ByteSource
{
public:
    explicit ByteSource(Bytes bytes) : mBytes(bytes) {}

    bool IsEmpty() const { return mBytes.empty(); }

    template <typename Number>
    Number Take()
    {
        Number number{};
        const Bytes taken = TakeBytes(sizeof(number));
        if (!taken.empty()) // What is empty may be at no address
            std::memcpy(&number, taken.data(), taken.size());
        return number;
    }

    Bytes TakeBytes(std::size_t count)
    {
        const Bytes taken = mBytes.first(std::min(count, mBytes.size()));
        mBytes = mBytes.subspan(taken.size());
        return taken;
    }

    // A text of up to 255 units, behind its length.
    template <typename String>
    String TakeText()
    {
        using Unit = typename String::value_type;
        const Bytes taken = TakeBytes(Take<std::uint8_t>() * sizeof(Unit));
        String text(taken.size() / sizeof(Unit), Unit());
        if (!text.empty())
            std::memcpy(text.data(), taken.data(), text.size() * sizeof(Unit));
        return text;
    }

private:
    Bytes mBytes;
};

} // namespace zebfuzz
