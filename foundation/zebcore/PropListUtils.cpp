#include "foundation/zebcore/PropListUtils.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/SafeSave.h"
#include "foundation/zebcore/Trace.h"
#include "foundation/zebcore/internal/FileDescriptor.h"
#include "foundation/zebcore/internal/ParseXml.h"
#include "foundation/zebcore/internal/PropListCopier.h"
#include "foundation/zebcore/internal/PropListReader.h"
#include "foundation/zebcore/internal/PropListWriter.h"
#include "foundation/zebcore/internal/TextFile.h"

#include <typeinfo>

namespace zebcore::proplist::utils
{

namespace
{

// Replaces the content of `list`. `document` is a text or a source of one. Returns what is wrong with it, and then
// leaves the list empty.
template <typename Document>
xml::XmlResult Read(const Document& document, PropList& list)
{
    list.Clear();
    PropListReader reader(list);
    xml::XmlResult result = xml::ParseXml(document, reader);
    if (result.mCode != 0)
        list.Clear();
    return result;
}

xml::XmlResult ReadFile(const UTF16String& path, PropList& list)
{
    filesupport::TextFile file(path);
    const xml::XmlSource source = [&file](unsigned char* buffer, unsigned int size)
    {
        return file.ReadBlock(buffer, size);
    };
    return Read(source, list);
}

void CopyTo(PropList& list, const PropList& added)
{
    PropListCopier copier(list);
    added.Visit(copier);
}

// A wrapper has its own idea of setting a value.
void Replace(PropList& list, PropList& content)
{
    if (typeid(list) == typeid(PropList))
        return list.Swap(content);
    list.Clear();
    CopyTo(list, content);
}

// The text never stands in memory as a whole.
void WriteFile(const UTF16String& path, const PropList& list)
{
    filesupport::FileDescriptor file = filesupport::FileDescriptor::Create(path);
    const PropListWriter::Drain drain = [&file](const UTF8String& text)
    {
        file.Write(text);
    };
    UTF8String rest;
    PropListWriter(rest, 0, &drain).WriteDocument(list);
    file.Write(rest);
    file.Close();
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
    PropList content; // not the caller's list: a file that can't be read to its end must not leave half of it there
    const xml::XmlResult result = ReadFile(path, content);
    if (result.mCode != 0)
        ZEB_TRACE("PropList", path << ": " << result.mFault);
    if (merge)
        CopyTo(list, content);
    else
        Replace(list, content);
    return result.mCode == 0;
}

void SavePropList(filesupport::File& file, const PropList& list)
{
    MakePreferenceFolder(file);
    filesupport::SafeSave save(file);
    try
    {
        WriteFile(save.GetTempFile().FullPath(), list);
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
