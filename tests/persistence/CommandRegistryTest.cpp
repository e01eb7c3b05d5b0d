#include "foundation/zebcore/CommandRegistry.h"

#include <gtest/gtest.h>

using namespace zebcore;
using console::CommandRegistry;

namespace
{

int sMade = 0;
int sAlive = 0;

class Echo : public console::Command
{
public:
    Echo(const UTF16String& name, const UTF16String& description) : Command(name, description)
    {
        ++sMade;
        ++sAlive;
    }
    ~Echo() override { --sAlive; }

    void Execute(const UTF16String& arguments, utility::UTF16OutputStream& output) override
    {
        output << GetName() << u"/" << GetDescription() << u"/" << arguments;
        output.flush();
    }
};

class Remover final : public console::Command
{
public:
    using Command::Command;
    void Execute(const UTF16String& /*arguments*/, utility::UTF16OutputStream& output) override
    {
        CommandRegistry::UnregisterCommand(UTF16String(GetName()));
        output << GetName();
    }
};

class CommandRegistryTest : public testing::Test
{
protected:
    void SetUp() override { sMade = 0; }
    void TearDown() override
    {
        for (const auto& [name, description] : CommandRegistry::GetCommands())
            CommandRegistry::UnregisterCommand(name);
        EXPECT_EQ(sAlive, 0);
    }

    // What the command wrote; "?" if there is none of the name.
    static UTF16String Run(const UTF16String& name, const UTF16String& arguments = {})
    {
        utility::oUTF16StringStream output;
        return CommandRegistry::ExecuteCommand(name, arguments, output) ? output.str() : u"?";
    }
};

} // namespace

TEST_F(CommandRegistryTest, MakesACommandWhenItIsNeededAndOnce)
{
    CommandRegistry::RegisterCommand(u"echo", u"says it", console::CommandRegistrar<Echo>::CreateCommand);
    EXPECT_EQ(sMade, 0);
    EXPECT_TRUE(Run(u"echo", u"a,b") == u"echo/says it/a,b");
    EXPECT_TRUE(Run(u"echo") == u"echo/says it/");
    EXPECT_EQ(sMade, 1);
}

TEST_F(CommandRegistryTest, UnknownCommandsAreReported)
{
    CommandRegistry::RegisterCommand(u"echo", u"", console::CommandRegistrar<Echo>::CreateCommand);
    CommandRegistry::RegisterCommand(u"none", u"", CommandRegistry::Creator());
    EXPECT_TRUE(Run(u"Echo") == u"?");
    EXPECT_TRUE(Run(u"none") == u"?");
    CommandRegistry::UnregisterCommand(u"echo");
    CommandRegistry::UnregisterCommand(u"echo");
    EXPECT_TRUE(Run(u"echo") == u"?");
}

TEST_F(CommandRegistryTest, LaterRegistrationReplacesAndListIsSorted)
{
    CommandRegistry::RegisterCommand(u"b", u"first", console::CommandRegistrar<Echo>::CreateCommand);
    Run(u"b");
    CommandRegistry::RegisterCommand(u"b", u"second", console::CommandRegistrar<Echo>::CreateCommand);
    CommandRegistry::RegisterCommand(u"a", u"other", console::CommandRegistrar<Echo>::CreateCommand);
    EXPECT_TRUE(Run(u"b") == u"b/second/");
    const auto commands = CommandRegistry::GetCommands();
    ASSERT_EQ(commands.size(), 2U);
    EXPECT_TRUE(commands[0] == std::make_pair(UTF16String(u"a"), UTF16String(u"other")));
    EXPECT_TRUE(commands[1] == std::make_pair(UTF16String(u"b"), UTF16String(u"second")));
}

TEST_F(CommandRegistryTest, CommandMayUnregisterItself)
{
    CommandRegistry::RegisterCommand(u"remover", u"", console::CommandRegistrar<Remover>::CreateCommand);
    EXPECT_TRUE(Run(u"remover") == u"remover");
    EXPECT_TRUE(Run(u"remover") == u"?");
}
