// Property lists as text: what is read can be written, and reads as the same.
#include "foundation/zebcore/PropListUtils.h"
#include "fuzz/support/ListText.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"

namespace
{

using namespace zebfuzz;
using namespace zebcore::proplist;

void Run(Bytes bytes)
{
    PropList list;
    list.SetValue(u8"stale", 1);
    if (!utils::ReadPropList(TextOf(bytes), list))
        return Expect(list.IsEmpty(), "a text that is refused leaves the list empty");
    zebcore::UTF8String written;
    utils::WritePropList(written, list);
    PropList again;
    Expect(utils::ReadPropList(written, again), "what is written can be read");
    Expect(ListText(list) == ListText(again), "what is written reads as the same");
    zebcore::UTF8String twice;
    utils::WritePropList(twice, again);
    Expect(written == twice, "a list has one text");
}

const Target kTarget("property_list", Run);

} // namespace
