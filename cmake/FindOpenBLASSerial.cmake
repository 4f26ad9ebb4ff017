# Finds the single-threaded OpenBLAS with LAPACK and CBLAS inside, as a static archive: OpenBLAS::serial.
#
# The shared variants of OpenBLAS (serial, pthread, OpenMP) go by one SONAME, and the system's alternatives decide at
# run time which of them is loaded. The archive fixes the choice at link time. Its Fortran parts refer to the Fortran
# run time in one place only, which src/linalg/fortran_runtime.cpp fills; nothing else has to be found.
#
# OPENBLAS_SERIAL_ROOT names another place to look in first.

find_library(OpenBLASSerial_LIBRARY
    NAMES ${CMAKE_STATIC_LIBRARY_PREFIX}openblas${CMAKE_STATIC_LIBRARY_SUFFIX}
    HINTS ${OPENBLAS_SERIAL_ROOT}
    PATHS /usr/lib/${CMAKE_LIBRARY_ARCHITECTURE} /usr/lib64 /usr/lib /usr/local/lib
    PATH_SUFFIXES openblas-serial lib
    NO_DEFAULT_PATH)
# Its license, to be handed on with the binary.
find_file(OpenBLASSerial_COPYRIGHT copyright PATHS /usr/share/doc/libopenblas-serial-dev NO_DEFAULT_PATH)
mark_as_advanced(OpenBLASSerial_LIBRARY OpenBLASSerial_COPYRIGHT)

include(FindPackageHandleStandardArgs)
find_package_handle_standard_args(OpenBLASSerial REQUIRED_VARS OpenBLASSerial_LIBRARY
    REASON_FAILURE_MESSAGE "Debian has it in libopenblas-serial-dev, elsewhere set OPENBLAS_SERIAL_ROOT")

if(OpenBLASSerial_FOUND AND NOT TARGET OpenBLAS::serial)
    add_library(OpenBLAS::serial STATIC IMPORTED)
    set_target_properties(OpenBLAS::serial PROPERTIES
        IMPORTED_LOCATION ${OpenBLASSerial_LIBRARY}
        INTERFACE_LINK_LIBRARIES m)
endif()
