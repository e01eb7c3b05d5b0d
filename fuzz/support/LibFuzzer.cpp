// What libFuzzer calls.
#include "fuzz/support/Target.h"

#include <cstddef>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    zebfuzz::Target::All().front()->Run({data, size});
    return 0;
}
