# Flags common to everything that is compiled here.

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)

get_property(multiConfig GLOBAL PROPERTY GENERATOR_IS_MULTI_CONFIG)
if(NOT CMAKE_BUILD_TYPE AND NOT multiConfig)
    set(CMAKE_BUILD_TYPE Release CACHE STRING "Release, Debug or RelWithDebInfo" FORCE)
endif()

if(NOT CMAKE_CXX_COMPILER_LAUNCHER)
    find_program(STILLMARK_CCACHE ccache)
    mark_as_advanced(STILLMARK_CCACHE)
    if(STILLMARK_CCACHE)
        set(CMAKE_CXX_COMPILER_LAUNCHER "${STILLMARK_CCACHE}")
    endif()
endif()

add_compile_options(
    -Wall -Wextra -Wpedantic -Wshadow -Wnon-virtual-dtor -Woverloaded-virtual
    # A fused multiply-add rounds once where two operations round twice: the picture would depend on the processor.
    -ffp-contract=off
    # Nobody reads errno after sqrt, nor the floating-point exception flags. Neither flag changes a value; both let
    # loops with square roots and conditions vectorise.
    -fno-math-errno -fno-trapping-math)

if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # g++ 12 sees overlapping copies in every `"text" + std::string` (its bug 105651).
    add_compile_options(-Wno-restrict)
endif()

if(STILLMARK_SANITIZE)
    add_compile_options(-fsanitize=${STILLMARK_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    add_link_options(-fsanitize=${STILLMARK_SANITIZE})
endif()

if(STILLMARK_FUZZ)
    if(NOT CMAKE_CXX_COMPILER_ID MATCHES "Clang")
        message(FATAL_ERROR "STILLMARK_FUZZ takes clang: -DCMAKE_CXX_COMPILER=clang++")
    endif()
    add_compile_options(-fsanitize=fuzzer-no-link)
endif()
