// Property lists of any content: whatever is put in comes out of the text again, bit for bit.
#include "foundation/zebcore/PropListUtils.h"
#include "fuzz/support/ByteSource.h"
#include "fuzz/support/ListText.h"
#include "fuzz/support/Target.h"

#include <list>
#include <string>

namespace
{

using namespace zebfuzz;
using namespace zebcore::proplist;

std::list<float> TakeFloats(ByteSource& source)
{
    std::list<float> floats;
    for (int left = source.Take<std::uint8_t>() % 8; left > 0; --left)
        floats.push_back(source.Take<float>());
    return floats;
}

void SetEntry(PropList& list, ByteSource& source, unsigned int kind, const zebcore::UTF8String& key)
{
    switch (kind)
    {
    case 0:
        return list.SetValue(key, source.TakeText<zebcore::UTF16String>());
    case 1:
        return list.SetValue(key, source.TakeText<zebcore::UTF8String>());
    case 2:
        return list.SetValue(key, source.Take<std::uint8_t>() % 2 == 1);
    case 3:
        return list.SetValue(key, source.Take<unsigned int>());
    case 4:
        return list.SetValue(key, source.Take<int>());
    case 5:
        return list.SetValue(key, source.Take<float>());
    case 6:
        return list.SetValue(key, TakeFloats(source));
    default:
        return list.RemoveValue(key);
    }
}

void Fill(PropList& list, ByteSource& source, unsigned int depth)
{
    constexpr unsigned int kKinds = 10;
    constexpr unsigned int kSubList = 8;
    while (!source.IsEmpty())
    {
        const unsigned int kind = source.Take<std::uint8_t>() % kKinds;
        if (kind > kSubList)
            return;
        const zebcore::UTF8String key = source.TakeText<zebcore::UTF8String>();
        if (kind < kSubList)
            SetEntry(list, source, kind, key);
        else if (depth < utils::kMaxListDepth)
            Fill(list.GetOrCreateSubList(key), source, depth + 1);
    }
}

void Run(Bytes bytes)
{
    PropList list;
    ByteSource source(bytes);
    Fill(list, source, 0);
    const std::string content = ListText(list);
    zebcore::UTF8String written;
    utils::WritePropList(written, list);
    PropList again;
    Expect(utils::ReadPropList(written, again), "any list can be written and read");
    Expect(ListText(again) == content, "a list comes back bit for bit");
    Expect(ListText(PropList(list)) == content, "a copy is equal");
}

const Target kTarget("property_values", Run);

} // namespace
