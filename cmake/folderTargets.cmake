# How a folder becomes a library. Sources are found by pattern, so that adding a file needs no edit here.

# stillmark_glob(<variable> <pattern>...): the files that match, seen again at every build.
function(stillmark_glob variable)
    file(GLOB found CONFIGURE_DEPENDS LIST_DIRECTORIES false ${ARGN})
    set(${variable} ${found} PARENT_SCOPE)
endfunction()

# stillmark_library(<name> SOURCES <pattern>... [FLOORS <our library>...] [PUBLIC <library>...] [PRIVATE <library>...]
#                   [MULTIVERSION])
#
# A static library. FLOORS are the project's own libraries that it stands on. MULTIVERSION: hot loops are compiled for
# several processors, and where the build does that, <name>_baseline is a second library of the same sources without,
# standing on the _baseline of its floors. The definition is private to the sources: whether a loop is multiplied shows
# in no header, so one set of test objects can be linked with either library.
function(stillmark_library name)
    cmake_parse_arguments(PARSE_ARGV 1 arg "MULTIVERSION" "" "SOURCES;FLOORS;PUBLIC;PRIVATE")
    stillmark_glob(sources ${arg_SOURCES})

    add_library(${name} STATIC ${sources})
    target_include_directories(${name} PUBLIC ${PROJECT_SOURCE_DIR})
    target_link_libraries(${name} PUBLIC ${arg_FLOORS} ${arg_PUBLIC} PRIVATE ${arg_PRIVATE})

    if(arg_MULTIVERSION AND STILLMARK_MULTIVERSION)
        target_compile_definitions(${name} PRIVATE STILLMARK_MULTIVERSION=1)

        list(TRANSFORM arg_FLOORS APPEND _baseline)
        add_library(${name}_baseline STATIC EXCLUDE_FROM_ALL ${sources})
        target_include_directories(${name}_baseline PUBLIC ${PROJECT_SOURCE_DIR})
        target_link_libraries(${name}_baseline PUBLIC ${arg_FLOORS} ${arg_PUBLIC} PRIVATE ${arg_PRIVATE})
    endif()
endfunction()
