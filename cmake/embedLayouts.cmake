# stillmark_embed_layouts(<target> <file>...): compiles layout texts into the target, as what LayoutResources() of
# framework/layout/layoutResources.h answers. The texts are read again whenever one of them changes.
function(stillmark_embed_layouts target)
    set(texts)
    set(rows)
    foreach(file IN LISTS ARGN)
        cmake_path(GET file FILENAME name)
        set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS "${file}")
        file(READ "${file}" bytes HEX)
        string(REGEX REPLACE "([0-9a-f][0-9a-f])" "'\\\\x\\1'," bytes "${bytes}")
        string(LENGTH "${rows}" index)
        string(APPEND texts "constexpr char text${index}[] = {${bytes}};\n")
        string(APPEND rows "    {\"${name}\", {text${index}, sizeof(text${index})}},\n")
    endforeach()
    set(source "${CMAKE_CURRENT_BINARY_DIR}/layoutTexts.cpp")
    file(CONFIGURE OUTPUT "${source}" @ONLY CONTENT [=[
// Made by cmake/embedLayouts.cmake from resources/*.wyra.
#include "framework/layout/layoutResources.h"

namespace Sarnik
{
namespace
{

@texts@
constexpr CLayoutResource layouts[] = {
@rows@};

} // namespace

std::span<const CLayoutResource> LayoutResources()
{
    return layouts;
}

} // namespace Sarnik
]=])
    target_sources(${target} PRIVATE "${source}")
    if(TARGET ${target}_baseline)
        target_sources(${target}_baseline PRIVATE "${source}")
    endif()
endfunction()
