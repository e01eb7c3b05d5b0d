// Files that may be shared libraries: what they export is read from them before anything is loaded.
#include "fuzz/support/Target.h"
#include "host/src/VST/src/linux/ElfExports.h"

#include <sstream>
#include <string>

namespace
{

using namespace zebfuzz;
using zebaudiofilterhost::vst::ElfExports;
using zebaudiofilterhost::vst::ElfKind;

void Run(Bytes bytes)
{
    const std::string content(bytes.begin(), bytes.end());
    std::istringstream file(content);
    ElfExports exports(file);
    Expect(exports.GetKind() == ElfKind::kNoLibrary || content.starts_with("\177ELF"), "a library begins like one");
    for (const std::string name : {"VSTPluginMain", "main", "other_function", "needed", ""})
    {
        const bool has = exports.HasFunction(name);
        Expect(!has || exports.GetKind() == ElfKind::kLibrary, "nothing but a library has functions");
        Expect(!has || content.find(name + '\0') != std::string::npos, "a name that is found stands in the file");
        Expect(exports.HasFunction(name) == has, "asking twice tells the same");
    }
}

const Target kTarget("vst_exports", Run);

} // namespace
