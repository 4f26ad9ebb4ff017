# Turns the meanings that stand beside the status codes in the public header into the cases of a switch, so that
# they are written once.

set(status_header ${PROJECT_SOURCE_DIR}/include/krnumer/status.h)
set_property(DIRECTORY ${PROJECT_SOURCE_DIR} APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${status_header})
file(READ ${status_header} text)

# Semicolons and brackets mean something in a list.
string(REPLACE ";" "<semicolon>" text "${text}")
string(REGEX MATCHALL "= *\n? *-?[1-9][0-9]*," codes "${text}")
string(REGEX MATCHALL "= *\n? *-?[1-9][0-9]*, *\n? */\\*\\*< [^*]* \\*/" meanings "${text}")
list(LENGTH codes code_count)
list(LENGTH meanings meaning_count)
if(code_count EQUAL 0 OR NOT code_count EQUAL meaning_count)
    message(FATAL_ERROR "status.h: ${code_count} codes, but ${meaning_count} with a meaning beside them")
endif()

set(cases "")
foreach(meaning IN LISTS meanings)
    string(REGEX REPLACE "= *\n? *(-?[0-9]+), *\n? */\\*\\*< ([^*]*) \\*/" "case \\1: return \"\\2\"<semicolon>\n" case
        "${meaning}")
    string(APPEND cases "${case}")
endforeach()
string(REGEX REPLACE "\n +\\* " " " cases "${cases}")
string(REPLACE "<semicolon>" ";" cases "${cases}")
file(CONFIGURE OUTPUT ${CMAKE_CURRENT_BINARY_DIR}/status_cases.inc CONTENT "${cases}" @ONLY)
