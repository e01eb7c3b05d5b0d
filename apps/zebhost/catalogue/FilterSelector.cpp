#include "catalogue/FilterSelector.h"

#include "catalogue/DisplayName.h"
#include "catalogue/PluginFinder.h"
#include "catalogue/ScanSession.h"
#include "cli/Failure.h"
#include "cli/StartFolder.h"
#include "output/PrintableText.h"
#include "output/Strings.h"

#include <host/AudioFilterDescriptor.h>

#include <algorithm>
#include <array>
#include <cctype>
#include <iterator>
#include <optional>

namespace zebhost
{

using zebaudiofilterhost::AudioFilterDescriptorManager;
using zebaudiofilterhost::PluginLocator;

namespace
{

using Descriptors = std::vector<Catalogue::Descriptor>;

struct PathAndClass
{
    std::string path;
    std::string className;
};

bool LooksLikeID(const std::string& text)
{
    return text.size() > 2 && std::isdigit(static_cast<unsigned char>(text[0])) != 0 && text[1] == ':';
}

bool IsThere(const std::string& path)
{
    std::error_code error;
    return std::filesystem::exists(startfolder::Resolve(path), error);
}

// A '#' may also stand in the path itself, so the longest path that is there counts.
std::optional<PathAndClass> SplitPath(const std::string& text)
{
    if (IsBundlePath(text) || (text.find('/') != std::string::npos && IsThere(text)))
    {
        return PathAndClass{text, {}};
    }
    for (std::size_t at = text.rfind('#'); at != std::string::npos && at > 0; at = text.rfind('#', at - 1))
    {
        if (IsBundlePath(text.substr(0, at)))
        {
            return PathAndClass{text.substr(0, at), text.substr(at + 1)};
        }
    }
    if (text.find('/') != std::string::npos)
    {
        return PathAndClass{text, {}};
    }
    return std::nullopt;
}

std::string NameOf(const Catalogue::Descriptor& descriptor)
{
    return DisplayName(*descriptor);
}

std::vector<std::string> Candidates(const Descriptors& descriptors)
{
    constexpr std::size_t kMost = 12;
    std::vector<std::string> lines;
    for (std::size_t index = 0; index < std::min(descriptors.size(), kMost); ++index)
    {
        const Catalogue::Descriptor& each = descriptors[index];
        lines.push_back(NameOf(each) + "  [" + ToUTF8(each->GetUniqueID()) + "]  " + PlaceOf(each->GetLocator()));
    }
    if (descriptors.size() > kMost)
    {
        lines.push_back("and " + std::to_string(descriptors.size() - kMost) + " more");
    }
    return lines;
}

// From the strictest reading of a name to the most lenient; the first that fits anything decides.
Descriptors Fitting(const Descriptors& all, const std::string& wanted)
{
    using Reading = bool (*)(const std::string& name, const std::string& wanted);
    const std::array<Reading, 4> readings = {
        [](const std::string& name, const std::string& text) { return name == text; },
        [](const std::string& name, const std::string& text) { return EqualIgnoringCase(name, text); },
        [](const std::string& name, const std::string& text) { return StartsWithIgnoringCase(name, text); },
        [](const std::string& name, const std::string& text)
        {
            return ContainsIgnoringCase(name, text);
        }};
    for (const Reading reading : readings)
    {
        Descriptors fitting;
        std::copy_if(all.begin(), all.end(), std::back_inserter(fitting),
                     [&](const Catalogue::Descriptor& each) { return reading(NameOf(each), wanted); });
        if (!fitting.empty())
        {
            return fitting;
        }
    }
    return {};
}

class ProblemKeeper : public IScanObserver
{
public:
    void Stepping(const PluginLocator&, const std::string&, std::size_t, std::size_t) override {}
    void Finished(const PluginLocator&, const Outcome& outcome) override { mProblem = outcome.problem; }
    bool ShallStop() const override { return false; }

    std::string mProblem;
};

// Of a path that is named like a plug-in; the sentence goes on with what such names end in.
std::vector<PluginLocator> NamedPlugins(const std::string& path, const std::string& elseSay)
{
    if (!IsBundlePath(path))
    {
        throw Failure(ExitCode::NotFound, path + elseSay + kPluginNameEnds);
    }
    std::vector<PluginLocator> plugins = PluginsAt(path);
    if (plugins.empty())
    {
        throw Failure(ExitCode::NotFound, path + kHoldsNoUnit);
    }
    return plugins;
}

// Throws if that leaves none.
std::vector<PluginLocator> WithoutBlocked(const Catalogue& catalogue, const std::vector<PluginLocator>& plugins)
{
    std::vector<PluginLocator> usable;
    std::copy_if(plugins.begin(), plugins.end(), std::back_inserter(usable),
                 [&catalogue](const PluginLocator& locator) { return !catalogue.IsBlocked(locator); });
    if (usable.empty())
    {
        throw Failure(ExitCode::Blocked, catalogue.BlockedBecause(plugins.front()));
    }
    return usable;
}

} // namespace

FilterSelector::FilterSelector(const Catalogue& catalogue) : mCatalogue(catalogue)
{
}

Catalogue::Descriptor FilterSelector::Select(const std::string& text) const
{
    Catalogue::Descriptor found;
    if (LooksLikeID(text))
    {
        found = AudioFilterDescriptorManager::GetInstance().GetComponentDescriptorForID(FromUTF8(text));
        if (found == nullptr)
        {
            throw Failure(ExitCode::NotFound,
                          "no filter has the ID " + text + ": 'zebhost list --long' shows all IDs");
        }
    }
    else if (const std::optional<PluginLocator> called = FindCalled(text))
    {
        const bool isFile = called->GetTechnologyType() != zebaudiofilterhost::kTechnologyAudioUnit;
        found = isFile ? FindByPath(PathOf(*called), {}) : mCatalogue.EffectsOf(*called).front();
    }
    else if (const std::optional<PathAndClass> split = SplitPath(text))
    {
        found = FindByPath(split->path, split->className);
    }
    else
    {
        found = FindByName(text);
    }
    if (mCatalogue.IsBlocked(found->GetLocator()))
    {
        throw Failure(ExitCode::Blocked, mCatalogue.BlockedBecause(found->GetLocator()));
    }
    return found;
}

std::vector<PluginLocator> FilterSelector::SelectPlugins(const std::string& text) const
{
    if (const std::optional<PluginLocator> called = FindCalled(text))
    {
        return {*called};
    }
    if (!LooksLikeID(text) && (IsBundlePath(text) || text.find('/') != std::string::npos))
    {
        return NamedPlugins(text, " is not named like a plug-in: its name ends in ");
    }
    const auto byID = AudioFilterDescriptorManager::GetInstance().GetComponentDescriptorForID(FromUTF8(text));
    return {(byID != nullptr ? byID : FindByName(text))->GetLocator()};
}

std::optional<PluginLocator> FilterSelector::FindCalled(const std::string& text) const
{
    if (IsBundlePath(text) && IsThere(text))
    {
        return std::nullopt;
    }
    Descriptors fitting = mCatalogue.Effects();
    std::erase_if(fitting,
                  [&text](const Catalogue::Descriptor& each) { return !IsCalled(each->GetLocator(), text); });
    if (fitting.empty())
    {
        return std::nullopt;
    }
    const PluginLocator first = fitting.front()->GetLocator();
    if (std::any_of(fitting.begin(), fitting.end(),
                    [&first](const Catalogue::Descriptor& each) { return each->GetLocator() != first; }))
    {
        throw Failure(ExitCode::NotFound, text + " fits several plug-ins: give the path of one of the above",
                      Candidates(fitting));
    }
    return first;
}

Catalogue::Descriptor FilterSelector::FindByPath(const std::string& path, const std::string& className) const
{
    if (!IsThere(path))
    {
        throw Failure(ExitCode::NotFound, path + ": there is nothing at this path; check its spelling");
    }
    const std::vector<PluginLocator> usable =
        WithoutBlocked(mCatalogue, NamedPlugins(path, " is no plug-in: its name has to end in "));
    const bool areAllKnown =
        std::none_of(usable.begin(), usable.end(),
                     [this](const PluginLocator& locator) { return mCatalogue.EffectsOf(locator).empty(); });
    Descriptors fitting = Fitting(EffectsOf(usable), className);
    if (fitting.empty() || !areAllKnown)
    {
        Scan(usable);
        fitting = Fitting(EffectsOf(usable), className);
    }
    if (fitting.size() == 1)
    {
        return fitting.front();
    }
    const std::string what =
        fitting.empty() ? path + " has no effect named " + className + " (instruments are not in the catalogue)"
                        : path + " has several effects that fit";
    throw Failure(ExitCode::NotFound, what + ": give one of the above as '" + path + "#NAME'",
                  Candidates(fitting.empty() ? EffectsOf(usable) : fitting));
}

Descriptors FilterSelector::EffectsOf(const std::vector<PluginLocator>& locators) const
{
    Descriptors effects;
    for (const PluginLocator& locator : locators)
    {
        const Descriptors some = mCatalogue.EffectsOf(locator);
        effects.insert(effects.end(), some.begin(), some.end());
    }
    return effects;
}

// One unit of several that fails does not keep the others away.
void FilterSelector::Scan(const std::vector<PluginLocator>& locators) const
{
    std::optional<Failure> first;
    for (const PluginLocator& locator : locators)
    {
        try
        {
            ScanOne(locator);
        }
        catch (const Failure& failure)
        {
            first = first ? first : failure;
        }
    }
    if (first && EffectsOf(locators).empty())
    {
        throw Failure(*first);
    }
}

void FilterSelector::ScanOne(const PluginLocator& locator) const
{
    ProblemKeeper observer;
    ScanSession(nullptr, observer, {}).Run({locator});
    if (!observer.mProblem.empty())
    {
        throw Failure(ExitCode::NotLoaded, observer.mProblem);
    }
    if (mCatalogue.EffectsOf(locator).empty())
    {
        throw Failure(ExitCode::NotFound, PlaceOf(locator) +
                                              " holds no effect: instruments are not in the catalogue, "
                                              "and classes that do not start up are left out");
    }
}

Catalogue::Descriptor FilterSelector::FindByName(const std::string& name) const
{
    const Descriptors all = mCatalogue.Effects();
    if (all.empty())
    {
        throw Failure(ExitCode::NotFound,
                      "there is no filter named " + name +
                          ", for the catalogue is empty: run 'zebhost scan', or give a plug-in's path");
    }
    const Descriptors fitting = Fitting(all, name);
    if (fitting.size() == 1)
    {
        return fitting.front();
    }
    if (fitting.empty())
    {
        throw Failure(ExitCode::NotFound, "no filter is named " + name +
                                              ": 'zebhost list' shows all names, 'zebhost scan' looks for new ones");
    }
    throw Failure(ExitCode::NotFound,
                  name + " fits " + std::to_string(fitting.size()) + " filters: give the ID of one of the above",
                  Candidates(fitting));
}

} // namespace zebhost
