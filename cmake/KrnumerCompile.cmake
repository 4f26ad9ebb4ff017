# One set of compiler flags for everything that the project builds.
#
# The stated forms of the numerics are what the compiler sees: no contraction into fused operations, no reassociation,
# no flags of one machine. -fno-math-errno only drops the writes of errno, which nothing reads, and lets square roots
# become instructions; -fno-trapping-math lets comparisons be vectorised, since no floating-point trap is ever enabled.

add_library(krnumer_flags INTERFACE)
target_compile_features(krnumer_flags INTERFACE cxx_std_20)
if(MSVC)
    target_compile_options(krnumer_flags INTERFACE /W4 /fp:precise)
else()
    target_compile_options(krnumer_flags INTERFACE -Wall -Wextra -Wconversion -Wshadow
        -ffp-contract=off -fno-math-errno -fno-trapping-math)
endif()

set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_C_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
if(NOT CMAKE_BUILD_TYPE AND NOT CMAKE_CONFIGURATION_TYPES)
    set(CMAKE_BUILD_TYPE Release)
endif()
set(CMAKE_CXX_FLAGS_RELEASE "-O3 -DNDEBUG")

set(KRNUMER_SANITIZE "" CACHE STRING "Sanitizers to build with, such as address,undefined")
if(KRNUMER_SANITIZE)
    add_compile_options(-fsanitize=${KRNUMER_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    add_link_options(-fsanitize=${KRNUMER_SANITIZE})
    if(KRNUMER_SANITIZE MATCHES address)
        add_compile_definitions(KRNUMER_ASAN)
    endif()
endif()
