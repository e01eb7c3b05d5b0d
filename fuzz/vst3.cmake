# A plug-in inside the process, so that nothing but our side of the chunk can fail.
set(fake_plugin
    ../tests/vst3/FakeComponent.cpp
    ../tests/vst3/FakeController.cpp
    ../tests/vst3/FakePlugin.cpp)

zeb_add_fuzz_target(vst3_chunk UP_TO zeb_vst3 DICTIONARY property_list LONGEST 192 SOURCES ${fake_plugin})
zeb_add_fuzz_target(vst3_filter_ids UP_TO zeb_vst3 DICTIONARY filter_ids LONGEST 96)
