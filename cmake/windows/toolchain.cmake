# Cross-builds for 64-bit Windows with Debian's MinGW-w64, against the wxWidgets that build_wxwidgets.sh builds, or the
# one in FOLDER_UPGRADE_WX_PREFIX. The program is linked statically, so that it is a single file, and is identical
# wherever it is built.
set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_SYSTEM_PROCESSOR x86_64)

# CMake checks the compilers in separate projects, which read this file again.
list(APPEND CMAKE_TRY_COMPILE_PLATFORM_VARIABLES FOLDER_UPGRADE_WX_PREFIX)
if(NOT FOLDER_UPGRADE_WX_PREFIX)
    execute_process(
        COMMAND ${CMAKE_CURRENT_LIST_DIR}/build_wxwidgets.sh
        OUTPUT_VARIABLE FOLDER_UPGRADE_WX_PREFIX OUTPUT_STRIP_TRAILING_WHITESPACE
        COMMAND_ERROR_IS_FATAL ANY)
endif()
set(wxWidgets_CONFIG_EXECUTABLE ${FOLDER_UPGRADE_WX_PREFIX}/bin/wx-config)

# The variant with POSIX threads, which has std::thread and the like.
set(host x86_64-w64-mingw32)
set(CMAKE_C_COMPILER ${host}-gcc-posix)
set(CMAKE_CXX_COMPILER ${host}-g++-posix)
set(CMAKE_RC_COMPILER ${host}-windres)
foreach(tool AR RANLIB STRIP OBJCOPY OBJDUMP DLLTOOL)
    string(TOLOWER ${tool} name)
    find_program(CMAKE_${tool} ${host}-${name} REQUIRED)
endforeach()

# The program must not contain a folder of the build machine or a time: the library's log calls contain __FILE__.
set(flags "")
foreach(folder ${CMAKE_SOURCE_DIR} ${CMAKE_BINARY_DIR} ${FOLDER_UPGRADE_WX_PREFIX})
    string(APPEND flags " \"-ffile-prefix-map=${folder}=.\"")
endforeach()
set(CMAKE_C_FLAGS_INIT ${flags})
set(CMAKE_CXX_FLAGS_INIT ${flags})
# The symbols are split off after linking.
set(CMAKE_CXX_FLAGS_RELEASE_INIT -g)
set(CMAKE_EXE_LINKER_FLAGS_INIT "-static -Wl,--gc-sections -Wl,--no-insert-timestamp")

set(CMAKE_FIND_ROOT_PATH ${FOLDER_UPGRADE_WX_PREFIX} /usr/${host})
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)
