#include "host/src/PluginSearch.h"

#include "foundation/zebcore/NativePath.h"
#include "host/BannedPluginManager.h"

#include <filesystem>
#include <set>
#include <system_error>

namespace zebaudiofilterhost
{

namespace
{

class PluginSearch
{
public:
    PluginSearch(const std::vector<Dir>& places, const PluginSearchRules& rules)
        : mRules(rules), mStack(places.rbegin(), places.rend())
    {
    }

    std::vector<PluginLocator> Run()
    {
        while (!mStack.empty())
        {
            const Dir dir = mStack.back();
            mStack.pop_back();
            if (dir.Exists() && IsNew(dir))
                Search(dir);
        }
        return mLocators;
    }

private:
    // Directories are told apart by what they are and not by how they were reached: links can make a tree of few
    // directories endless, or of exponential size.
    bool IsNew(const Dir& dir)
    {
        std::error_code error;
        const auto real = std::filesystem::canonical(zebcore::filesupport::ToNativePath(dir.FullPath()), error);
        return !error && mSearched.insert(real.native()).second;
    }

    void Search(const Dir& dir)
    {
        const Dir::DirIterator end = dir.EndSubdirs();
        for (Dir::DirIterator subdir = dir.BeginSubdirs(false, nullptr, {}); subdir != end; ++subdir)
            Sort(*subdir);
        if (!mRules.mFindFiles)
            return;
        for (const UTF16String& path : mRules.mFindFiles(dir))
            Add(path);
    }

    void Sort(const Dir& subdir)
    {
        const UTF16String path = subdir.FullPath();
        if (IsNamedAsBundle(path, mRules))
            Add(path);
        else if (!mRules.mIsSearched || mRules.mIsSearched(path))
            mStack.push_back(subdir);
    }

    void Add(const UTF16String& path)
    {
        const PluginLocator locator(mRules.mType, path);
        if (!BannedPluginManager::GetInstance().IsPluginBanned(locator))
            mLocators.push_back(locator);
    }

    const PluginSearchRules& mRules;
    std::vector<Dir> mStack;
    std::set<std::filesystem::path::string_type> mSearched;
    std::vector<PluginLocator> mLocators;
};

} // namespace

bool IsNamedAsBundle(const UTF16String& path, const PluginSearchRules& rules)
{
    return path.ends_with(rules.mBundleExtension) && (rules.mIsBundle == nullptr || rules.mIsBundle(path));
}

std::vector<PluginLocator> SearchForPlugins(const std::vector<Dir>& places, const PluginSearchRules& rules)
{
    return PluginSearch(places, rules).Run();
}

} // namespace zebaudiofilterhost
