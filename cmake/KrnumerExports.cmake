# Writes the linker's version script from the public headers: whatever they declare with KRNUMER_API is exported,
# and nothing else is.

file(GLOB headers CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/include/krnumer/*.h)
set(KRNUMER_EXPORTED_NAMES "")
foreach(header IN LISTS headers)
    set_property(DIRECTORY ${PROJECT_SOURCE_DIR} APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${header})
    file(STRINGS ${header} declarations REGEX "^KRNUMER_API [^(]*\\(")
    foreach(declaration IN LISTS declarations)
        string(REGEX REPLACE "^KRNUMER_API [^(]*[ *]([A-Za-z0-9_]+)\\(.*" "\\1" name "${declaration}")
        list(APPEND KRNUMER_EXPORTED_NAMES ${name})
    endforeach()
endforeach()

set(KRNUMER_VERSION_SCRIPT ${PROJECT_BINARY_DIR}/krnumer.map)
list(JOIN KRNUMER_EXPORTED_NAMES ";\n        " exported)
file(CONFIGURE OUTPUT ${KRNUMER_VERSION_SCRIPT} CONTENT "{
    global:
        @exported@;
    local:
        *;
};
" @ONLY)

# The same names for the tests, one a line.
set(KRNUMER_EXPORTS_FILE ${PROJECT_BINARY_DIR}/exports.txt)
list(JOIN KRNUMER_EXPORTED_NAMES "\n" exported)
file(CONFIGURE OUTPUT ${KRNUMER_EXPORTS_FILE} CONTENT "@exported@\n" @ONLY)
