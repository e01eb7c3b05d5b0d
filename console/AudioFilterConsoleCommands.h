// The commands that the library adds to the application's console.
#pragma once

#include "foundation/zebcore/Command.h"
#include "foundation/zebcore/Export.h"

namespace zebaudiofilterhost::console
{

/// Builds the private plug-in configuration (utility::BuildPrivatePluginConfig); registered while the library is
/// initialised.
class ZEB_EXPORT BuildPrivatePluginConfigCmd : public zebcore::console::Command
{
public:
    static const zebcore::UTF16String kName;
    static const zebcore::UTF16String kDescription;

    using Command::Command;

    /// arguments: path of the result file, folder of VST 3 plug-ins and, if there is one, folder of VST 2 plug-ins,
    /// with a comma between them. Anything else, a missing middle among it, prints how the command is used.
    /// Exceptions of the build pass through. [main]
    void Execute(const zebcore::UTF16String& arguments, zebcore::utility::UTF16OutputStream& output) override;
};

} // namespace zebaudiofilterhost::console
