# An effect inside the process, and the reader of shared libraries, on which the search for VST 2 on Linux rests.
zeb_add_fuzz_target(vst_filter_ids UP_TO zeb_vst DICTIONARY filter_ids LONGEST 96)
zeb_add_fuzz_target(vst_presets UP_TO zeb_vst
    DICTIONARY property_list LONGEST 384 SOURCES ../tests/vst/support/FakeEffect.cpp)
if(NOT APPLE)
    zeb_add_fuzz_target(vst_exports UP_TO zeb_vst DICTIONARY property_list LONGEST 1024)
endif()
