// A filter around a fake effect, which has the filter's host callback from the start.
#pragma once

#include "host/src/VST/src/VSTAudioFilter.h"
#include "tests/vst/support/FakeEffect.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gtest/gtest.h>

namespace fakeeffect
{

using zebaudiofilterhost::AudioFilterBusDescription;
using zebaudiofilterhost::ChannelFlags;
using zebaudiofilterhost::ChannelLayout;
using zebaudiofilterhost::UTF16String;

inline boost::intrusive_ptr<VSTAudioFilter> MakeFilter(FakeEffect& fake, const UTF16String& id = u"2:1234 Fake",
                                                       bool useFileTitle = true)
{
    fake.host = VSTAudioFilter::StaticAudioMasterCallback;
    return new VSTAudioFilter(id, u"/plug-ins/Title.of.file.so", fake.Get(), true, useFileTitle);
}

class FilterTest : public testing::Test
{
protected:
    void Make() { filter = MakeFilter(fake); }

    // Ready for blocks of this size.
    void MakeRunning(int blockSize = 64)
    {
        Make();
        filter->SetSampleRate(48000.0F);
        filter->SetBlockSize(blockSize);
        filter->Resume();
    }

    FakeEffect fake; // dies after the filter
    boost::intrusive_ptr<VSTAudioFilter> filter;
};

} // namespace fakeeffect
