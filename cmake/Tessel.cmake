# What every library, test and program of the project is made with.

include(CMakePackageConfigHelpers)
include(GNUInstallDirs)
set(TESSEL_PACKAGE_FOLDER ${CMAKE_INSTALL_LIBDIR}/cmake/Tesselcontrols4)

add_library(tessel_build_flags INTERFACE)
target_compile_features(tessel_build_flags INTERFACE cxx_std_20)
target_compile_options(tessel_build_flags INTERFACE
    -Wall -Wextra -Wpedantic -Wshadow -Wnon-virtual-dtor -Woverloaded-virtual -Wcast-align -Wunused -Werror)
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND CMAKE_CXX_COMPILER_VERSION VERSION_LESS 13)
    # Warns of "text" + string, in the standard library's own code, as soon as it optimises.
    target_compile_options(tessel_build_flags INTERFACE -Wno-restrict)
endif()
if(TESSEL_SANITIZE)
    target_compile_options(tessel_build_flags INTERFACE
        -fsanitize=address,undefined -fno-sanitize-recover=all -fno-omit-frame-pointer)
    target_link_options(tessel_build_flags INTERFACE -fsanitize=address,undefined)
endif()

# Tests are compiled without optimisation, which takes the compiler a third of the time; what they test is not.
add_library(tessel_test_flags INTERFACE)
target_compile_options(tessel_test_flags INTERFACE -O0)

# What the fuzzing programs reach tells them which way it went.
add_library(tessel_fuzzed_flags INTERFACE)
if(TESSEL_FUZZ)
    target_compile_options(tessel_fuzzed_flags INTERFACE -fsanitize=fuzzer-no-link)
endif()

# tessel_precompiled_headers(tessel_test_headers HEADERS <string> "frame/Control.h" DEPENDS tessel_frame)
# Headers that are compiled once for all targets with the same flags, which take them by tessel_precompiled.
function(tessel_precompiled_headers name)
    cmake_parse_arguments(ARG "" "" "HEADERS;DEPENDS" ${ARGN})
    file(CONFIGURE OUTPUT ${CMAKE_CURRENT_BINARY_DIR}/${name}.cpp CONTENT "")
    add_library(${name} OBJECT ${CMAKE_CURRENT_BINARY_DIR}/${name}.cpp)
    target_link_libraries(${name} PRIVATE ${ARG_DEPENDS} tessel_build_flags)
    set_target_properties(${name} PROPERTIES AUTOMOC OFF)
    target_precompile_headers(${name} PRIVATE ${ARG_HEADERS})
endfunction()

function(tessel_precompiled target headers)
    target_precompile_headers(${target} REUSE_FROM ${headers})
endfunction()

# tessel_library(frame SOURCES a.cpp b.cpp DEPENDS tessel_frame)
# A static library tessel_<name> of the folder it stands in, with the folder's headers and the project's root on the include
# path. INSTALL_AS Controls makes it Tesselcontrols4::Controls in the installed package; NEEDS Qt6 6.4 COMPONENTS Widgets says
# what the package finds for that part, which is not there without. HEADERS_OF names a root with headers that were made, then files.
function(tessel_library name)
    cmake_parse_arguments(ARG "" "INSTALL_AS" "SOURCES;DEPENDS;HEADERS_OF;NEEDS" ${ARGN})
    file(GLOB headers CONFIGURE_DEPENDS *.h)
    add_library(tessel_${name} STATIC ${ARG_SOURCES})
    target_sources(tessel_${name} PUBLIC FILE_SET HEADERS BASE_DIRS ${PROJECT_SOURCE_DIR} FILES ${headers})
    if(ARG_HEADERS_OF)
        list(POP_FRONT ARG_HEADERS_OF root)
        list(FILTER ARG_HEADERS_OF INCLUDE REGEX "\\.h$")
        target_sources(tessel_${name} PUBLIC FILE_SET made_headers TYPE HEADERS BASE_DIRS ${root} FILES ${ARG_HEADERS_OF})
    endif()
    target_compile_features(tessel_${name} PUBLIC cxx_std_20)
    target_link_libraries(tessel_${name} PUBLIC ${ARG_DEPENDS}
        PRIVATE $<BUILD_INTERFACE:tessel_build_flags> $<BUILD_INTERFACE:tessel_fuzzed_flags>)
    set_target_properties(tessel_${name} PROPERTIES EXPORT_NAME internal::${name})
    if(ARG_INSTALL_AS)
        set_target_properties(tessel_${name} PROPERTIES EXPORT_NAME ${ARG_INSTALL_AS})
        tessel_install_part(${ARG_INSTALL_AS} tessel_${name})
        set_property(GLOBAL PROPERTY TESSEL_${ARG_INSTALL_AS}_NEEDS "${ARG_NEEDS}")
    endif()
endfunction()

# A part of the package: one library of the project with all that it depends on, less what earlier parts brought.
function(tessel_install_part part library)
    tessel_install_library(${part} ${library})
    install(EXPORT Tesselcontrols4${part} NAMESPACE Tesselcontrols4:: DESTINATION ${TESSEL_PACKAGE_FOLDER})
    set_property(GLOBAL APPEND PROPERTY TESSEL_INSTALLED_PARTS ${part})
endfunction()

function(tessel_install_library part library)
    get_property(installed GLOBAL PROPERTY TESSEL_INSTALLED_LIBRARIES)
    if(library IN_LIST installed)
        return()
    endif()
    set_property(GLOBAL APPEND PROPERTY TESSEL_INSTALLED_LIBRARIES ${library})
    get_target_property(header_sets ${library} INTERFACE_HEADER_SETS)
    set(headers)
    foreach(set IN LISTS header_sets)
        list(APPEND headers FILE_SET ${set} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/tesselcontrols4)
    endforeach()
    install(TARGETS ${library} EXPORT Tesselcontrols4${part} ARCHIVE ${headers})
    get_target_property(needed ${library} INTERFACE_LINK_LIBRARIES)
    list(FILTER needed INCLUDE REGEX "^tessel_")
    foreach(other IN LISTS needed)
        tessel_install_library(${part} ${other})
    endforeach()
endfunction()

# What find_package(Tesselcontrols4) reads: all parts, so it stands after the libraries.
function(tessel_install_package)
    get_property(parts GLOBAL PROPERTY TESSEL_INSTALLED_PARTS)
    set(needs "")
    foreach(part IN LISTS parts)
        get_property(needed GLOBAL PROPERTY TESSEL_${part}_NEEDS)
        string(APPEND needs "set(Tesselcontrols4_${part}_needs ${needed})\n")
    endforeach()
    configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/Tesselcontrols4Config.cmake.in
        ${PROJECT_BINARY_DIR}/Tesselcontrols4Config.cmake INSTALL_DESTINATION ${TESSEL_PACKAGE_FOLDER})
    write_basic_package_version_file(${PROJECT_BINARY_DIR}/Tesselcontrols4ConfigVersion.cmake
        COMPATIBILITY SameMajorVersion)
    install(FILES ${PROJECT_BINARY_DIR}/Tesselcontrols4Config.cmake ${PROJECT_BINARY_DIR}/Tesselcontrols4ConfigVersion.cmake
        DESTINATION ${TESSEL_PACKAGE_FOLDER})
endfunction()

# tessel_program(tessel-host SOURCES main.cpp DEPENDS tessel_headless)
function(tessel_program name)
    cmake_parse_arguments(ARG "" "" "SOURCES;DEPENDS" ${ARGN})
    add_executable(${name} ${ARG_SOURCES})
    target_link_libraries(${name} PRIVATE ${ARG_DEPENDS} tessel_build_flags)
endfunction()

# tessel_test(frame_tests SOURCES a_test.cpp DEPENDS tessel_frame)
# One test program of a folder, run by ctest as one test.
function(tessel_test name)
    cmake_parse_arguments(ARG "" "" "SOURCES;DEPENDS" ${ARGN})
    tessel_program(${name} SOURCES ${ARG_SOURCES} DEPENDS ${ARG_DEPENDS} tessel_test_flags GTest::gmock GTest::gtest_main)
    tessel_precompiled(${name} tessel_test_headers)
    add_test(NAME ${name} COMMAND ${name})
endfunction()

# tessel_folder_tests(frame_tests DEPENDS tessel_frame)
# All files *_test.cpp of the folder as one test program; nothing where there is none yet.
function(tessel_folder_tests name)
    file(GLOB sources CONFIGURE_DEPENDS *_test.cpp)
    if(sources)
        tessel_test(${name} SOURCES ${sources} ${ARGN})
    endif()
endfunction()

# tessel_control_tests(link DEPENDS tessel_controls_link)
# All files *_test.cpp of the folder, compiled once and linked twice: link_tests on the headless host, link_on_qt_tests on the host
# for Qt. Files *OnHeadless_test.cpp are for the first alone.
function(tessel_control_tests name)
    cmake_parse_arguments(ARG "" "" "DEPENDS" ${ARGN})
    file(GLOB sources CONFIGURE_DEPENDS *_test.cpp)
    set(headless ${sources})
    list(FILTER headless INCLUDE REGEX "OnHeadless_test\\.cpp$")
    list(FILTER sources EXCLUDE REGEX "OnHeadless_test\\.cpp$")
    add_library(${name}_test_objects OBJECT ${sources})
    target_link_libraries(${name}_test_objects PRIVATE
        ${ARG_DEPENDS} tessel_headless tessel_build_flags tessel_test_flags GTest::gmock)
    tessel_precompiled(${name}_test_objects tessel_test_headers)
    tessel_test(${name}_tests SOURCES $<TARGET_OBJECTS:${name}_test_objects> ${headless}
        DEPENDS headless_test_host ${ARG_DEPENDS} tessel_headless)
    if(TESSEL_QT)
        tessel_qt_test(${name}_on_qt_tests SOURCES $<TARGET_OBJECTS:${name}_test_objects>
            DEPENDS qt_test_host ${ARG_DEPENDS})
    endif()
endfunction()

# tessel_folder_benches(DEPENDS tessel_frame)
# Each file *_bench.cpp of the folder as one program of its name.
function(tessel_folder_benches)
    cmake_parse_arguments(ARG "" "" "DEPENDS" ${ARGN})
    file(GLOB sources CONFIGURE_DEPENDS *_bench.cpp)
    foreach(source IN LISTS sources)
        cmake_path(GET source STEM name)
        tessel_program(${name} SOURCES ${source} DEPENDS ${ARG_DEPENDS} benchmark::benchmark_main)
    endforeach()
endfunction()

# tessel_fuzzer(tessel_host_reader_fuzz DEPENDS tessel_headless)
# The file of that name as a fuzzing program. ctest gives it the inputs of the folder <name>_seeds where there is one, then
# what grows from them for half a minute at most, from a fixed seed; by hand it runs until it is stopped.
function(tessel_fuzzer name)
    cmake_parse_arguments(ARG "" "" "DEPENDS" ${ARGN})
    tessel_program(${name} SOURCES ${name}.cpp DEPENDS ${ARG_DEPENDS})
    target_link_options(${name} PRIVATE -fsanitize=fuzzer)
    # New inputs go to the first folder named: one of the build, never the seeds.
    set(corpus ${CMAKE_CURRENT_BINARY_DIR}/${name}_corpus)
    set(seeds ${CMAKE_CURRENT_SOURCE_DIR}/${name}_seeds)
    file(MAKE_DIRECTORY ${corpus})
    if(NOT IS_DIRECTORY ${seeds})
        set(seeds "")
    endif()
    add_test(NAME ${name} COMMAND ${name}
        -seed=1 -runs=100000 -max_total_time=30 -timeout=10 -verbosity=0 -print_final_stats=1 ${corpus} ${seeds})
endfunction()

# tessel_qt_test(qt_tests SOURCES a_test.cpp DEPENDS tessel_headless)
# A test program with widgets. They are shown on no screen, and nothing of the user's is read or written.
function(tessel_qt_test name)
    cmake_parse_arguments(ARG "" "" "SOURCES;DEPENDS" ${ARGN})
    tessel_program(${name} SOURCES ${ARG_SOURCES} DEPENDS qt_test_main ${ARG_DEPENDS} tessel_qt_test_flags)
    tessel_precompiled(${name} tessel_qt_test_headers)
    add_test(NAME ${name} COMMAND ${name})
    set(home ${CMAKE_CURRENT_BINARY_DIR}/${name}_home)
    file(MAKE_DIRECTORY ${home})
    file(CHMOD ${home} PERMISSIONS OWNER_READ OWNER_WRITE OWNER_EXECUTE)
    set_tests_properties(${name} PROPERTIES ENVIRONMENT
        "QT_QPA_PLATFORM=offscreen;QT_QPA_PLATFORMTHEME=;QT_SCALE_FACTOR=1;QT_ACCESSIBILITY=1;HOME=${home};XDG_CONFIG_HOME=${home};XDG_DATA_HOME=${home};XDG_CACHE_HOME=${home};XDG_RUNTIME_DIR=${home};TZ=UTC;LC_ALL=C.UTF-8")
endfunction()
