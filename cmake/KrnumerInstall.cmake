# What lands on a machine, in three components: runtime (libkrnumer), host (libkrrt) and development (headers, CMake
# and pkg-config files for both). Everything installed finds its neighbours relative to itself, so the prefix may be
# chosen, or changed, at installation.

include(CMakePackageConfigHelpers)

set(runtime_package libkrnumer${PROJECT_VERSION_MAJOR})
set(host_package libkrrt)
set(development_package libkrnumer-dev)

install(TARGETS krnumer EXPORT krnumerTargets
    RUNTIME COMPONENT runtime LIBRARY COMPONENT runtime NAMELINK_COMPONENT development ARCHIVE COMPONENT development)
install(TARGETS krrt EXPORT krnumerTargets
    RUNTIME COMPONENT host LIBRARY COMPONENT host ARCHIVE COMPONENT development)
install(DIRECTORY include/krnumer host/include/krrt DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT development
    FILES_MATCHING PATTERN *.h)

set(config_dir ${CMAKE_INSTALL_LIBDIR}/cmake/krnumer)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/krnumerConfigVersion.cmake COMPATIBILITY SameMajorVersion)
configure_file(cmake/krnumerConfig.cmake.in krnumerConfig.cmake @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/krnumerConfig.cmake ${PROJECT_BINARY_DIR}/krnumerConfigVersion.cmake
    DESTINATION ${config_dir} COMPONENT development)
install(EXPORT krnumerTargets NAMESPACE krnumer:: DESTINATION ${config_dir} COMPONENT development)

set(pkgconfig_dir ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
file(RELATIVE_PATH pkgconfig_up /prefix/${pkgconfig_dir} /prefix)
string(REGEX REPLACE "/$" "" pkgconfig_up ${pkgconfig_up})
foreach(library krnumer krrt)
    configure_file(cmake/${library}.pc.in ${library}.pc @ONLY)
    install(FILES ${PROJECT_BINARY_DIR}/${library}.pc DESTINATION ${pkgconfig_dir} COMPONENT development)
endforeach()

# libkrnumer carries parts of OpenBLAS, whose license asks that its text goes with them.
foreach(component runtime host development)
    set(doc_dir ${CMAKE_INSTALL_DATADIR}/doc/${${component}_package})
    install(FILES LICENSE DESTINATION ${doc_dir} COMPONENT ${component} RENAME copyright)
endforeach()
if(OpenBLASSerial_COPYRIGHT)
    install(FILES ${OpenBLASSerial_COPYRIGHT} DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/${runtime_package}
        COMPONENT runtime RENAME copyright.openblas)
endif()

# Debian packages of the components, by `make package`.
if(PROJECT_IS_TOP_LEVEL)
    set(CPACK_GENERATOR DEB)
    set(CPACK_PACKAGE_CONTACT "The krnumer authors")
    set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
    set(CPACK_STRIP_FILES ON)
    set(CPACK_DEB_COMPONENT_INSTALL ON)
    set(CPACK_COMPONENTS_ALL runtime host development)
    set(CPACK_COMPONENT_RUNTIME_DESCRIPTION "numerical analysis over the arrays of a host program")
    set(CPACK_COMPONENT_HOST_DESCRIPTION "host for krnumer, for programs without one of their own")
    set(CPACK_COMPONENT_DEVELOPMENT_DESCRIPTION "headers of libkrnumer and libkrrt")
    set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
    set(CPACK_DEBIAN_RUNTIME_PACKAGE_NAME ${runtime_package})
    set(CPACK_DEBIAN_HOST_PACKAGE_NAME ${host_package})
    set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME ${development_package})
    set(CPACK_DEBIAN_RUNTIME_PACKAGE_SECTION libs)
    set(CPACK_DEBIAN_HOST_PACKAGE_SECTION libs)
    set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
    set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS
        "${runtime_package} (= ${PROJECT_VERSION}), ${host_package} (= ${PROJECT_VERSION})")
    set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
    set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
    include(CPack)
endif()
