// The commands by which a test lets a fixture call its host.
#include "tests/plugins/support/FixtureView.h"
#include "tests/plugins/support/HostAccess.h"
#include "tests/plugins/support/RunLoopUser.h"
#include "tests/plugins/support/VendorInterfaces.h"

#include <charconv>
#include <map>
#include <vector>

namespace fixture
{

namespace
{

using Arguments = std::vector<std::string>; // without the command itself

std::vector<std::string> Words(const std::string& text)
{
    std::vector<std::string> words;
    for (std::size_t at = 0; at < text.size();)
    {
        const std::size_t end = std::min(text.find(' ', at), text.size());
        if (end > at)
            words.push_back(text.substr(at, end - at));
        at = end + 1;
    }
    return words;
}

template <class Number>
Number Argument(const Arguments& arguments, std::size_t index)
{
    Number value{};
    if (index < arguments.size())
        std::from_chars(arguments[index].data(), arguments[index].data() + arguments[index].size(), value);
    return value;
}

std::string Answer(tresult result)
{
    return std::to_string(result);
}

template <class Call>
std::string ToHandler(Call call)
{
    IComponentHandler* handler = Handler();
    return handler != nullptr ? Answer(call(*handler)) : "none";
}

std::string BeginEdit(const Arguments& words)
{
    return ToHandler([&](auto& handler) { return handler.beginEdit(Argument<ParamID>(words, 0)); });
}

std::string PerformEdit(const Arguments& words)
{
    return ToHandler([&](auto& handler)
                     { return handler.performEdit(Argument<ParamID>(words, 0), Argument<ParamValue>(words, 1)); });
}

std::string EndEdit(const Arguments& words)
{
    return ToHandler([&](auto& handler) { return handler.endEdit(Argument<ParamID>(words, 0)); });
}

std::string RestartComponent(const Arguments& words)
{
    return ToHandler([&](auto& handler) { return handler.restartComponent(Argument<int32>(words, 0)); });
}

std::string NotifyUnitSelection(const Arguments& words)
{
    const FUnknownPtr<IUnitHandler> units(Handler());
    return units != nullptr ? Answer(units->notifyUnitSelection(Argument<UnitID>(words, 0))) : "none";
}

std::string NotifyProgramListChange(const Arguments& words)
{
    const FUnknownPtr<IUnitHandler> units(Handler());
    return units != nullptr
               ? Answer(units->notifyProgramListChange(Argument<ProgramListID>(words, 0), Argument<int32>(words, 1)))
               : "none";
}

std::string HostName(const Arguments&)
{
    const FUnknownPtr<IHostApplication> host(HostContext());
    String128 name{};
    if (host == nullptr || host->getName(name) != kResultOk)
        return "none";
    std::string text;
    for (const char16_t unit : std::u16string_view(name))
        text += static_cast<char>(unit);
    return text;
}

// Makes a message as a plug-in does, fills it and reads it back: "ID result-of-setBinary integer".
std::string MakeMessage(const Arguments&)
{
    const FUnknownPtr<IHostApplication> host(HostContext());
    const IPtr<IMessage> message(host != nullptr ? allocateMessage(host) : nullptr, false);
    if (message == nullptr)
        return "none";
    message->setMessageID("Hello");
    int64 value = 0;
    message->getAttributes()->setInt("Number", 42);
    const tresult binary = message->getAttributes()->setBinary("Bytes", "abc", 3);
    message->getAttributes()->getInt("Number", value);
    return std::string(message->getMessageID()) + ' ' + Answer(binary) + ' ' + std::to_string(value);
}

std::string ResizeView(const Arguments& words)
{
    FixtureView* view = NewestView();
    return view != nullptr ? Answer(view->AskForSize(Argument<int32>(words, 0), Argument<int32>(words, 1))) : "none";
}

std::string FrameHasRunLoop(const Arguments&)
{
    FixtureView* view = NewestView();
    if (view == nullptr || view->Frame() == nullptr)
        return "none";
    return FUnknownPtr<Linux::IRunLoop>(view->Frame()) != nullptr ? "1" : "0";
}

// "code locale theme-length" of the vendor-specific host interface.
std::string Language(const Arguments&)
{
    const FUnknownPtr<VendorSpecificHost> host(HostContext());
    if (host == nullptr)
        return "none";
    return std::to_string(host->GetUILanguage()) + ' ' + host->GetUILanguageString() + ' ' +
           std::to_string(host->GetThemeXMLLength());
}

std::string PassFocus(const Arguments& words)
{
    const FUnknownPtr<VendorSpecificHost> host(HostContext());
    if (host == nullptr)
        return "none";
    host->GainFocus(Argument<long>(words, 0));
    return "0";
}

std::string RunLoop(const Arguments& words)
{
    RunLoopUser* user = NewestRunLoopUser();
    if (user == nullptr || words.empty())
        return "none";
    return user->CarryOut(words[0]) ? "0" : "1";
}

} // namespace

std::string CarryOut(const std::string& command)
{
    static const std::map<std::string, std::string (*)(const Arguments&)> sCommands{
        {"beginEdit", BeginEdit},
        {"performEdit", PerformEdit},
        {"endEdit", EndEdit},
        {"restartComponent", RestartComponent},
        {"notifyUnitSelection", NotifyUnitSelection},
        {"notifyProgramListChange", NotifyProgramListChange},
        {"hostName", HostName},
        {"makeMessage", MakeMessage},
        {"resizeView", ResizeView},
        {"frameHasRunLoop", FrameHasRunLoop},
        {"language", Language},
        {"passFocus", PassFocus},
        {"runLoop", RunLoop},
    };
    Arguments words = Words(command);
    const auto found = words.empty() ? sCommands.end() : sCommands.find(words.front());
    if (found == sCommands.end())
        return "unknown";
    words.erase(words.begin());
    return found->second(words);
}

} // namespace fixture
