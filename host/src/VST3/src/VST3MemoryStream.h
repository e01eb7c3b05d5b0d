#pragma once

#include "host/src/VST3/src/HostObject.h"

#include <pluginterfaces/base/ibstream.h>

#include <span>
#include <vector>

namespace zebaudiofilterhost::vst3
{

/// The stream in which a plug-in's state travels. It has no overwrite in the middle: a write cuts off what lay behind
/// it. The position may stand anywhere, also beyond the end or below 0. Lives on the stack as a rule, where plug-ins'
/// references do not keep it alive.
class VST3MemoryStream final : public Steinberg::IBStream
{
public:
    /// No state is larger; what would grow the stream beyond it fails and changes nothing.
    static constexpr Steinberg::int64 kMaxSize = Steinberg::int64(1) << 30;

    VST3MemoryStream() = default;
    ~VST3MemoryStream() = default;

    VST3MemoryStream(const VST3MemoryStream&) = delete;
    VST3MemoryStream& operator=(const VST3MemoryStream&) = delete;

    /// Shows these bytes, from the first on, and copies them only when somebody writes. They must outlive that, or
    /// the stream.
    void Borrow(std::span<const char> bytes);

    /// In bytes.
    Steinberg::int64 GetSize() const;
    /// Valid until the next change of size; not to be read when the stream is empty.
    const char* GetData() const;
    /// Cuts, or fills with zero bytes; the position is left alone. A negative size counts as 0. False when there is
    /// no room.
    bool SetSize(Steinberg::int64 size);

    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** object) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

    /// A short read shows in `numRead` only.
    Steinberg::tresult PLUGIN_API read(void* buffer, Steinberg::int32 count, Steinberg::int32* numRead) override;
    /// kInvalidArgument for a null buffer or a position below 0; kOutOfMemory beyond kMaxSize.
    Steinberg::tresult PLUGIN_API write(void* buffer, Steinberg::int32 count, Steinberg::int32* numWritten) override;
    Steinberg::tresult PLUGIN_API seek(Steinberg::int64 offset, Steinberg::int32 mode,
                                       Steinberg::int64* result) override;
    Steinberg::tresult PLUGIN_API tell(Steinberg::int64* position) override;

private:
    HostReferenceCount mReferenceCount;
    void TakeOver();

    std::vector<char> mData;
    std::span<const char> mBorrowed; // in place of mData unless empty
    Steinberg::int64 mPosition = 0;
};

} // namespace zebaudiofilterhost::vst3
