#pragma once

#include "module/Module.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/plugins/hosted/HostedPlugin.h"
#include "utility/EffectUtils.h"

#include <gtest/gtest.h>

namespace zebtest
{

// A test with the library up, and the catalogue's filter of one fixture.
class HostedVST2 : public testing::Test
{
protected:
    static void SetUpTestSuite() { zebaudiofilterhost::Initialize(); }
    static void TearDownTestSuite() { zebaudiofilterhost::Terminate(); }

    // Scans the fixture and makes its first filter. The log is empty then, but for what making it called.
    FilterPtr Make(const char* fixture)
    {
        mPath = VST2Fixture(fixture);
        const auto descriptors = Scan(mPath);
        Recorder().Reset();
        Recorder().Clear();
        return descriptors.empty()
                   ? nullptr
                   : zebaudiofilterhost::utility::CreateAudioFilter(descriptors.front()->GetUniqueID());
    }

    FixtureRecorder Recorder() const { return RecorderOf(mPath); } // of the fixture that was made last

private:
    std::filesystem::path mPath;
};

} // namespace zebtest
