#include "foundation/zebcore/XmlParser.h"

#include "TempFolder.h"

#include "foundation/zebcore/StringConversion.h"

#include <gtest/gtest.h>

#include <stdexcept>

using namespace zebcore;

namespace
{

// Writes down what it is told.
class Recorder final : public xml::AbstractParseHandler
{
public:
    explicit Recorder(std::string& log) : mLog(log) {}

    void StartDocument() override { mLog += "document "; }
    void StartElement(const UTF16String& name, const Attributes& attributes) override
    {
        Add("<", name);
        for (const auto& [key, value] : attributes)
            mLog += " " + utility::NarrowFromUTF16(key) + "=" + utility::NarrowFromUTF16(value);
        mLog += "> ";
    }
    void StartElementWithNamespace(const UTF16String& uri, const UTF16String& localName,
                                   const Attributes& attributes) override
    {
        Add("{", uri);
        Add("}", localName);
        mLog += ":" + std::to_string(attributes.size()) + " ";
    }
    void EndElement(const UTF16String& name) override
    {
        Add("</", name);
        mLog += "> ";
    }
    void EndElementWithNamespace(const UTF16String& uri, const UTF16String& localName) override
    {
        Add("{/", uri);
        Add("}", localName);
        mLog += " ";
    }
    void StartCDATA() override { mLog += "[ "; }
    void EndCDATA() override { mLog += "] "; }
    void Characters(const UTF16String& text) override
    {
        Add("'", text);
        mLog += "' ";
    }
    void Comment(const UTF16String& text) override
    {
        Add("#", text);
        mLog += " ";
    }
    void EndDocument() override { mLog += "end"; }
    void StartPrefixMapping(const UTF16String& prefix, const UTF16String& uri) override
    {
        Add("map ", prefix);
        Add("=", uri);
        mLog += " ";
    }
    void EndPrefixMapping(const UTF16String& prefix) override
    {
        Add("unmap ", prefix);
        mLog += " ";
    }

private:
    void Add(const char* mark, const UTF16String& text) { mLog += mark + utility::NarrowFromUTF16(text); }

    std::string& mLog;
};

class Thrower final : public xml::AbstractParseHandler
{
    void StartElement(const UTF16String& /*name*/, const Attributes& /*attributes*/) override
    {
        throw std::domain_error("handler");
    }
};

class XmlParserTest : public testing::Test
{
protected:
    int Parse(const std::string& text)
    {
        mFolder.Write("file.xml", text);
        mLog.clear();
        std::unique_ptr<xml::AbstractParseHandler> handler = std::make_unique<Recorder>(mLog);
        const std::unique_ptr<xml::XmlParser> parser = xml::GetParser(handler);
        EXPECT_EQ(handler, nullptr);
        return parser->Parse(mFolder.File("file.xml").FullPath());
    }

    const TempFolder mFolder;
    std::string mLog;
};

} // namespace

TEST_F(XmlParserTest, EventsArriveInDocumentOrder)
{
    EXPECT_EQ(Parse("<?xml version='1.0'?><pluginlist><!--note--><plugin version='2' filename='a &amp; b'/>"
                    "x<![CDATA[<y>]]></pluginlist>"),
              0);
    EXPECT_EQ(mLog, "document <pluginlist> #note <plugin filename=a & b version=2> </plugin> 'x' [ '<y>' ] "
                    "</pluginlist> end");
}

TEST_F(XmlParserTest, NamespacesAreReportedBesideThePlainNames)
{
    EXPECT_EQ(Parse("<p xmlns='urn:d' xmlns:q='urn:q'><q:e q:a='1' b='2'/></p>"), 0);
    EXPECT_EQ(mLog, "document map =urn:d map q=urn:q <p> {urn:d}p:0 <q:e b=2 q:a=1> {urn:q}e:2 {/urn:q}e </q:e> "
                    "{/urn:d}p </p> unmap q unmap  end");
}

TEST_F(XmlParserTest, BrokenFilesGiveACodeAndNoEnd)
{
    const char* const broken[] = {
        "",
        "text",
        "<a>",
        "<a></b>",
        "<a/><b/>",
        "<a b='1' b='2'/>",
        "<a>\xFF</a>",
        "<a>&x;</a>",
        "<!DOCTYPE a [<!ENTITY x 'y'>]><a>&x;</a>",
        "<!DOCTYPE a [<!ATTLIST a b CDATA 'default'>]><a/>",
    };
    for (const char* const text : broken)
    {
        EXPECT_NE(Parse(text), 0) << text;
        EXPECT_EQ(mLog.find("end"), std::string::npos) << text;
    }
}

TEST_F(XmlParserTest, HarmlessDocumentTypeIsTaken)
{
    EXPECT_EQ(Parse("<!DOCTYPE a SYSTEM '/etc/passwd'><a/>"), 0);
    EXPECT_EQ(mLog, "document <a> </a> end");
}

TEST_F(XmlParserTest, OtherEncodingsAreConverted)
{
    EXPECT_EQ(Parse("<?xml version='1.0' encoding='ISO-8859-1'?><a b='\xE9'/>"), 0);
    EXPECT_EQ(mLog, "document <a b=\u00e9> </a> end");
}

TEST_F(XmlParserTest, DeepNestingIsRefused)
{
    std::string deep;
    for (int i = 0; i < 100000; ++i)
        deep += "<a>";
    EXPECT_NE(Parse(deep), 0);
}

TEST_F(XmlParserTest, UnreadableFileGivesACode)
{
    std::unique_ptr<xml::AbstractParseHandler> handler = std::make_unique<Recorder>(mLog);
    const auto parser = xml::GetParser(handler);
    EXPECT_EQ(parser->Parse(mFolder.File("missing.xml").FullPath()), -1);
    EXPECT_EQ(parser->Parse(mFolder.Dir().FullPath()), -1);
    EXPECT_EQ(mLog, "");
}

TEST_F(XmlParserTest, OneParserReadsSeveralFiles)
{
    mFolder.Write("bad.xml", "<a>");
    mFolder.Write("good.xml", "<b/>");
    std::unique_ptr<xml::AbstractParseHandler> handler = std::make_unique<Recorder>(mLog);
    const auto parser = xml::GetParser(handler);
    EXPECT_NE(parser->Parse(mFolder.File("bad.xml").FullPath()), 0);
    EXPECT_EQ(parser->Parse(mFolder.File("good.xml").FullPath()), 0);
    EXPECT_EQ(mLog, "document <a> document <b> </b> end");
}

TEST_F(XmlParserTest, WhatAHandlerThrowsComesOut)
{
    mFolder.Write("file.xml", "<a><b/></a>");
    std::unique_ptr<xml::AbstractParseHandler> handler = std::make_unique<Thrower>();
    EXPECT_THROW(xml::GetParser(handler)->Parse(mFolder.File("file.xml").FullPath()), std::domain_error);
}

TEST_F(XmlParserTest, NoHandlerChecksOnly)
{
    mFolder.Write("file.xml", "<a/>");
    std::unique_ptr<xml::AbstractParseHandler> none;
    EXPECT_EQ(xml::GetParser(none)->Parse(mFolder.File("file.xml").FullPath()), 0);
}
