# Installs the build into an empty folder, moves that folder, and builds and runs programs that know nothing but where the
# folder is now.
#   cmake -D BUILD=folder -D CONFIG=Release -D SCRATCH=folder -D SOURCE=folder -D GENERATOR=Ninja -D COMPILER=g++
#     -D QT=ON -P <this>
cmake_minimum_required(VERSION 3.25)

function(expect_equal what expected found)
    if(NOT found STREQUAL expected)
        message(FATAL_ERROR "${what}: expected\n${expected}\nfound\n${found}")
    endif()
endfunction()

unset(ENV{DESTDIR})
file(REMOVE_RECURSE ${SCRATCH})
execute_process(COMMAND ${CMAKE_COMMAND} --install ${BUILD} --config "${CONFIG}" --prefix ${SCRATCH}/first
    OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)
set(prefix ${SCRATCH}/moved)
file(RENAME ${SCRATCH}/first ${prefix})

# Headers stand in a folder of their own, where no other library's can be meant.
file(GLOB folders RELATIVE ${prefix} ${prefix}/include/*)
expect_equal("in include/" "include/tesselcontrols4" "${folders}")
file(GLOB_RECURSE licences RELATIVE ${prefix} ${prefix}/share/doc/*)
expect_equal("in share/doc/" "share/doc/Tesselcontrols4/LICENSE" "${licences}")

# How the project is built, and where, is nothing to those who use it.
file(GLOB_RECURSE package_files ${prefix}/*.cmake)
foreach(file IN LISTS package_files)
    file(READ ${file} text)
    foreach(own IN ITEMS -Werror -Wall tessel_build_flags nlohmann ${SOURCE}/ ${SCRATCH}/)
        string(FIND "${text}" "${own}" place)
        expect_equal("${own} in ${file}" -1 ${place})
    endforeach()
endforeach()

# Builds the program of a folder and expects what it says; further arguments go to CMake.
function(try_consumer name expected)
    set(program_build ${SCRATCH}/${name})
    execute_process(
        COMMAND ${CMAKE_COMMAND} -S ${CMAKE_CURRENT_LIST_DIR}/consumer/${name} -B ${program_build} -G ${GENERATOR}
            -D CMAKE_CXX_COMPILER=${COMPILER} -D CMAKE_BUILD_TYPE=${CONFIG} -D CMAKE_PREFIX_PATH=${prefix}
            -D CMAKE_RUNTIME_OUTPUT_DIRECTORY=${program_build}/$<0:> ${ARGN}
        COMMAND_ERROR_IS_FATAL ANY)
    execute_process(COMMAND ${CMAKE_COMMAND} --build ${program_build} --config "${CONFIG}" COMMAND_ERROR_IS_FATAL ANY)
    execute_process(COMMAND ${program_build}/${name}_consumer OUTPUT_VARIABLE said COMMAND_ERROR_IS_FATAL ANY)
    expect_equal("what the program of ${name} says" "${expected}" "${said}")
endfunction()

try_consumer(headless "open manual.txt\nLink\n" -D CMAKE_DISABLE_FIND_PACKAGE_Qt6=ON)
if(QT)
    set(ENV{QT_QPA_PLATFORM} offscreen)
    try_consumer(qt "pressed with button 1\nUnable to find file\n")
endif()
