#include "host/src/VST3/src/HostAttributeList.h"

#include <algorithm>
#include <bit>
#include <cstddef>
#include <utility>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int64;
using Steinberg::tresult;
using Steinberg::uint32;
using Steinberg::Vst::TChar;

class HostAttributeList::HostAttribute : public zebcore::utility::RefCountedObject
{
public:
    enum Kind : std::int32_t
    {
        kInteger = 0,
        kFloat = 1,
        kString = 2,
        kBinary = 3
    };

    explicit HostAttribute(int64 value) : mNumber(std::bit_cast<std::uint64_t>(value)), mKind(kInteger) {}
    explicit HostAttribute(double value) : mNumber(std::bit_cast<std::uint64_t>(value)), mKind(kFloat) {}
    explicit HostAttribute(std::vector<TChar> text) : mString(std::move(text)), mKind(kString) {}
    explicit HostAttribute(std::vector<char> data) : mBinary(std::move(data)), mKind(kBinary) {}

    const std::vector<TChar> mString; // without a terminator
    const std::vector<char> mBinary;
    const std::uint64_t mNumber = 0; // an integer or a double, bit for bit
    const Kind mKind;
};

HostAttributeList::HostAttributeList() = default;
HostAttributeList::~HostAttributeList() = default;

bool HostAttributeList::KeyOrder::operator()(const Steinberg::String& left, const Steinberg::String& right) const
{
    return left.compare(right) < 0;
}

void HostAttributeList::removeAttrID(AttrID id)
{
    mAttributes.erase(Steinberg::String(id));
}

void HostAttributeList::Put(AttrID id, boost::intrusive_ptr<HostAttribute> attribute)
{
    removeAttrID(id);
    mAttributes.emplace(Steinberg::String(id), std::move(attribute));
}

const HostAttributeList::HostAttribute* HostAttributeList::Find(AttrID id) const
{
    const auto found = mAttributes.find(Steinberg::String(id));
    return found == mAttributes.end() ? nullptr : found->second.get();
}

tresult PLUGIN_API HostAttributeList::queryInterface(const Steinberg::TUID interfaceID, void** object)
{
    return QueryHostObject<Steinberg::Vst::IAttributeList>(*this, interfaceID, object);
}

uint32 PLUGIN_API HostAttributeList::addRef()
{
    return mReferenceCount.Add();
}

uint32 PLUGIN_API HostAttributeList::release()
{
    const uint32 count = mReferenceCount.Remove();
    if (count == 0)
        delete this;
    return count;
}

tresult PLUGIN_API HostAttributeList::setInt(AttrID id, int64 value)
{
    Put(id, new HostAttribute(value));
    return Steinberg::kResultOk;
}

tresult PLUGIN_API HostAttributeList::getInt(AttrID id, int64& value)
{
    const HostAttribute* attribute = Find(id);
    if (!attribute)
        return Steinberg::kResultFalse;
    value = std::bit_cast<int64>(attribute->mNumber);
    return Steinberg::kResultOk;
}

tresult PLUGIN_API HostAttributeList::setFloat(AttrID id, double value)
{
    Put(id, new HostAttribute(value));
    return Steinberg::kResultOk;
}

tresult PLUGIN_API HostAttributeList::getFloat(AttrID id, double& value)
{
    const HostAttribute* attribute = Find(id);
    if (!attribute)
        return Steinberg::kResultFalse;
    value = std::bit_cast<double>(attribute->mNumber);
    return Steinberg::kResultOk;
}

tresult PLUGIN_API HostAttributeList::setString(AttrID id, const TChar* string)
{
    const TChar* end = string;
    while (end && *end != 0)
        ++end;
    Put(id, new HostAttribute(std::vector<TChar>(string, end)));
    return Steinberg::kResultOk;
}

tresult PLUGIN_API HostAttributeList::getString(AttrID id, TChar* string, uint32 size)
{
    const HostAttribute* attribute = Find(id);
    if (!attribute)
        return Steinberg::kResultFalse;
    const std::size_t count = string ? std::min<std::size_t>(attribute->mString.size(), size) : 0;
    std::copy_n(attribute->mString.begin(), count, string);
    return Steinberg::kResultOk;
}

tresult PLUGIN_API HostAttributeList::setBinary(AttrID id, const void* data, uint32 size)
{
    const char* bytes = static_cast<const char*>(data);
    Put(id, new HostAttribute(std::vector<char>(bytes, bytes ? bytes + size : bytes)));
    return Steinberg::kResultFalse;
}

tresult PLUGIN_API HostAttributeList::getBinary(AttrID id, const void*& data, uint32& size)
{
    size = 0;
    const HostAttribute* attribute = Find(id);
    if (!attribute)
        return Steinberg::kResultFalse;
    data = attribute->mBinary.data();
    size = static_cast<uint32>(attribute->mBinary.size());
    return Steinberg::kResultOk;
}

} // namespace zebaudiofilterhost::vst3
