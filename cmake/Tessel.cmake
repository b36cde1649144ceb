# What every library, test and program of the project is made with.

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
if(TESSEL_FUZZ)
    target_compile_options(tessel_build_flags INTERFACE
        -fsanitize=fuzzer-no-link,address,undefined -fno-sanitize-recover=all -fno-omit-frame-pointer)
    target_link_options(tessel_build_flags INTERFACE -fsanitize=address,undefined)
endif()

# tessel_library(frame SOURCES a.cpp b.cpp DEPENDS tessel_frame)
# A static library tessel_<name> of the folder it stands in, with the project's root on the include path.
function(tessel_library name)
    cmake_parse_arguments(ARG "" "" "SOURCES;DEPENDS" ${ARGN})
    add_library(tessel_${name} STATIC ${ARG_SOURCES})
    target_include_directories(tessel_${name} PUBLIC $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}>)
    target_compile_features(tessel_${name} PUBLIC cxx_std_20)
    target_link_libraries(tessel_${name} PUBLIC ${ARG_DEPENDS} PRIVATE $<BUILD_INTERFACE:tessel_build_flags>)
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
    tessel_program(${name} SOURCES ${ARG_SOURCES} DEPENDS ${ARG_DEPENDS} GTest::gmock GTest::gtest_main)
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
