# Toolchain: programs for 64-bit Windows, made by mingw-w64 and run by Wine. tests/compilers/mingw.sh uses it.

set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_SYSTEM_PROCESSOR x86_64)
# Of the two variants this is the one with the standard library's threads.
set(CMAKE_C_COMPILER x86_64-w64-mingw32-gcc-posix)
set(CMAKE_CXX_COMPILER x86_64-w64-mingw32-g++-posix)
set(CMAKE_RC_COMPILER x86_64-w64-mingw32-windres)
# So that a program needs nothing beside it.
set(CMAKE_EXE_LINKER_FLAGS_INIT -static)

# Programs are this machine's, headers and libraries the target's, packages what is named here.
set(tessel_cross_packages ${CMAKE_BINARY_DIR}/packages)
set(CMAKE_FIND_ROOT_PATH /usr/x86_64-w64-mingw32 ${tessel_cross_packages})
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)

# A package that is headers alone serves any target, but its own include folder is /usr/include, with all headers of this
# machine. Through these links it is a folder with the package's headers and nothing else.
get_property(is_trial GLOBAL PROPERTY IN_TRY_COMPILE)
if(NOT is_trial)
    foreach(link IN ITEMS include/nlohmann share/cmake/nlohmann_json)
        cmake_path(GET link PARENT_PATH folder)
        file(MAKE_DIRECTORY ${tessel_cross_packages}/${folder})
        file(CREATE_LINK /usr/${link} ${tessel_cross_packages}/${link} SYMBOLIC)
    endforeach()
endif()

# Without a display, without questions about what Wine would like to download, in a folder of its own.
set(CMAKE_CROSSCOMPILING_EMULATOR
    env --unset=DISPLAY WINEDEBUG=-all WINEDLLOVERRIDES=mscoree,mshtml= WINEPREFIX=${CMAKE_BINARY_DIR}/wine wine)
