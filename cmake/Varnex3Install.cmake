# What `cmake --install` gives: headers, the static library for C++, the shared one for C, the Python package, the
# program, a CMake package and pkg-config files.
include(CMakePackageConfigHelpers)

install(DIRECTORY varnex3 DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} FILES_MATCHING PATTERN "*.h")
install(FILES bindings/c/varnex3_c.h DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(TARGETS varnex3 varnex3_c EXPORT varnex3Targets
    ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
    LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR})
install(EXPORT varnex3Targets NAMESPACE varnex3:: DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/varnex3)

configure_package_config_file(cmake/varnex3Config.cmake.in ${PROJECT_BINARY_DIR}/varnex3Config.cmake
    INSTALL_DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/varnex3)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/varnex3ConfigVersion.cmake COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/varnex3Config.cmake ${PROJECT_BINARY_DIR}/varnex3ConfigVersion.cmake
    DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/varnex3)

# The prefix is found from where the file stands, so that an installed tree can be moved.
file(RELATIVE_PATH up /${CMAKE_INSTALL_LIBDIR}/pkgconfig /)
list(TRANSFORM CMAKE_DL_LIBS PREPEND -l OUTPUT_VARIABLE VARNEX3_PC_LIBS)
set(PKGCONFIG_PREFIX "\${pcfiledir}/${up}")
foreach(package varnex3 varnex3_c)
    configure_file(cmake/${package}.pc.in ${PROJECT_BINARY_DIR}/${package}.pc @ONLY)
    install(FILES ${PROJECT_BINARY_DIR}/${package}.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
endforeach()

install(DIRECTORY ${VARNEX3_PYTHON_DIR}/varnex3 DESTINATION ${CMAKE_INSTALL_LIBDIR}/varnex3/python
    FILES_MATCHING PATTERN "*.py" PATTERN "*.pyi" PATTERN "*.so" PATTERN "py.typed")
