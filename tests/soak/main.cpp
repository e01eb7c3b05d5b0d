// Uses effects at random for a long time, as an application does, and tells whether anything was lost on the way:
// memory, descriptors, threads, or the sound.
#include "ControlFilter.h"
#include "Interrupt.h"
#include "Report.h"
#include "module/Module.h"

#include <cstdlib>
#include <exception>

#include <unistd.h>

namespace
{

// A folder that goes when this does.
class ScratchFolder
{
public:
    ScratchFolder()
        : mPath(std::filesystem::temp_directory_path() / ("zeb-soak-" + std::to_string(static_cast<int>(getpid()))))
    {
        std::filesystem::create_directories(mPath);
    }

    ~ScratchFolder()
    {
        std::error_code ignored;
        std::filesystem::remove_all(mPath, ignored);
    }

    ScratchFolder(const ScratchFolder&) = delete;
    ScratchFolder& operator=(const ScratchFolder&) = delete;

    const std::filesystem::path& Path() const { return mPath; }

private:
    std::filesystem::path mPath;
};

bool RunSoak(const soak::Options& options, const soak::Console& console)
{
    const ScratchFolder folder;
    const soak::Findings findings = soak::Soak(options, console, folder.Path()).Run();
    soak::SayFindings(console, findings);
    soak::WriteJson(options, findings);
    return findings.Passed();
}

} // namespace

int main(int argc, char** argv)
{
    const soak::Options options = soak::ReadOptions(argc, argv);
    const soak::Console console(options.log);
    soak::RegisterControlFilter();
    zebaudiofilterhost::Initialize();
    soak::interrupt::Watch();
    bool passed = false;
    try
    {
        passed = RunSoak(options, console);
    }
    catch (const std::exception& fault)
    {
        console.Say(std::string("soak: FAILED: ") + fault.what() + ", random start " +
                    std::to_string(options.randomStart));
    }
    zebaudiofilterhost::Terminate();
    // What plug-ins do while they are taken down says nothing more.
    std::_Exit(passed ? 0 : 1);
}
