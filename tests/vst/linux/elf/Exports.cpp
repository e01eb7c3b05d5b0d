// A library with symbols of every kind that matters to who looks for a function in it. Many more, so that the hash
// tables have chains.
#include <cstdlib>

#define ZEB_SHOWN __attribute__((visibility("default")))
#define ZEB_HIDDEN __attribute__((visibility("hidden")))

extern "C"
{
    ZEB_SHOWN int Shown()
    {
        return 1;
    }
    ZEB_SHOWN __attribute__((weak)) int Weak()
    {
        return 2;
    }
    __attribute__((visibility("protected"))) int Protected()
    {
        return 3;
    }
    ZEB_HIDDEN int Hidden()
    {
        return 4;
    }
    ZEB_SHOWN int sData = 5;

#define ZEB_MORE(name)                                                                                               \
    ZEB_SHOWN int name##0()                                                                                          \
    {                                                                                                                \
        return Hidden();                                                                                             \
    }                                                                                                                \
    ZEB_SHOWN int name##1()                                                                                          \
    {                                                                                                                \
        return std::abs(sData);                                                                                      \
    }
    ZEB_MORE(A)
    ZEB_MORE(B)
    ZEB_MORE(C)
    ZEB_MORE(D)
    ZEB_MORE(E)
    ZEB_MORE(F)
    ZEB_MORE(G)
    ZEB_MORE(H)
}
