// Names of the foundation layer that the public headers use without their namespaces.
#pragma once

#include "foundation/zebcore/Dir.h"
#include "foundation/zebcore/File.h"
#include "foundation/zebcore/Flags.h"
#include "foundation/zebcore/Guid.h"
#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/StringTypes.h"
#include "foundation/zebmediatypes/AudioChannelDescription.h"
#include "foundation/zebmediatypes/ChannelLayout.h"
#include "foundation/zebmediatypes/ChannelMap.h"

namespace zebaudiofilterhost
{

using zebcore::UTF16String;
using zebcore::UTF8String;
using zebcore::filesupport::Dir;
using zebcore::filesupport::File;
using zebcore::proplist::PropList;
using zebcore::utility::Guid;
using zebmediatypes::AudioChannelDescription;
using zebmediatypes::AudioChannelLabel;
using zebmediatypes::ChannelLayout;
using zebmediatypes::ChannelMap;

/// One bit a channel; a set bit means that the channel is silent. Channel numbers count modulo 64.
using ChannelFlags = zebcore::utility::Flags<unsigned long long>;

/// The bit of a channel in ChannelFlags. Channels 64 and up share bits with the low ones.
constexpr unsigned long long ChannelBit(unsigned int channel)
{
    return 1ULL << (channel % 64U);
}

} // namespace zebaudiofilterhost
