#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringStreams.h"
#include "foundation/zebcore/StringTypes.h"

#include <memory>

namespace zebcore::console
{

/// A command that an application offers at its console.
class ZEB_EXPORT Command
{
public:
    Command(const UTF16String& name, const UTF16String& description);
    Command(const Command&) = delete;
    Command& operator=(const Command&) = delete;
    virtual ~Command();

    /// `arguments` is all that follows the name. What it throws reaches the console. [main]
    virtual void Execute(const UTF16String& arguments, utility::UTF16OutputStream& output) = 0;

    const UTF16String& GetName() const { return mName; }
    const UTF16String& GetDescription() const { return mDescription; }

private:
    const UTF16String mName;
    const UTF16String mDescription;
};

/// Supplies the creator function that CommandRegistry wants for the command class T.
template <typename T>
class CommandRegistrar
{
public:
    static std::unique_ptr<Command> CreateCommand(const UTF16String& name, const UTF16String& description)
    {
        return std::make_unique<T>(name, description);
    }
};

} // namespace zebcore::console
