#pragma once

#include <charconv>
#include <concepts>
#include <string>
#include <string_view>

namespace fixture
{

// The log of what the host called. One per bundle, any thread.
bool IsRecording();
void SetRecording(bool on);
void Append(std::string line);
const char* AllCalls(); // newline-separated; valid until the next call of this on any thread
void ForgetCalls();

// Objects of this bundle that exist.
int LiveObjects();
void CountLiveObject(int change);

inline void AddWord(std::string& line, std::string_view word)
{
    line += word;
}

template <class Number>
requires std::integral<Number> || std::floating_point<Number>
void AddWord(std::string& line, Number number)
{
    char text[32];
    line.append(text, std::to_chars(text, text + sizeof(text), number).ptr);
}

// Records "operation word word ..." and costs nothing while recording is off.
template <class... Words>
void Record(std::string_view operation, const Words&... words)
{
    if (!IsRecording())
        return;
    std::string line(operation);
    ((line += ' ', AddWord(line, words)), ...);
    Append(std::move(line));
}

} // namespace fixture
