#include "audio/OutputFile.h"
#include "catalogue/PresetStore.h"
#include "cli/Failure.h"
#include "commands/Commands.h"
#include "commands/FilterCommand.h"
#include "commands/FilterJson.h"
#include "commands/ParameterListing.h"
#include "editor/EditorSession.h"
#include "filter/ParameterSetup.h"
#include "filter/Parameters.h"
#include "filter/ValueFinder.h"
#include "output/Strings.h"

#include <algorithm>
#include <optional>
#include <utility>

#include <unistd.h>

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;

namespace
{

std::vector<float> ValuesOf(const AudioFilter& filter)
{
    std::vector<float> values;
    for (int index = 0; index < filter.GetParameterCount(); ++index)
    {
        values.push_back(filter.GetParameter(index));
    }
    return values;
}

std::string Changes(AudioFilter& filter, const std::vector<float>& before)
{
    std::vector<std::string> changes;
    for (int index = 0; index < std::min(filter.GetParameterCount(), static_cast<int>(before.size())); ++index)
    {
        const auto info = filter.GetParameterInfo(index);
        if (info != nullptr && filter.GetParameter(index) != before[static_cast<std::size_t>(index)])
        {
            changes.push_back(ParameterName(filter, index) + " to " +
                              ValueFinder(filter, index, *info).Shown(filter.GetParameter(index)));
        }
    }
    return Joined(changes, ", ");
}

void WritePicture(OutputFile& file, const Picture& picture)
{
    const std::string bytes = ToPng(picture);
    std::size_t written = 0;
    while (written < bytes.size())
    {
        const ssize_t count = write(file.Descriptor(), bytes.data() + written, bytes.size() - written);
        if (count <= 0)
        {
            throw Failure(ExitCode::FileTrouble,
                          file.Path() + " could not be written to the end: make room on the disk");
        }
        written += static_cast<std::size_t>(count);
    }
    file.Commit();
}

void SavePicture(const CommandContext& context, const FilterOfCommand& filter, const Picture& picture,
                 OutputFile& file)
{
    if (picture.pixels.empty())
    {
        throw Failure(ExitCode::JobFailed, file.Path() + " was not written: nothing can be seen of the window of " +
                                               filter.Name() + "; move it onto the screen");
    }
    WritePicture(file, picture);
    context.console.Remark("zebhost: saved " + file.Path());
}

} // namespace

ExitCode RunEdit(CommandContext& context)
{
    const Arguments& arguments = context.arguments;
    const auto milliseconds = static_cast<unsigned int>(1000 * arguments.Number("seconds", 0, 0.001, 1000000));
    const FilterOfCommand filter(context);
    ApplyParameterOptions(context, *filter);
    std::optional<OutputFile> pictureFile;
    if (arguments.Has("screenshot"))
    {
        pictureFile.emplace(arguments.Text("screenshot"), arguments.Has("overwrite"));
    }
    const std::vector<float> before = ValuesOf(*filter);
    const EditorOutcome outcome = RunEditor(*filter, filter.Name(), milliseconds, pictureFile.has_value());
    if (!outcome.trouble.empty())
    {
        context.console.Warn("zebhost: " + filter.Name() + " threw an exception while its editor was open, \"" +
                             outcome.trouble + "\": what it showed may be wrong; ask its maker");
    }
    Settle(kDefaultSettleMs);
    const std::string changes = Changes(*filter, before);
    context.console.Remark("zebhost: " + (changes.empty() ? "nothing was changed" : "set " + changes));
    if (pictureFile)
    {
        SavePicture(context, filter, outcome.picture, *pictureFile);
    }
    if (arguments.Has("save"))
    {
        PresetStore store(context.catalogue.Folder().Presets());
        context.console.Remark("zebhost: saved " +
                               store.Save(*filter, arguments.Text("save"), arguments.Has("overwrite")).string());
    }
    if (context.WantsJson())
    {
        Json document = context.NewDocument();
        document["filter"] = DescriptorJson(filter.Descriptor());
        PrintParameters(context, *filter, std::move(document), false);
    }
    return ExitCode::Done;
}

} // namespace zebhost
