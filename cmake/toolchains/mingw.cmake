# Windows, by the mingw-w64 compilers of Debian: -DVARNEX3_MINGW=i686 or x86_64.
#
# The win32 thread variant: with the other one a thread_local object with a destructor in a statically linked DLL
# corrupts the heap when a thread ends.
set(CMAKE_SYSTEM_NAME Windows)
list(APPEND CMAKE_TRY_COMPILE_PLATFORM_VARIABLES VARNEX3_MINGW)
set(CMAKE_SYSTEM_PROCESSOR ${VARNEX3_MINGW})
set(CMAKE_C_COMPILER ${VARNEX3_MINGW}-w64-mingw32-gcc-win32)
set(CMAKE_CXX_COMPILER ${VARNEX3_MINGW}-w64-mingw32-g++-win32)
set(CMAKE_RC_COMPILER ${VARNEX3_MINGW}-w64-mingw32-windres)
set(VARNEX3_WIDL ${VARNEX3_MINGW}-w64-mingw32-widl)

set(CMAKE_FIND_ROOT_PATH /usr/${VARNEX3_MINGW}-w64-mingw32)
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)

# Nothing but system libraries is needed where the component is installed.
set(CMAKE_EXE_LINKER_FLAGS_INIT "-static")
set(CMAKE_SHARED_LINKER_FLAGS_INIT "-static")
add_compile_definitions(UNICODE _UNICODE _WIN32_WINNT=0x0601 NOMINMAX WIN32_LEAN_AND_MEAN)
# The cold parts of functions stay where they are: apart, one that turns out empty has the address of another one's, and
# what tells how to unwind the stack is then the wrong one's, so that an error ends the host.
add_compile_options(-fno-reorder-blocks-and-partition)
if(VARNEX3_MINGW STREQUAL i686) # the same arithmetic as everywhere: doubles have 64 bits, not 80
    add_compile_options(-msse2 -mfpmath=sse)
endif()
