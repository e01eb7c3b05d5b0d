// A message that writes down what happens to it.
#pragma once

#include "utility/Message.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

/// What several messages have done, in order: "p1" for the process stage of message 1, "m1" for its main stage, "d1"
/// for its destruction.
using MessageLog = std::vector<std::string>;

class RecordingMessage : public Message
{
public:
    RecordingMessage(MessageLog& log, int number) : mLog(log), mNumber(number) {}
    ~RecordingMessage() override { Write("d"); }

    bool ExecuteOnProcessThread() override
    {
        Write("p");
        return mRefusalsOnProcessThread-- <= 0;
    }

    bool ExecuteOnMainThread() override
    {
        Write("m");
        return mRefusalsOnMainThread-- <= 0;
    }

    int mRefusalsOnProcessThread = 0; ///< How often the process stage asks for the main stage
    int mRefusalsOnMainThread = 0;    ///< How often the main stage asks for the process stage

private:
    void Write(const char* what) { mLog.push_back(what + std::to_string(mNumber)); }

    MessageLog& mLog;
    int mNumber;
};

} // namespace zebaudiofilterhost::testing
