// A library that lies beside plug-ins and is none: no entry point, nothing of a fixture, and not to be loaded.
extern "C" __attribute__((visibility("default"))) int ZebHelperAnswer()
{
    return 42;
}
