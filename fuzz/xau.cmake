# Units on the component layer, and the property lists that it reads.
if(NOT APPLE)
    zeb_add_fuzz_target(xau_component_ids UP_TO zeb_xau DICTIONARY filter_ids LONGEST 96)
    zeb_add_fuzz_target(xau_presets UP_TO zeb_xau
        DICTIONARY apple_list LONGEST 512 SOURCES ../tests/xau/support/FakeUnit.cpp)
    zeb_add_fuzz_target(xau_property_lists UP_TO zeb_xau
        DICTIONARY apple_list LONGEST 512)
endif()
