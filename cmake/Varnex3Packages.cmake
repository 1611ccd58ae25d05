# The Debian packages that `cpack -G DEB` makes of a build folder, one for each component of what is installed.
set(VARNEX3_PACKAGES libvarnex3-3 libvarnex3-dev varnex3 python3-varnex3)
set(VARNEX3_COMPONENTS library development tool python)

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME varnex3)
set(CPACK_PACKAGE_VENDOR "the Varnex3 authors")
set(CPACK_PACKAGE_CONTACT "Varnex3 developers <varnex3@example.invalid>")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_COMPONENTS_ALL ${VARNEX3_COMPONENTS})
set(CPACK_COMPONENTS_GROUPING IGNORE)
set(CPACK_PRE_BUILD_SCRIPTS ${PROJECT_SOURCE_DIR}/packaging/debian/documents.cmake)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS_POLICY ">=")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "") # each package begins its description with one of its own

set(CPACK_DEBIAN_LIBRARY_PACKAGE_NAME libvarnex3-3)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_CONTROL_EXTRA ${PROJECT_SOURCE_DIR}/packaging/debian/triggers)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_SUGGESTS "libodbc2, tdsodbc")
set(CPACK_COMPONENT_LIBRARY_DESCRIPTION "object model of the Xalo message language
The messages that a vehicle body repairer and an insurer exchange about a
repair job, as objects that write themselves as XML and read themselves.

This is the shared library, which any language reaches through its C face.")

set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME libvarnex3-dev)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS "libvarnex3-3 (= ${PROJECT_VERSION})")
set(CPACK_COMPONENT_DEVELOPMENT_DESCRIPTION "object model of the Xalo message language (development files)
The messages that a vehicle body repairer and an insurer exchange about a
repair job, as objects that write themselves as XML and read themselves.

These are the headers for C++20 and for C, the static library for C++, the
CMake package varnex3 and the pkg-config packages varnex3 and varnex3_c.")

set(CPACK_DEBIAN_TOOL_PACKAGE_NAME varnex3)
set(CPACK_DEBIAN_TOOL_PACKAGE_SECTION utils)
set(CPACK_DEBIAN_TOOL_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_TOOL_PACKAGE_SUGGESTS "libodbc2, tdsodbc")
set(CPACK_COMPONENT_TOOL_DESCRIPTION "reads the messages of the Xalo message language
Lists an inbox of messages, shows one, tells what makes one ill-formed, and
sees to the settings of the workshop's database.")

set(CPACK_DEBIAN_PYTHON_PACKAGE_NAME python3-varnex3)
set(CPACK_DEBIAN_PYTHON_PACKAGE_SECTION python)
set(CPACK_DEBIAN_PYTHON_PACKAGE_ARCHITECTURE all)
set(CPACK_DEBIAN_PYTHON_PACKAGE_DEPENDS "python3 (>= 3.9), libvarnex3-3 (>= ${PROJECT_VERSION})")
set(CPACK_DEBIAN_PYTHON_PACKAGE_CONTROL_EXTRA
    ${PROJECT_SOURCE_DIR}/packaging/debian/postinst ${PROJECT_SOURCE_DIR}/packaging/debian/prerm)
set(CPACK_COMPONENT_PYTHON_DESCRIPTION "object model of the Xalo message language (Python)
The messages that a vehicle body repairer and an insurer exchange about a
repair job, as objects that write themselves as XML and read themselves.

This is the Python package varnex3, with stubs for type checkers.")

# Debian's interpreter looks there; the package uses the shared library of libvarnex3-3.
install(DIRECTORY ${VARNEX3_PYTHON_DIR}/varnex3 DESTINATION lib/python3/dist-packages
    COMPONENT python EXCLUDE_FROM_ALL
    FILES_MATCHING PATTERN "*.py" PATTERN "*.pyi" PATTERN "py.typed")
foreach(package component IN ZIP_LISTS VARNEX3_PACKAGES VARNEX3_COMPONENTS)
    install(FILES packaging/debian/copyright DESTINATION share/doc/${package} COMPONENT ${component} EXCLUDE_FROM_ALL)
    install(FILES CHANGELOG.md DESTINATION share/doc/${package} COMPONENT ${component} EXCLUDE_FROM_ALL)
endforeach()

include(CPack)
