# The libraries, all from the system. Their Debian packages are listed in cmake/packages.sh.

find_package(PkgConfig REQUIRED)
find_package(TBB REQUIRED)
find_package(PNG 1.6 REQUIRED)
find_program(RSVG_CONVERT rsvg-convert REQUIRED)
find_package(CLI11 REQUIRED)
pkg_check_modules(FFTW3F REQUIRED IMPORTED_TARGET fftw3f)
pkg_check_modules(VIPS REQUIRED IMPORTED_TARGET vips>=8.14)
pkg_check_modules(LCMS2 REQUIRED IMPORTED_TARGET lcms2)
pkg_check_modules(SDL2 REQUIRED IMPORTED_TARGET sdl2>=2.26)
pkg_check_modules(PANGOCAIRO REQUIRED IMPORTED_TARGET pangocairo>=1.50 cairo)

if(STILLMARK_TESTS)
    find_package(GTest REQUIRED)
endif()

option(STILLMARK_BENCH "Build the benchmarks, if Google Benchmark is there" ON)
if(STILLMARK_BENCH)
    find_package(benchmark)
    if(NOT benchmark_FOUND)
        message(STATUS "No Google Benchmark: bench/ is left out")
    endif()
endif()
