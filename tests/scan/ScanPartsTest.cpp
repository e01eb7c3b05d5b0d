#include "scan/LineBuffer.h"
#include "scan/ScanWorkerProtocol.h"
#include "scan/StallClock.h"
#include "scan/WorkerEnd.h"
#include "scan/WorkerOutput.h"

#include <gmock/gmock.h>

#include <csignal>
#include <thread>

namespace zebhost
{

namespace
{

using protocol::Message;
using zebaudiofilterhost::PluginLocator;

TEST(LineBufferTest, GivesLinesOutOfPiecesOfAnySize)
{
    const std::string text = "one\n\ntwo three\nunfinished";
    for (std::size_t size = 1; size <= text.size(); ++size)
    {
        LineBuffer buffer;
        std::vector<std::string> lines;
        for (std::size_t at = 0; at < text.size(); at += size)
        {
            buffer.Append(std::string_view(text).substr(at, size));
            while (const auto line = buffer.Next())
            {
                lines.push_back(*line);
            }
        }
        EXPECT_THAT(lines, testing::ElementsAre("one", "", "two three")) << size;
        EXPECT_EQ(buffer.Size(), std::string("unfinished").size());
    }
}

TEST(ScanWorkerProtocolTest, AnyPathArrivesUnitForUnit)
{
    for (const zebcore::UTF16String& path :
         {zebcore::UTF16String(u"/a b/\"c\" & <d>\n.vst3"), zebcore::UTF16String(u"/\xD800/\xDCFF\x0001.vst3"),
          zebcore::UTF16String(u"")})
    {
        const PluginLocator locator(zebaudiofilterhost::kTechnologyVST3, path);
        const std::string line = protocol::ScanLine(locator);
        EXPECT_EQ(line.find('\n'), line.size() - 1);
        ASSERT_TRUE(protocol::ParseScan(line).has_value());
        EXPECT_EQ(*protocol::ParseScan(line), locator);
    }
}

TEST(ScanWorkerProtocolTest, MessagesComeBackAsTheyWere)
{
    EXPECT_EQ(protocol::ParseMessage(protocol::ReadyLine()).kind, Message::Kind::Ready);
    EXPECT_EQ(protocol::ParseMessage(protocol::StepLine("(2/3)")).detail, "(2/3)");
    IScanObserver::Outcome outcome;
    outcome.effects = 7;
    outcome.problem = "two\nlines \"quoted\"";
    for (const bool loaded : {true, false})
    {
        outcome.loaded = loaded;
        const Message message = protocol::ParseMessage(protocol::ResultLine(outcome, u8"<xml>\n\u00E9</xml>"));
        EXPECT_EQ(message.kind, Message::Kind::Result);
        EXPECT_EQ(message.outcome.loaded, loaded);
        EXPECT_EQ(message.outcome.effects, 7U);
        EXPECT_EQ(message.outcome.problem, outcome.problem);
        EXPECT_EQ(message.outcome.end, loaded ? IScanObserver::End::Scanned : IScanObserver::End::Failed);
        EXPECT_TRUE(message.found == u8"<xml>\n\u00E9</xml>");
    }
}

TEST(ScanWorkerProtocolTest, WhatAPluginWritesThereIsNonsense)
{
    for (const char* line : {"", "chatter", "{", "[]", "7", "{}", "{\"result\":1}", "{\"step\":\"a\",\"ready\":true}",
                             "{\"scan\":\"x\"}", "\xFF\xFE"})
    {
        EXPECT_EQ(protocol::ParseMessage(line).kind, Message::Kind::Nonsense) << line;
        EXPECT_FALSE(protocol::ParseScan(line).has_value()) << line;
    }
    EXPECT_FALSE(protocol::ParseMessage("{\"result\":{\"effects\":-1,\"loaded\":\"yes\"}}").outcome.loaded);
}

TEST(WorkerEndTest, TellsPluginsFromPeople)
{
    using Kind = WorkerEnd::Kind;
    for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT})
    {
        EXPECT_TRUE((WorkerEnd{Kind::Signalled, signal}.IsByUser()));
        EXPECT_FALSE((WorkerEnd{Kind::Exited, signal}.IsByUser()));
        EXPECT_THAT((WorkerEnd{Kind::Signalled, signal}.Describe()),
                    testing::StartsWith("was ended from outside: SIG"));
    }
    for (const int signal : {SIGSEGV, SIGABRT, SIGKILL, SIGPIPE})
    {
        EXPECT_FALSE((WorkerEnd{Kind::Signalled, signal}.IsByUser()));
    }
    EXPECT_EQ((WorkerEnd{Kind::Signalled, 63}.Describe()), "crashed: signal 63");
}

TEST(StallClockTest, CountsFromTheLastRestartAndNeverAtZero)
{
    const auto pause = []
    {
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    };
    StallClock endless(0);
    StallClock clock(0.03);
    pause();
    clock.Tick();
    clock.Restart();
    EXPECT_FALSE(clock.HasExpired());
    pause();
    pause();
    clock.Tick();
    endless.Tick();
    EXPECT_TRUE(clock.HasExpired());
    EXPECT_FALSE(endless.HasExpired());
}

TEST(WorkerOutputTest, KeepsTheLastLineOfAnyAmount)
{
    Console console;
    WorkerOutput output(console, false);
    EXPECT_EQ(output.LastLine(), "");
    const std::string line(1000, 'x');
    for (int count = 0; count < 10000; ++count)
    {
        output.Take(line);
    }
    output.Take("\nlast \x01words\n\n  \n");
    EXPECT_EQ(output.LastLine(), "last \uFFFDwords");
    EXPECT_GT(output.Amount(), 10000000U);
    output.Take("cut in the m");
    output.Take("iddle");
    EXPECT_EQ(output.LastLine(), "cut in the middle");
    output.Take("\n" + line);
    EXPECT_LT(output.LastLine().size(), 200U);
    output.Begin();
    EXPECT_EQ(output.LastLine(), "");
}

} // namespace

} // namespace zebhost
