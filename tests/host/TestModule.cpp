// A binary to load: it needs no more than to be there.
extern "C" __attribute__((visibility("default"))) int ZebTestModuleAnswer()
{
    return 42;
}
