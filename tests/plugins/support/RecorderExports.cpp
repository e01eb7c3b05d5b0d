// The log, for tests: also in binaries that have nothing else of a plug-in.
#include "tests/plugins/support/Recorder.h"

#define ZEB_EXPORTED extern "C" __attribute__((visibility("default")))

ZEB_EXPORTED const char* ZebFixtureCalls()
{
    return fixture::AllCalls();
}

ZEB_EXPORTED void ZebFixtureClear()
{
    fixture::ForgetCalls();
}

ZEB_EXPORTED int ZebFixtureLiveObjects()
{
    return fixture::LiveObjects();
}

ZEB_EXPORTED void ZebFixtureSetRecording(int on)
{
    fixture::SetRecording(on != 0);
}
