# How an editor is served, with a window of the test's own in place of the platform's.
add_executable(zebhost_editor_session_test EditorSessionTest.cpp)
target_link_libraries(zebhost_editor_session_test PRIVATE zebhost_parts zeb_options GTest::gtest_main)
target_include_directories(zebhost_editor_session_test PRIVATE ${PROJECT_SOURCE_DIR})
add_test(NAME zebhost_editor_session_test COMMAND zebhost_editor_session_test)
