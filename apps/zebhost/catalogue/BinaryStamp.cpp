#include "catalogue/BinaryStamp.h"

#include "catalogue/PluginFinder.h"

#include <foundation/zebcore/NativePath.h>
#include <foundation/zebcore/OSModule.h>

#include <chrono>
#include <filesystem>

namespace zebhost
{

BinaryStamp StampOf(const zebaudiofilterhost::PluginLocator& locator)
{
    std::filesystem::path binary =
        zebcore::filesupport::ToNativePath(zebcore::utility::FindOSModuleBinary(locator.GetPath()));
    if (binary.empty())
    {
        binary = PathOf(locator);
    }
    std::error_code error;
    const auto changed = std::filesystem::last_write_time(binary, error);
    if (error)
    {
        return {};
    }
    const auto size = std::filesystem::is_regular_file(binary, error) ? std::filesystem::file_size(binary, error) : 0;
    const auto since1970 = std::chrono::file_clock::to_sys(changed).time_since_epoch();
    return {std::chrono::duration_cast<std::chrono::nanoseconds>(since1970).count(), error ? 0 : size};
}

Json ToJson(const BinaryStamp& stamp)
{
    return Json{{"time", stamp.time}, {"size", stamp.size}};
}

BinaryStamp StampIn(const Json& entry)
{
    const auto found = entry.find("binary");
    if (found == entry.end() || !found->is_object())
    {
        return {};
    }
    const Json time = found->value("time", Json());
    const Json size = found->value("size", Json());
    if (!time.is_number_integer() || !size.is_number_unsigned())
    {
        return {};
    }
    return {time.get<std::int64_t>(), size.get<std::uint64_t>()};
}

} // namespace zebhost
