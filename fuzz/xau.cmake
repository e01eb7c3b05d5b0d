# Property lists of Audio Units, where the component layer reads them.
if(NOT APPLE)
    zeb_add_fuzz_target(xau_property_lists UP_TO zeb_xau SOURCES ${ZEB_FUZZ_SUPPORT})
    if(ZEB_BUILD_FUZZERS)
        target_link_libraries(fuzz_xau_property_lists PRIVATE PkgConfig::ZEB_PLIST PkgConfig::ZEB_CAIRO_XCB)
    endif()
endif()
