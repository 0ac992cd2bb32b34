# Installs the build into a new folder, checks the list of files, builds and runs a small outside
# project against it, by CMake and by pkg-config, and runs the installed program.
#   cmake -D BUILD_DIR=... -D SOURCE_DIR=... -D WORK_DIR=... -D COMPILER=... -D CXX_FLAGS=...
#         -P install_test.cmake

function(run)
    cmake_parse_arguments(RUN "" "OUTPUT" "COMMAND" ${ARGN})
    execute_process(COMMAND ${RUN_COMMAND} WORKING_DIRECTORY ${WORK_DIR}
        RESULT_VARIABLE status OUTPUT_VARIABLE output ERROR_VARIABLE error)
    if(NOT status EQUAL 0)
        message(FATAL_ERROR "${RUN_COMMAND} ended with ${status}\n${output}\n${error}")
    endif()
    if(RUN_OUTPUT)
        set(${RUN_OUTPUT} "${output}" PARENT_SCOPE)
    endif()
endfunction()

function(expect_equal what actual expected)
    if(NOT actual STREQUAL expected)
        message(FATAL_ERROR "${what}: expected\n${expected}\nbut got\n${actual}")
    endif()
endfunction()

file(REMOVE_RECURSE ${WORK_DIR})
file(MAKE_DIRECTORY ${WORK_DIR})
set(prefix ${WORK_DIR}/prefix)
run(COMMAND ${CMAKE_COMMAND} --install ${BUILD_DIR} --prefix ${prefix})

# Version numbers and the system's library folder are not part of the list.
file(GLOB_RECURSE files LIST_DIRECTORIES false RELATIVE ${prefix} ${prefix}/*)
list(TRANSFORM files REPLACE "^lib/[a-z0-9_]+-linux-gnu/" "lib/")
list(TRANSFORM files REPLACE "libzefra\\.so\\..*" "libzefra.so.VERSION")
list(TRANSFORM files REPLACE "_orlith\\..*\\.so" "_orlith.PYTHON.so")
list(TRANSFORM files REPLACE "OrlithTargets-[a-z]+\\.cmake" "OrlithTargets-CONFIG.cmake")
list(REMOVE_DUPLICATES files)
list(SORT files)
list(JOIN files "\n" files)
file(READ ${SOURCE_DIR}/tests/install/installed_files.txt expected)
string(STRIP "${expected}" expected)
expect_equal("installed files" "${files}" "${expected}")

# The example is the one that the README shows.
file(READ ${SOURCE_DIR}/tests/install/consumer/example.cpp example)
file(READ ${SOURCE_DIR}/README.md readme)
string(FIND "${readme}" "${example}" place)
if(place EQUAL -1)
    message(FATAL_ERROR "README.md does not show tests/install/consumer/example.cpp as it is")
endif()

file(WRITE ${WORK_DIR}/look.cube "LUT_3D_SIZE 2
0.0 0.0 0.0\n1.0 0.0 0.0\n0.0 1.0 0.0\n1.0 1.0 0.0
0.0 0.0 1.0\n1.0 0.0 1.0\n0.0 1.0 1.0\n1.0 1.0 1.0\n")
run(COMMAND ${CMAKE_COMMAND} -S ${SOURCE_DIR}/tests/install/consumer -B ${WORK_DIR}/consumer
    -D CMAKE_PREFIX_PATH=${prefix} -D CMAKE_CXX_COMPILER=${COMPILER}
    "-DCMAKE_CXX_FLAGS=${CXX_FLAGS}")
run(COMMAND ${CMAKE_COMMAND} --build ${WORK_DIR}/consumer)
run(COMMAND ${WORK_DIR}/consumer/example look.cube OUTPUT output)
set(evaluated "0.5 0.5 0.5 1 0 0 \n")
expect_equal("the example's output" "${output}" "${evaluated}")
if(NOT EXISTS ${WORK_DIR}/copy.csp)
    message(FATAL_ERROR "the example wrote no copy.csp")
endif()

file(GLOB pc ${prefix}/lib/pkgconfig ${prefix}/lib/*/pkgconfig)
run(COMMAND ${CMAKE_COMMAND} -E env PKG_CONFIG_PATH=${pc}
    pkg-config --cflags --libs orlith OUTPUT flags)
separate_arguments(flags UNIX_COMMAND "${flags}")
separate_arguments(cxx_flags UNIX_COMMAND "${CXX_FLAGS}")
run(COMMAND ${COMPILER} -std=c++17 ${SOURCE_DIR}/tests/install/consumer/example.cpp
    -o ${WORK_DIR}/by-pkg-config ${flags} ${cxx_flags})
run(COMMAND ${WORK_DIR}/by-pkg-config look.cube OUTPUT output)
expect_equal("the example's output, built by pkg-config" "${output}" "${evaluated}")

run(COMMAND ${prefix}/bin/orlith panel OUTPUT panel)
if(NOT panel MATCHES "Generate and Write LUT File")
    message(FATAL_ERROR "the installed program does not find its bundle:\n${panel}")
endif()

# The image library brings hundreds of others: only what touches images may load it.
run(COMMAND ldd ${prefix}/bin/orlith OUTPUT libraries)
if(libraries MATCHES "libOpenImageIO")
    message(FATAL_ERROR "orlith is linked with the image library:\n${libraries}")
endif()
