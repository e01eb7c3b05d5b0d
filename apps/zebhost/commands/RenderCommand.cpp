#include "cli/Failure.h"
#include "commands/Commands.h"
#include "commands/FileRenderer.h"
#include "filter/Interrupt.h"
#include "filter/ProcessFailures.h"
#include "output/Strings.h"

#include <filesystem>
#include <set>

namespace zebhost
{

namespace fs = std::filesystem;

namespace
{

struct FilePair
{
    std::string input;
    std::string output;
};

std::vector<FilePair> PairsInFolder(const std::vector<std::string>& inputs, const fs::path& folder)
{
    std::error_code error;
    fs::create_directories(folder, error);
    if (!fs::is_directory(folder, error))
    {
        throw Failure(ExitCode::FileTrouble, folder.string() + " is no folder and cannot be made: name another");
    }
    std::vector<FilePair> pairs;
    std::set<fs::path> names;
    for (const std::string& input : inputs)
    {
        const fs::path output = folder / fs::path(input).filename();
        if (!names.insert(output).second)
        {
            throw Failure(ExitCode::Usage, "two inputs would both become " + output.string() + ": render them apart");
        }
        pairs.push_back({input, output.string()});
    }
    return pairs;
}

std::vector<FilePair> Pairs(const Arguments& arguments)
{
    const std::vector<std::string> files = arguments.All("FILE");
    if (arguments.Has("out-dir"))
    {
        return PairsInFolder(files, arguments.Text("out-dir"));
    }
    if (files.size() != 2)
    {
        throw Failure(ExitCode::Usage, files.size() < 2 ? "give an input and an output file, or inputs with --out-dir"
                                                        : "several inputs need --out-dir for their outputs");
    }
    return {{files[0], files[1]}};
}

} // namespace

ExitCode RunRender(CommandContext& context)
{
    const RenderOptions options(context.arguments);
    const std::vector<FilePair> pairs = Pairs(context.arguments);
    interrupt::Watch();
    Json document = context.NewDocument();
    document["files"] = Json::array();
    const ProcessFailures failures;
    for (std::size_t index = 0; index < pairs.size(); ++index)
    {
        const std::string number =
            pairs.size() == 1 ? "" : std::to_string(index + 1) + "/" + std::to_string(pairs.size()) + " ";
        FileRenderer renderer(context, options, number);
        document["files"].push_back(renderer.Render(pairs[index].input, pairs[index].output));
        document["filter"] = renderer.FilterDocument();
    }
    document["processFailed"] = !failures.First().empty();
    if (!failures.First().empty())
    {
        context.console.Warn("zebhost: " + document["filter"]["name"].get<std::string>() +
                             " could not process every block (" + failures.First() +
                             "): the output is silent where it gave nothing; its maker should know");
    }
    if (context.WantsJson())
    {
        context.Print(document);
    }
    return ExitCode::Done;
}

} // namespace zebhost
