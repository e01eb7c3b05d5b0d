#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/File.h"

namespace zebcore::filesupport
{

/// Replaces a file as a whole or not at all. The content is written to the temporary file, which lies beside the
/// target and takes on its permissions; Commit flushes it to the disk and moves it over the target. Without Commit
/// the target stays as it was. A target that is a symbolic link stays one: the file that it leads to is replaced.
///
///     SafeSave save(file);
///     utility::FileUtils::SimpleWriteStringToFile(save.GetTempFile().FullPath(), text);
///     save.Commit();
///
/// All failures are a file_exception that leaves the target as it was and no temporary file behind, with one
/// exception: if only the flush of the folder fails, the new file is in its place, whole, but might not outlive a
/// power failure. [any]
class ZEB_EXPORT SafeSave
{
public:
    /// Makes the empty temporary file. Throws file_exception, among others if the target is there and no regular
    /// file.
    explicit SafeSave(File& target);

    SafeSave(const SafeSave&) = delete;
    SafeSave& operator=(const SafeSave&) = delete;

    /// Removes the temporary file if Commit has not moved it.
    ~SafeSave();

    File GetTempFile() const { return mTemp; }

    /// Throws file_delete_exception if the system refuses to give up the old file, file_exception on any other
    /// failure. A second call does nothing.
    void Commit();

private:
    void Flush() const;
    void Replace();
    void FlushFolder() const;
    void Discard() noexcept;

    File mTarget;   // with links resolved
    bool mReplaces; // whether there is an old file
    File mTemp;
    bool mDone = false;
};

} // namespace zebcore::filesupport
