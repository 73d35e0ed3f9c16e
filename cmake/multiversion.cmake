# Hot loops are compiled for the baseline and for x86-64-v3 and chosen by the loader (platform/math/multiversion.h).
# Where that works it is the default, and the engine exists a second time without it, so that the tests also run the
# code of an older processor. Sanitizer runtimes start after the loader has chosen, so no multiversioning there.

include(CheckCXXSourceCompiles)

set(CMAKE_REQUIRED_FLAGS "-O2 -Werror")
check_cxx_source_compiles([[
    __attribute__((target_clones("default", "arch=x86-64-v3"))) void twice(float *a, int n)
    {
        for (int i = 0; i < n; ++i)
            a[i] *= 2;
    }
    int main(int argc, char **)
    {
        float a[4] = {};
        twice(a, argc & 3);
    }
]] STILLMARK_MULTIVERSION_WORKS)
unset(CMAKE_REQUIRED_FLAGS)

if(STILLMARK_MULTIVERSION_WORKS AND NOT STILLMARK_SANITIZE AND CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    set(multiversionDefault ON)
else()
    set(multiversionDefault OFF)
endif()
option(STILLMARK_MULTIVERSION "Compile hot loops for x86-64-v3 too and choose at load" ${multiversionDefault})

if(STILLMARK_MULTIVERSION AND NOT STILLMARK_MULTIVERSION_WORKS)
    message(FATAL_ERROR "STILLMARK_MULTIVERSION needs target_clones for x86-64-v3, which this compiler lacks")
endif()
if(STILLMARK_MULTIVERSION AND STILLMARK_SANITIZE)
    message(FATAL_ERROR "STILLMARK_MULTIVERSION and STILLMARK_SANITIZE exclude each other")
endif()
