#pragma once

#include "foundation/zebcore/Command.h"
#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringStreams.h"
#include "foundation/zebcore/StringTypes.h"

#include <boost/function.hpp>

#include <memory>
#include <utility>
#include <vector>

namespace zebcore::console
{

/// The commands of the process, by name.
class ZEB_EXPORT CommandRegistry
{
public:
    using Creator =
        boost::function<std::unique_ptr<Command>(const UTF16String& name, const UTF16String& description)>;

    CommandRegistry() = delete;

    /// Adds a command, in place of one of the same name. `creator` is called at the first execution. [main]
    static void RegisterCommand(const UTF16String& name, const UTF16String& description, const Creator& creator);

    /// A command that is being executed lives until it returns. [main]
    static void UnregisterCommand(const UTF16String& name);

    /// False, with nothing done, if there is no such command. What the command throws passes on. [main]
    static bool ExecuteCommand(const UTF16String& name, const UTF16String& arguments,
                               utility::UTF16OutputStream& output);

    /// Names and descriptions, sorted by name. [main]
    static std::vector<std::pair<UTF16String, UTF16String>> GetCommands();
};

} // namespace zebcore::console
