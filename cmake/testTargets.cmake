# How test sources become ctest cases.

include(GoogleTest)

# A test is listed when ctest runs, not when it is built; a hung one is stopped.
function(stillmark_discover target)
    gtest_discover_tests(${target} ${ARGN} DISCOVERY_MODE PRE_TEST PROPERTIES TIMEOUT 600)
endfunction()

# stillmark_test(<name> SOURCES <pattern>... LIBRARIES <library>...): one executable, nothing where no source matches.
function(stillmark_test name)
    cmake_parse_arguments(PARSE_ARGV 1 arg "" "" "SOURCES;LIBRARIES")
    stillmark_glob(sources ${arg_SOURCES})
    if(NOT sources)
        return()
    endif()
    add_executable(${name} ${sources})
    target_link_libraries(${name} PRIVATE ${arg_LIBRARIES} GTest::gmock_main)
    stillmark_discover(${name})
endfunction()

# stillmark_engine_test(<name> SOURCES <pattern>... LIBRARIES <library>...): tests over stillmark_engine. Where the
# engine also exists without multiversioning, the same test objects are linked with that one too and their cases appear
# a second time as baseline/<case>: both must pass, with the same tolerances. LIBRARIES must not link an engine.
function(stillmark_engine_test name)
    cmake_parse_arguments(PARSE_ARGV 1 arg "" "" "SOURCES;LIBRARIES")
    stillmark_glob(sources ${arg_SOURCES})
    if(NOT sources)
        return()
    endif()

    add_library(${name}_objects OBJECT ${sources})
    target_link_libraries(${name}_objects PRIVATE ${arg_LIBRARIES} stillmark_engine)

    add_executable(${name} $<TARGET_OBJECTS:${name}_objects>)
    target_link_libraries(${name} PRIVATE ${arg_LIBRARIES} stillmark_engine GTest::gmock_main)
    stillmark_discover(${name})

    if(TARGET stillmark_engine_baseline)
        add_executable(${name}_baseline $<TARGET_OBJECTS:${name}_objects>)
        target_link_libraries(${name}_baseline PRIVATE ${arg_LIBRARIES} stillmark_engine_baseline GTest::gmock_main)
        stillmark_discover(${name}_baseline TEST_PREFIX baseline/)
    endif()
endfunction()
