#include "host/src/VST3/src/VST3VendorInterfaces.h"

namespace zebaudiofilterhost::vst3
{

DEF_CLASS_IID(IVST3CorvaneVendorSpecificComponent)
DEF_CLASS_IID(IVST3CorvaneVendorSpecificHost)
DEF_CLASS_IID(IVST3CorvaneVendorSpecificEffect)

} // namespace zebaudiofilterhost::vst3
