// Plug-ins that an application ships inside its own folder, catalogued at production time.
#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

/// The catalogue of private plug-ins is built once and shipped as text, with placeholders in place of paths, since
/// the application may be installed anywhere. At each start, and before PluginModuleInfoManager::LoadConfiguration,
/// the application hands the text over with the folders of this installation; its filters are then in the catalogue
/// without a scan, ahead of the user's own.
namespace zebaudiofilterhost::utility
{

/// The name under which an application keeps the text in its resources.
ZEB_EXPORT extern const zebcore::UTF16String kPrivatePluginConfigResourceName;

/// What stands in the text for the folders and extensions, and the extensions themselves.
ZEB_EXPORT extern const zebcore::UTF16String kVSTPrivateApplicationPluginPath;
ZEB_EXPORT extern const zebcore::UTF16String kVST3PrivateApplicationPluginPath;
ZEB_EXPORT extern const zebcore::UTF16String kVSTPluginExtensionPlaceholder;
ZEB_EXPORT extern const zebcore::UTF16String kVST3PluginExtensionPlaceholder;
ZEB_EXPORT extern const zebcore::UTF16String kVSTPluginExtension;
ZEB_EXPORT extern const zebcore::UTF16String kVST3PluginExtension;

/// Scans the two folders, banned plug-ins included, and writes the text to `resultPath`, the old file or the new one,
/// whole. An empty folder name, or a folder that is not there, has no plug-ins. Afterwards this process uses the new
/// configuration, and the user's catalogue is loaded again from the preference folder: unsaved records are gone.
/// Without a settings file there, those of this scan stay; ClearAll drops them. Categories are not asked for, so
/// instruments of VST 3 are among the effects. Exceptions of the file layer pass through, and the catalogue then
/// holds the scanned plug-ins alone. A plug-in that crashes takes the process along and leaves the old file.
///
/// Folders are replaced as text, wherever it stands, that of VST 3 first. So give full paths, with a slash at the end
/// either here and to the setters or to none of them; without one, no folder's name may begin with that of the VST 3
/// folder. [main]
ZEB_EXPORT void BuildPrivatePluginConfig(const zebcore::UTF16String& resultPath,
                                         const zebcore::UTF16String& vstDirectory,
                                         const zebcore::UTF16String& vst3Directory);

/// Fills in the placeholders and stores the text for the next LoadConfiguration. An empty text changes nothing. The
/// folders come in the other order than above. [main]
ZEB_EXPORT void SetPrivatePluginConfig(const zebcore::UTF16String& text, const zebcore::UTF16String& vst3Directory,
                                       const zebcore::UTF16String& vstDirectory);

/// The same from a UTF-8 file; one that is missing or empty changes nothing. Throws
/// zebcore::filesupport::file_exception if the file can't be read. [main]
ZEB_EXPORT void SetPrivatePluginConfigFromFile(const zebcore::UTF16String& path,
                                               const zebcore::UTF16String& vst3Directory,
                                               const zebcore::UTF16String& vstDirectory);

} // namespace zebaudiofilterhost::utility
