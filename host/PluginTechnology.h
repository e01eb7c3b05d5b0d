#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "host/PluginLocator.h"
#include "host/PluginScanContext.h"
#include "host/TechnologyType.h"
#include "utility/CommonTypes.h"

#include <boost/function.hpp>
#include <boost/signals2/signal.hpp>
#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost
{

/// What the catalogue knows of one technology: a number, a list of directories and four functions, which the
/// technology supplies from a static initializer. Signal slots see the list's new value. All operations: [main]
class ZEB_EXPORT PluginTechnology : public virtual zebcore::utility::RefCountedObject
{
public:
    /// Finds the plug-ins below a directory, leaving out those that BannedPluginManager::IsPluginBanned names.
    using CollectFunction = boost::function<std::vector<PluginLocator>(const Dir&)>;
    /// Makes a new context, also when there is nothing to scan.
    using ScanContextFunction = boost::function<boost::intrusive_ptr<PluginScanContext>(const std::vector<Dir>&)>;
    using DefaultDirectoriesFunction = boost::function<std::vector<UTF16String>()>;
    /// Turns a locator's path into text for the user.
    using PathDisplayFunction = boost::function<UTF16String(const UTF16String&)>;

    using DirectoryIterator = std::vector<UTF16String>::const_iterator;
    using DirectoriesChangedSignal =
        boost::signals2::signal<void(boost::intrusive_ptr<PluginTechnology>, const std::vector<UTF16String>& added,
                                     const std::vector<UTF16String>& removed)>;

    /// The directory list starts empty. Without `hasDirectories` the technology looks in places of its own.
    PluginTechnology(TechnologyType type, CollectFunction collect, ScanContextFunction scanContext,
                     DefaultDirectoriesFunction defaultDirectories, PathDisplayFunction pathDisplay,
                     bool hasDirectories);
    ~PluginTechnology() override;

    PluginTechnology(const PluginTechnology&) = delete;
    PluginTechnology& operator=(const PluginTechnology&) = delete;

    TechnologyType GetType() const;
    /// Whether the technology works from the directory list below.
    bool HasDirectories() const;

    DirectoryIterator DirectoryBegin() const;
    DirectoryIterator DirectoryEnd() const;
    DirectoriesChangedSignal& GetDirectoriesChangedSignal();

    /// Appends those that are new, as plain text. The signal tells the whole of `directories`, known ones included,
    /// and is silent when none was new.
    void AddPluginDirectories(const std::vector<UTF16String>& directories);
    /// The signal tells the whole of `directories`, and is silent when none was there.
    void RemovePluginDirectories(const std::vector<UTF16String>& directories);
    void RemoveAllPluginDirectories();
    /// Always tells the present list as removed, even an empty one. The list then becomes the technology's standard
    /// directories, if it works from a list and has a function for them; otherwise it stays.
    void ResetDirectoriesToDefault();

    /// All plug-ins on disk; nested directories give a plug-in twice. Exceptions of the collect function pass
    /// through.
    std::vector<PluginLocator> CollectPlugins() const;
    /// An empty function throws boost::bad_function_call.
    boost::intrusive_ptr<PluginScanContext> CreateScanContext() const;
    /// The path itself when the technology has no function for it.
    UTF16String GetPathDisplayString(const UTF16String& path) const;

private:
    void EmitDirectoriesChanged(const std::vector<UTF16String>& added, const std::vector<UTF16String>& removed);

    TechnologyType mType;
    DirectoriesChangedSignal mDirectoriesChangedSignal;
    CollectFunction mCollect;
    ScanContextFunction mScanContext;
    DefaultDirectoriesFunction mDefaultDirectories;
    PathDisplayFunction mPathDisplay;
    bool mHasDirectories;
    std::vector<UTF16String> mDirectories;
};

} // namespace zebaudiofilterhost
