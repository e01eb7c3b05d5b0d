# What an installed copy offers: the library with its headers, a CMake package, a pkg-config file, and zebhost with its
# man page and completions.

include(CMakePackageConfigHelpers)

set(ZEB_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/zebaudiofilterhost)

install(TARGETS zebaudiofilterhost EXPORT zebaudiofilterhostTargets
    FILE_SET HEADERS DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/zebaudiofilterhost)
install(EXPORT zebaudiofilterhostTargets NAMESPACE zebaudiofilterhost:: DESTINATION ${ZEB_CMAKE_DIR})

configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/zebaudiofilterhostConfig.cmake.in
    ${PROJECT_BINARY_DIR}/zebaudiofilterhostConfig.cmake INSTALL_DESTINATION ${ZEB_CMAKE_DIR})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/zebaudiofilterhostConfigVersion.cmake
    COMPATIBILITY SameMinorVersion)
install(FILES ${PROJECT_BINARY_DIR}/zebaudiofilterhostConfig.cmake
    ${PROJECT_BINARY_DIR}/zebaudiofilterhostConfigVersion.cmake DESTINATION ${ZEB_CMAKE_DIR})

configure_file(${PROJECT_SOURCE_DIR}/cmake/zebaudiofilterhost.pc.in ${PROJECT_BINARY_DIR}/zebaudiofilterhost.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/zebaudiofilterhost.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)

if(TARGET zebhost)
    if(APPLE)
        set(own_folder @loader_path)
    else()
        set(own_folder $ORIGIN)
    endif()
    set_target_properties(zebhost PROPERTIES INSTALL_RPATH ${own_folder}/../${CMAKE_INSTALL_LIBDIR})
    install(TARGETS zebhost)

    # The program prints its own manual page and completions, all from the table of its options.
    set(pages ${PROJECT_BINARY_DIR}/share)
    file(MAKE_DIRECTORY ${pages})
    set(print "\"$0\" man >zebhost.1 && \"$0\" completion bash >zebhost && \"$0\" completion zsh >_zebhost \
&& \"$0\" completion fish >zebhost.fish")
    add_custom_command(OUTPUT ${pages}/zebhost.1 COMMAND sh -c "${print}" $<TARGET_FILE:zebhost>
        WORKING_DIRECTORY ${pages} DEPENDS zebhost VERBATIM)
    add_custom_target(zebhost_pages ALL DEPENDS ${pages}/zebhost.1)
    install(FILES ${pages}/zebhost.1 DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
    install(FILES ${pages}/zebhost DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions)
    install(FILES ${pages}/_zebhost DESTINATION ${CMAKE_INSTALL_DATADIR}/zsh/site-functions)
    install(FILES ${pages}/zebhost.fish DESTINATION ${CMAKE_INSTALL_DATADIR}/fish/vendor_completions.d)
endif()
