# Installs the build tree given as BUILD into a prefix of its own, then builds a C and a C++ program against it outside
# the tree, once with find_package and once with pkg-config, and runs them.
#
#   cmake -DBUILD=... -DLIBDIR=lib [-DFLAGS=...] -P run.cmake

set(user ${CMAKE_CURRENT_LIST_DIR}/user)
set(program ${CMAKE_CURRENT_LIST_DIR}/../../examples/first.c)
set(work ${BUILD}/tests/package/work)
set(prefix ${work}/prefix)
file(REMOVE_RECURSE ${work})
file(MAKE_DIRECTORY ${work})

function(run)
    execute_process(COMMAND ${ARGN} COMMAND_ERROR_IS_FATAL ANY OUTPUT_QUIET)
endfunction()

run(${CMAKE_COMMAND} --install ${BUILD} --prefix ${prefix})

run(${CMAKE_COMMAND} -S ${user} -B ${work}/cmake -G Ninja -DCMAKE_PREFIX_PATH=${prefix}
    -DC_PROGRAM=${program} -DCMAKE_C_FLAGS=${FLAGS} -DCMAKE_CXX_FLAGS=${FLAGS})
run(${CMAKE_COMMAND} --build ${work}/cmake)
run(${work}/cmake/c_user)
run(${work}/cmake/cpp_user)

find_program(PKG_CONFIG pkg-config REQUIRED)
set(ENV{PKG_CONFIG_PATH} ${prefix}/${LIBDIR}/pkgconfig)
set(ENV{LD_LIBRARY_PATH} ${prefix}/${LIBDIR})
execute_process(COMMAND ${PKG_CONFIG} --cflags --libs krnumer krrt OUTPUT_VARIABLE options
    OUTPUT_STRIP_TRAILING_WHITESPACE COMMAND_ERROR_IS_FATAL ANY)
separate_arguments(options UNIX_COMMAND "${FLAGS} ${options}")
run(cc ${program} -o ${work}/pkgconfig_c_user ${options})
run(c++ ${user}/user.cpp -o ${work}/pkgconfig_cpp_user ${options})
run(${work}/pkgconfig_c_user)
run(${work}/pkgconfig_cpp_user)
