#include "foundation/zebcore/Contract.h"
#include "foundation/zebcore/DebugDatabase.h"
#include "foundation/zebcore/Localizer.h"
#include "foundation/zebcore/ThrowError.h"
#include "foundation/zebcore/Trace.h"

#include <gtest/gtest.h>

#include <string>

using namespace zebcore;
using namespace zebcore::config;
using namespace zebcore::debug;

namespace
{

class LocalizerTest : public testing::Test
{
protected:
    ~LocalizerTest() override { mLocalizer.ClearTranslations(); }

    Localizer& mLocalizer = Localizer::Get();
};

TEST_F(LocalizerTest, WithoutATranslationTheDefaultCounts)
{
    EXPECT_TRUE(mLocalizer.Localize("$$$/zebaudiofilterhost/ParameterInfo/On=On") == u"On");
    EXPECT_TRUE(mLocalizer.Localize(u8"$$$/key=\u00e9") == u"\u00e9");
    EXPECT_TRUE(mLocalizer.Localize("$$$/key=a=b") == u"a=b");
    EXPECT_TRUE(mLocalizer.Localize("$$$/key=").empty());
}

TEST_F(LocalizerTest, ATranslationTakesTheDefaultsPlace)
{
    mLocalizer.AddTranslation("$$$/key", u"Ein");
    mLocalizer.AddTranslation("$$$/key", u"An");
    EXPECT_TRUE(mLocalizer.Localize("$$$/key=On") == u"An");
    EXPECT_TRUE(mLocalizer.Localize("$$$/key2=On") == u"On");
    mLocalizer.ClearTranslations();
    EXPECT_TRUE(mLocalizer.Localize("$$$/key=On") == u"On");
}

TEST_F(LocalizerTest, OtherTextComesBackAsItIs)
{
    EXPECT_TRUE(mLocalizer.Localize("a=b") == u"a=b");
    EXPECT_TRUE(mLocalizer.Localize("$$$/key") == u"$$$/key");
    EXPECT_TRUE(mLocalizer.Localize("").empty());
}

TEST(ThrowError, CarriesMessageAndNumbers)
{
    try
    {
        ThrowError(2, "$$$/key=%1 is not %2, %1, nor %3", 17, -4, false, ReplacementValue(u"This"),
                   ReplacementValue(u"%2"), ReplacementValue(), ReplacementValue());
    }
    catch (const Error& error)
    {
        EXPECT_EQ(2, error.GetLevel());
        EXPECT_EQ(17U, error.GetCode());
        EXPECT_EQ(-4, error.GetSubCode());
        EXPECT_FALSE(error.GetFlag());
        EXPECT_STREQ("This is not %2, This, nor %3", error.what());
        EXPECT_TRUE(error.GetMessageText() == u"This is not %2, This, nor %3");
        return;
    }
    FAIL() << "nothing was thrown";
}

class ContractTest : public testing::Test
{
protected:
    ContractTest()
    {
        SetDebugTraceSink([this](std::string_view text) { mReport += text; });
    }
    ~ContractTest() override { SetDebugTraceSink({}); }

    std::string mReport;
};

TEST_F(ContractTest, AKeptContractSaysNothing)
{
    const int value = 1;
    EXPECT_NO_THROW(ZEB_CONTRACT(value == 1));
    EXPECT_TRUE(mReport.empty());
}

TEST_F(ContractTest, AViolationIsReportedAndThrown)
{
    if (IsDebuggerAttached())
        GTEST_SKIP() << "a violation would stop in the debugger";
    const int* inAEffect = nullptr;
    try
    {
        ZEB_CONTRACT(inAEffect);
        FAIL() << "nothing was thrown";
    }
    catch (const Error& error)
    {
        EXPECT_EQ(0, error.GetLevel());
        EXPECT_EQ(105U, error.GetCode());
        EXPECT_EQ(25, error.GetSubCode());
        EXPECT_TRUE(error.GetFlag());
        EXPECT_STREQ("An input contract violation has occurred!", error.what());
    }
    EXPECT_NE(std::string::npos, mReport.find("inAEffect")) << mReport;
    EXPECT_NE(std::string::npos, mReport.find("ErrorsTest.cpp")) << mReport;
}

TEST(DebugDatabase, ReadsSettingsOrDefaults)
{
    DebugDatabase& database = DebugDatabase::Instance();
    EXPECT_TRUE(database.GetEntry(u8"TestKey", u8"default") == u8"default");
    EXPECT_TRUE(database.GetEntryAs<bool>(u8"TestKey", true));
    EXPECT_FALSE(database.GetEntryAs<bool>(u8"TestKey", false));

    database.SetEntry(u8"TestKey", u8"true");
    EXPECT_TRUE(database.GetEntryAs<bool>(u8"TestKey", false));
    for (const char8_t* notTrue : {u8"false", u8"True", u8"true ", u8"1", u8""})
    {
        database.SetEntry(u8"TestKey", notTrue);
        EXPECT_FALSE(database.GetEntryAs<bool>(u8"TestKey", true));
    }
    database.RemoveEntry(u8"TestKey");
    EXPECT_TRUE(database.GetEntryAs<bool>(u8"TestKey", true));
}

} // namespace
