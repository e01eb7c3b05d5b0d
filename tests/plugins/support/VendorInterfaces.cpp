#include "tests/plugins/support/VendorInterfaces.h"

namespace fixture
{

const FUID VendorSpecificComponent::iid(0x872ee790, 0x61b243a2, 0x8dba33c1, 0xd9262d3e);
const FUID VendorSpecificHost::iid(0x7fcbcfce, 0x2862476a, 0xbff2219b, 0xca70789d);
const FUID VendorSpecificEffect::iid(0x3c8a2f25, 0x14114bf7, 0x851b13cb, 0x9c55ac92);

} // namespace fixture
