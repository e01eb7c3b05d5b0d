#include "console/AudioFilterConsoleCommands.h"

#include "foundation/zebcore/CommandRegistry.h"
#include "foundation/zebcore/Tokenizer.h"
#include "module/ModuleSteps.h"
#include "utility/PrivatePluginUtils.h"

namespace zebaudiofilterhost::console
{

using zebcore::UTF16String;
using zebcore::console::CommandRegistrar;
using zebcore::console::CommandRegistry;

const UTF16String BuildPrivatePluginConfigCmd::kName = u"zebaudiofilterhost.BuildPrivatePluginConfig";
const UTF16String BuildPrivatePluginConfigCmd::kDescription =
    u"zebaudiofilterhost.BuildPrivatePluginConfig - Build the private plug-in configuration used by "
    u"zebaudiofilterhost.";

void BuildPrivatePluginConfigCmd::Execute(const UTF16String& arguments, zebcore::utility::UTF16OutputStream& output)
{
    zebcore::utility::Tokenizer<UTF16String> tokens(arguments, u",", false);
    const std::size_t count = tokens.NumTokens();
    if (arguments.empty() || (count != 2 && count != 3))
    {
        output << UTF16String(u"zebaudiofilterhost.BuildPrivatePluginConfig <path of result file>,<VST3 directory>,"
                              u"[VST2 directory]\n");
        output.flush();
        return;
    }
    const UTF16String resultPath = tokens.NextToken();
    const UTF16String vst3Directory = tokens.NextToken();
    const UTF16String vstDirectory = count == 3 ? tokens.NextToken() : UTF16String();
    utility::BuildPrivatePluginConfig(resultPath, vstDirectory, vst3Directory);
    output << UTF16String(u"Done.\n");
    output.flush();
}

namespace
{

void RegisterCommands()
{
    CommandRegistry::RegisterCommand(BuildPrivatePluginConfigCmd::kName, BuildPrivatePluginConfigCmd::kDescription,
                                     CommandRegistrar<BuildPrivatePluginConfigCmd>::CreateCommand);
}

void UnregisterCommands()
{
    CommandRegistry::UnregisterCommand(BuildPrivatePluginConfigCmd::kName);
}

const bool sRegistered =
    ModuleSteps::GetInstance().Add(ModuleStepOrder::kConsoleCommands, RegisterCommands, UnregisterCommands);

} // namespace

} // namespace zebaudiofilterhost::console
