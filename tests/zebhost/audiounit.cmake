# The same program with Audio Units, where the component layer finds the tests' own.
add_executable(zebhost_audiounit_test AudioUnitTest.cpp support/Sound.cpp support/Zebhost.cpp)
target_link_libraries(zebhost_audiounit_test PRIVATE zebhost_parts zeb_options GTest::gtest_main GTest::gmock)
target_include_directories(zebhost_audiounit_test PRIVATE ${PROJECT_SOURCE_DIR})
target_compile_definitions(zebhost_audiounit_test PRIVATE ZEBHOST_PROGRAM="$<TARGET_FILE:zebhost>"
    ZEB_UNITS="${PROJECT_BINARY_DIR}/components" ZEB_UNIT_FIXTURES="${PROJECT_BINARY_DIR}/unitfixtures")
add_dependencies(zebhost_audiounit_test zebhost zeb_example_units fixture_unit_Recorder)
zeb_use_fixtures(zebhost_audiounit_test)
add_test(NAME zebhost_audiounit_test COMMAND zebhost_audiounit_test)
set_tests_properties(zebhost_audiounit_test PROPERTIES RESOURCE_LOCK display)
