#include "utility/PrivatePluginUtils.h"

#include "foundation/zebcore/CaseInsensitive.h"
#include "foundation/zebcore/Dir.h"
#include "foundation/zebcore/File.h"
#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/IPlatformByteStream.h"
#include "foundation/zebcore/SafeSave.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/XmlUtils.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginModuleScanner.h"

namespace zebaudiofilterhost::utility
{

const UTF16String kPrivatePluginConfigResourceName = u"PrivatePluginConfig";
const UTF16String kVSTPrivateApplicationPluginPath = u"@PRIVATEAPPLICATIONPLUGINPATH";
const UTF16String kVST3PrivateApplicationPluginPath = u"@VST3PRIVATEAPPLICATIONPLUGINPATH";
const UTF16String kVSTPluginExtensionPlaceholder = u"@PLUGINEXTENSION";
const UTF16String kVST3PluginExtensionPlaceholder = u"@VST3PLUGINEXTENSION";
const UTF16String kVSTPluginExtension = u"vst";
const UTF16String kVST3PluginExtension = u"vst3";

namespace
{

constexpr unsigned long long kMaxTextLength = 4294967294ULL; // Bytes

// The list of banned plug-ins is not asked: what an application ships is its own affair.
void AppendBundles(const UTF16String& directory, std::u16string_view extension, TechnologyType type,
                   std::vector<PluginLocator>& locators)
{
    const Dir dir(directory);
    if (!dir.Exists())
    {
        return;
    }
    const Dir::DirIterator end = dir.EndSubdirs();
    for (Dir::DirIterator it = dir.BeginSubdirs(false, nullptr, {}); it != end; ++it)
    {
        const UTF16String path = (*it).FullPath();
        if (zebcore::utility::CaseInsensitive::EndsWith(path, extension))
        {
            locators.emplace_back(type, path);
        }
    }
}

void ReplaceAll(UTF16String& text, const UTF16String& what, const UTF16String& with)
{
    // Into a new text: moving the rest at each place would make long configurations slow to load.
    UTF16String replaced;
    std::size_t done = 0;
    for (std::size_t at = text.find(what); at != UTF16String::npos; at = text.find(what, done))
    {
        replaced.append(text, done, at - done).append(with);
        done = at + what.size();
    }
    replaced.append(text, done);
    text.swap(replaced);
}

UTF16String Escaped(const UTF16String& text)
{
    UTF16String escaped;
    zebcore::xml::utils::EncodeReservedCharacters(text, escaped);
    return escaped;
}

void Scan(const std::vector<PluginLocator>& locators)
{
    constexpr bool kSkipCategory = true;
    const boost::intrusive_ptr<PluginModuleScanner> scanner(new PluginModuleScanner(locators, kSkipCategory));
    scanner->BeginScan();
    PluginLocator locator;
    UTF16String detail;
    int current = 0;
    int total = 0;
    while (scanner->GetCurrentProgressInfo(locator, detail, current, total))
    {
        scanner->ContinueScan();
    }
    // No EndScan: there was no record before, so there is no enabled state to bring back.
}

// Works on the text alone: a name that happens to hold "vst" is replaced too, and comes back when the text is read.
// VST 3 comes first, as "vst" is a part of "vst3".
void PutPlaceholders(UTF16String& text, const UTF16String& vstDirectory, const UTF16String& vst3Directory)
{
    UTF16String vstPath = Escaped(vstDirectory);
    if (!vst3Directory.empty())
    {
        ReplaceAll(text, Escaped(vst3Directory), kVST3PrivateApplicationPluginPath);
        ReplaceAll(text, kVST3PluginExtension, kVST3PluginExtensionPlaceholder);
        // A VST 2 folder with "vst3" in its path now stands in the text like this.
        ReplaceAll(vstPath, kVST3PluginExtension, kVST3PluginExtensionPlaceholder);
    }
    if (!vstDirectory.empty())
    {
        ReplaceAll(text, vstPath, kVSTPrivateApplicationPluginPath);
        ReplaceAll(text, kVSTPluginExtension, kVSTPluginExtensionPlaceholder);
    }
}

void WriteWhole(const UTF16String& path, const UTF16String& text)
{
    File file(path);
    zebcore::filesupport::SafeSave save(file);
    try
    {
        zebcore::utility::FileUtils::SimpleWriteStringToFile(save.GetTempFile().FullPath(),
                                                             zebcore::utility::UTF16to8(text));
    }
    catch (const zebcore::filesupport::file_exception& failure)
    {
        // The user knows the file, not the temporary one.
        throw zebcore::filesupport::file_exception("cannot save", path, failure.Error());
    }
    save.Commit();
}

} // namespace

void BuildPrivatePluginConfig(const UTF16String& resultPath, const UTF16String& vstDirectory,
                              const UTF16String& vst3Directory)
{
    PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
    manager.ClearAll(true);

    std::vector<PluginLocator> locators;
    AppendBundles(vstDirectory, u".vst", kTechnologyVST, locators);
    if (!vst3Directory.empty())
    {
        AppendBundles(vst3Directory, u".vst3", kTechnologyVST3, locators);
    }
    if (!locators.empty())
    {
        Scan(locators);
    }

    const UTF8String configuration = manager.GetConfigurationAsXML();
    UTF16String text = zebcore::utility::UTF8to16(configuration, nullptr, nullptr);
    PutPlaceholders(text, vstDirectory, vst3Directory);
    WriteWhole(resultPath, text);

    manager.SetPrivatePluginConfiguration(configuration);
    File settings(Dir::PrefDir(), manager.GetSettingsFileName());
    manager.LoadConfiguration(settings);
}

void SetPrivatePluginConfig(const UTF16String& text, const UTF16String& vst3Directory,
                            const UTF16String& vstDirectory)
{
    if (text.empty())
    {
        return;
    }
    UTF16String filled = text;
    ReplaceAll(filled, kVST3PrivateApplicationPluginPath, Escaped(vst3Directory));
    ReplaceAll(filled, kVST3PluginExtensionPlaceholder, kVST3PluginExtension);
    ReplaceAll(filled, kVSTPrivateApplicationPluginPath, Escaped(vstDirectory));
    ReplaceAll(filled, kVSTPluginExtensionPlaceholder, kVSTPluginExtension);
    PluginModuleInfoManager::GetInstance().SetPrivatePluginConfiguration(zebcore::utility::UTF16to8(filled));
}

void SetPrivatePluginConfigFromFile(const UTF16String& path, const UTF16String& vst3Directory,
                                    const UTF16String& vstDirectory)
{
    const File file(path);
    if (!file.Exists())
    {
        return;
    }
    using zebcore::filesupport::IPlatformByteStream;
    IPlatformByteStream stream(file, zebcore::utility::Flags<unsigned int>(IPlatformByteStream::kOpenForReading));
    const unsigned long long length = stream.Length();
    if (length == 0 || length > kMaxTextLength)
    {
        return;
    }
    UTF8String text(static_cast<std::size_t>(length), u8'\0');
    text.resize(stream.ReadBlock(reinterpret_cast<unsigned char*>(text.data()), static_cast<unsigned int>(length)));
    SetPrivatePluginConfig(zebcore::utility::UTF8to16(text, nullptr, nullptr), vst3Directory, vstDirectory);
}

} // namespace zebaudiofilterhost::utility
