# A run for each byte of each file; under sanitizers for some of them.

find_package(nlohmann_json REQUIRED)

if(ZEB_SANITIZE)
    set(step 13)
else()
    set(step 1)
endif()
add_executable(zebhost_truncation_test TruncationTest.cpp support/Zebhost.cpp)
target_link_libraries(zebhost_truncation_test PRIVATE
    zeb_options nlohmann_json::nlohmann_json GTest::gtest_main GTest::gmock)
target_include_directories(zebhost_truncation_test PRIVATE ${PROJECT_SOURCE_DIR})
target_compile_definitions(zebhost_truncation_test PRIVATE ZEBHOST_PROGRAM="$<TARGET_FILE:zebhost>"
    ZEB_TRUNCATION_STEP=${step})
add_dependencies(zebhost_truncation_test zebhost)
zeb_use_fixtures(zebhost_truncation_test)
add_test(NAME zebhost_truncation_test COMMAND zebhost_truncation_test)
set_tests_properties(zebhost_truncation_test PROPERTIES TIMEOUT 900)
