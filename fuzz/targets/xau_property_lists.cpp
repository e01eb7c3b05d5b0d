// The property list in a preset of an Audio Unit, or in a bundle of one.
#include "fuzz/support/UnitList.h"

namespace
{

using namespace zebfuzz;

void Run(Bytes bytes)
{
    const CFOwner list = ParseUnitList(bytes);
    if (!list)
        return;
    const CFOwner printed = PrintUnitList(list.get());
    Expect(printed != nullptr, "what is read can be written");
    const CFOwner back = ParseUnitList(BytesOf(printed));
    Expect(back != nullptr, "what is written can be read");
    Expect(AreSameLists(back.get(), list.get()), "and reads as the same");
}

const Target kTarget("xau_property_lists", Run);

} // namespace
