#include "foundation/zebcore/Dir.h"

#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/internal/FileStatus.h"
#include "foundation/zebcore/internal/Paths.h"

#include <dirent.h>

#include <algorithm>
#include <string_view>

namespace zebcore::filesupport
{

namespace
{

using Names = std::vector<UTF16String>;
using Order = boost::function<bool(const UTF16String&, const UTF16String&)>;

// Whether a link in a directory leads back to that directory or to one that its path goes through.
class BackLinkTest
{
public:
    explicit BackLinkTest(const UTF16String& directory) : mDirectory(directory) {}

    bool operator()(const FileStatus& target)
    {
        if (mWay.empty())
            CollectWay();
        return std::any_of(mWay.begin(), mWay.end(),
                           [&target](const FileStatus& passed) { return passed.IsSameFile(target); });
    }

private:
    void CollectWay()
    {
        UTF16String path = mDirectory;
        mWay.push_back(GetFileStatus(path));
        for (UTF16String parent = ParentOf(path); !parent.empty() && parent != path; parent = ParentOf(path))
        {
            mWay.push_back(GetFileStatus(parent));
            path = parent;
        }
    }

    const UTF16String& mDirectory;
    std::vector<FileStatus> mWay;
};

bool IsSubdirectory(const UTF16String& path, unsigned char type, BackLinkTest& leadsBack)
{
    if (type != DT_LNK && type != DT_UNKNOWN)
        return type == DT_DIR;
    const FileStatus status = GetFileStatus(path);
    // Where the type is unknown it may be a link, too; a true sub-directory is never on its own way.
    return status.IsDirectory() && !leadsBack(status);
}

Names ReadSubdirNames(const UTF16String& directory)
{
    Names names;
    struct CloseDirectory
    {
        void operator()(DIR* open) const { closedir(open); }
    };
    const bool isName = !directory.empty() && directory.find(u'\0') == UTF16String::npos;
    const std::unique_ptr<DIR, CloseDirectory> open(isName ? opendir(ToNativePath(directory).c_str()) : nullptr);
    if (!open)
        return names;
    BackLinkTest leadsBack(directory);
    while (const dirent* const entry = readdir(open.get()))
    {
        const std::string_view native = entry->d_name;
        if (native == "." || native == "..")
            continue;
        UTF16String name = FromNativePath(native);
        if (IsSubdirectory(Join(directory, name), entry->d_type, leadsBack))
            names.push_back(std::move(name));
    }
    return names;
}

Names SortedSubdirNames(const UTF16String& directory, const Order* order)
{
    Names names = ReadSubdirNames(directory);
    std::sort(names.begin(), names.end());
    if (order != nullptr && !order->empty())
        std::stable_sort(names.begin(), names.end(), *order);
    return names;
}

} // namespace

Dir::DirIterator
Dir::BeginSubdirs(bool recursive, boost::function<bool()>* goOn,
                  boost::shared_ptr<boost::function<bool(const UTF16String&, const UTF16String&)>> order) const
{
    auto paths = std::make_shared<DirIterator::Paths>();
    // A stack, with the next directory on top.
    std::vector<UTF16String> waiting;
    const auto push = [&waiting, &order](const UTF16String& directory)
    {
        const Names names = SortedSubdirNames(directory, order.get());
        std::for_each(names.rbegin(), names.rend(),
                      [&](const UTF16String& name) { waiting.push_back(Join(directory, name)); });
    };
    push(mPath);
    while (!waiting.empty() && (goOn == nullptr || goOn->empty() || (*goOn)()))
    {
        paths->push_back(std::move(waiting.back()));
        waiting.pop_back();
        if (recursive)
            push(paths->back());
    }
    return DirIterator(std::move(paths));
}

Dir::DirIterator Dir::EndSubdirs() const
{
    return DirIterator(nullptr);
}

Dir::DirIterator::DirIterator(std::shared_ptr<const Paths> paths) : mPaths(std::move(paths))
{
}

Dir::DirIterator::~DirIterator() = default;

Dir Dir::DirIterator::operator*() const
{
    return IsAtEnd() ? Dir() : Dir((*mPaths)[mIndex]);
}

Dir::DirIterator& Dir::DirIterator::operator++()
{
    if (!IsAtEnd())
        ++mIndex;
    return *this;
}

bool Dir::DirIterator::operator!=(const DirIterator& other) const
{
    if (IsAtEnd() || other.IsAtEnd())
        return IsAtEnd() != other.IsAtEnd();
    return mPaths != other.mPaths || mIndex != other.mIndex;
}

bool Dir::DirIterator::IsAtEnd() const
{
    return !mPaths || mIndex >= mPaths->size();
}

} // namespace zebcore::filesupport
