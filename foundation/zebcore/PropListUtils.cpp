#include "foundation/zebcore/PropListUtils.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/SafeSave.h"
#include "foundation/zebcore/Trace.h"
#include "foundation/zebcore/internal/ParseXml.h"
#include "foundation/zebcore/internal/PropListCopier.h"
#include "foundation/zebcore/internal/PropListReader.h"
#include "foundation/zebcore/internal/PropListWriter.h"

namespace zebcore::proplist::utils
{

namespace
{

// Replaces the content of `list`. Returns what is wrong with the text, and then leaves the list empty.
xml::XmlResult Read(const UTF8String& text, PropList& list)
{
    list.Clear();
    PropListReader reader(list);
    xml::XmlResult result = xml::ParseXml(text, reader);
    if (result.mCode != 0)
        list.Clear();
    return result;
}

bool IsBelow(const UTF16String& path, const UTF16String& folder)
{
    return path == folder || path.starts_with(folder + u'/');
}

void MakePreferenceFolder(const filesupport::File& file)
{
    const filesupport::Dir folder = file.GetDir();
    if (IsBelow(folder.FullPath(), filesupport::Dir::PrefDir().FullPath()))
        folder.Create();
}

} // namespace

bool LoadPropList(const UTF16String& path, PropList& list, bool merge)
{
    const UTF8String text = zebcore::utility::FileUtils::SimpleReadStringFromFile(path);
    PropList added;
    const xml::XmlResult result = Read(text, merge ? added : list);
    if (result.mCode != 0)
        ZEB_TRACE("PropList", path << ": " << result.mFault);
    PropListCopier copier(list);
    added.Visit(copier);
    return result.mCode == 0;
}

void SavePropList(filesupport::File& file, const PropList& list)
{
    UTF8String text;
    WritePropList(text, list);
    MakePreferenceFolder(file);
    filesupport::SafeSave save(file);
    try
    {
        zebcore::utility::FileUtils::SimpleWriteStringToFile(save.GetTempFile().FullPath(), text);
    }
    catch (const filesupport::file_exception& failure)
    {
        // The user knows the file, not the temporary one.
        throw filesupport::file_exception("cannot save", file.FullPath(), failure.Error());
    }
    save.Commit();
}

bool ReadPropList(const UTF8String& text, PropList& list)
{
    const xml::XmlResult result = Read(text, list);
    if (result.mCode != 0)
        ZEB_TRACE("PropList", result.mFault);
    return result.mCode == 0;
}

void WritePropList(UTF8String& text, const PropList& list)
{
    UTF8String written;
    PropListWriter(written, 0).WriteDocument(list);
    text.swap(written);
}

} // namespace zebcore::proplist::utils
