#include "host/PluginTechnology.h"

#include "foundation/zebcore/Dir.h"

#include <algorithm>
#include <utility>

namespace zebaudiofilterhost
{

PluginTechnology::PluginTechnology(TechnologyType type, CollectFunction collect, ScanContextFunction scanContext,
                                   DefaultDirectoriesFunction defaultDirectories, PathDisplayFunction pathDisplay,
                                   bool hasDirectories)
    : mType(type)
    , mCollect(std::move(collect))
    , mScanContext(std::move(scanContext))
    , mDefaultDirectories(std::move(defaultDirectories))
    , mPathDisplay(std::move(pathDisplay))
    , mHasDirectories(hasDirectories)
{
}

PluginTechnology::~PluginTechnology() = default;

TechnologyType PluginTechnology::GetType() const
{
    return mType;
}

bool PluginTechnology::HasDirectories() const
{
    return mHasDirectories;
}

PluginTechnology::DirectoryIterator PluginTechnology::DirectoryBegin() const
{
    return mDirectories.begin();
}

PluginTechnology::DirectoryIterator PluginTechnology::DirectoryEnd() const
{
    return mDirectories.end();
}

PluginTechnology::DirectoriesChangedSignal& PluginTechnology::GetDirectoriesChangedSignal()
{
    return mDirectoriesChangedSignal;
}

void PluginTechnology::AddPluginDirectories(const std::vector<UTF16String>& directories)
{
    std::vector<UTF16String> updated = mDirectories;
    for (const UTF16String& directory : directories)
    {
        // Looks at the list as it was: a new path that is given twice goes in twice.
        if (std::find(mDirectories.begin(), mDirectories.end(), directory) == mDirectories.end())
        {
            updated.push_back(directory);
        }
    }
    if (updated.size() > mDirectories.size())
    {
        mDirectories.swap(updated);
        EmitDirectoriesChanged(directories, {});
    }
}

void PluginTechnology::RemovePluginDirectories(const std::vector<UTF16String>& directories)
{
    std::vector<UTF16String> updated = mDirectories;
    for (const UTF16String& directory : directories)
    {
        const auto found = std::find(updated.begin(), updated.end(), directory);
        if (found != updated.end())
        {
            updated.erase(found);
        }
    }
    if (updated.size() != mDirectories.size())
    {
        mDirectories.swap(updated);
        EmitDirectoriesChanged({}, directories);
    }
}

void PluginTechnology::RemoveAllPluginDirectories()
{
    std::vector<UTF16String> removed;
    mDirectories.swap(removed);
    if (!removed.empty())
    {
        EmitDirectoriesChanged({}, removed);
    }
}

void PluginTechnology::ResetDirectoriesToDefault()
{
    // Copies: a slot may change the list.
    EmitDirectoriesChanged({}, std::vector<UTF16String>(mDirectories));
    if (mDefaultDirectories.empty() || !mHasDirectories)
    {
        return;
    }
    mDirectories = mDefaultDirectories();
    EmitDirectoriesChanged(std::vector<UTF16String>(mDirectories), {});
}

std::vector<PluginLocator> PluginTechnology::CollectPlugins() const
{
    if (mCollect.empty())
    {
        return {};
    }
    if (!mHasDirectories)
    {
        return mCollect(Dir(UTF16String()));
    }
    std::vector<PluginLocator> locators;
    for (const UTF16String& directory : mDirectories)
    {
        const std::vector<PluginLocator> found = mCollect(Dir(directory));
        locators.insert(locators.end(), found.begin(), found.end());
    }
    return locators;
}

boost::intrusive_ptr<PluginScanContext> PluginTechnology::CreateScanContext() const
{
    return mScanContext(std::vector<Dir>(mDirectories.begin(), mDirectories.end()));
}

UTF16String PluginTechnology::GetPathDisplayString(const UTF16String& path) const
{
    return mPathDisplay.empty() ? path : mPathDisplay(path);
}

void PluginTechnology::EmitDirectoriesChanged(const std::vector<UTF16String>& added,
                                              const std::vector<UTF16String>& removed)
{
    mDirectoriesChangedSignal(boost::intrusive_ptr<PluginTechnology>(this), added, removed);
}

} // namespace zebaudiofilterhost
