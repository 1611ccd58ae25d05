# What `cmake --install` gives: headers, the static library for C++, the shared one for C, the Python package, the
# program, a CMake package and pkg-config files. A component is what one Debian package holds (Varnex3Packages.cmake).
include(CMakePackageConfigHelpers)

install(DIRECTORY varnex3 DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT development
    FILES_MATCHING PATTERN "*.h" PATTERN "server" EXCLUDE)
install(FILES bindings/c/varnex3_c.h DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT development)
install(TARGETS varnex3 varnex3_c EXPORT varnex3Targets
    ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT development
    LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT library NAMELINK_COMPONENT development)
install(EXPORT varnex3Targets NAMESPACE varnex3:: DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/varnex3
    COMPONENT development)

configure_package_config_file(cmake/varnex3Config.cmake.in ${PROJECT_BINARY_DIR}/varnex3Config.cmake
    INSTALL_DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/varnex3)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/varnex3ConfigVersion.cmake COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/varnex3Config.cmake ${PROJECT_BINARY_DIR}/varnex3ConfigVersion.cmake
    DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/varnex3 COMPONENT development)

# The prefix is found from where the file stands, so that an installed tree can be moved.
file(RELATIVE_PATH up /${CMAKE_INSTALL_LIBDIR}/pkgconfig /)
list(TRANSFORM CMAKE_DL_LIBS PREPEND -l OUTPUT_VARIABLE VARNEX3_PC_LIBS)
set(PKGCONFIG_PREFIX "\${pcfiledir}/${up}")
foreach(package varnex3 varnex3_c)
    configure_file(cmake/${package}.pc.in ${PROJECT_BINARY_DIR}/${package}.pc @ONLY)
    install(FILES ${PROJECT_BINARY_DIR}/${package}.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig
        COMPONENT development)
endforeach()

# The Python package by itself, the shared library in it.
install(DIRECTORY ${VARNEX3_PYTHON_DIR}/varnex3 DESTINATION ${CMAKE_INSTALL_LIBDIR}/varnex3/python
    COMPONENT python_alone
    FILES_MATCHING PATTERN "*.py" PATTERN "*.pyi" PATTERN "*.so" PATTERN "py.typed")
