# Every header compiles alone, and twice: one generated source per header that includes nothing else.
# Not part of `all`: build the target headers_compile_alone.

stillmark_glob(headers RELATIVE ${PROJECT_SOURCE_DIR}
    platform/*.h platform/*/*.h deblur/*/*.h framework/*/*.h framework/*/*/*.h store/*.h store/*/*.h stages/*.h stages/*/*.h dialog/*/*.h shell/*.h shell/*/*.h host/*.h host/*/*.h cli/*.h gallery/*.h bench/*.h fuzz/*.h tests/*.h tests/*/*.h tests/*/*/*.h)

set(headerSources)
foreach(header IN LISTS headers)
    set(source "${PROJECT_BINARY_DIR}/headers/${header}.cpp")
    file(CONFIGURE OUTPUT "${source}" CONTENT "#include \"${header}\"\n#include \"${header}\" // again\n")
    list(APPEND headerSources "${source}")
endforeach()

add_library(headers_compile_alone OBJECT EXCLUDE_FROM_ALL ${headerSources})
target_compile_options(headers_compile_alone PRIVATE -O0)
target_link_libraries(headers_compile_alone PRIVATE stillmark_test_options
    stillmark_host stillmark_shell stillmark_store stillmark_engine PkgConfig::VIPS PkgConfig::LCMS2 CLI11::CLI11
    stillmark_interface PkgConfig::PANGOCAIRO PkgConfig::SDL2)
