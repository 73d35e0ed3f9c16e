# cmake -Dfolder=FOLDER -P writeIconSource.cmake: writes FOLDER/iconResources.cpp out of the packed icons beside it.

set(arrays)
set(rows)
foreach(row IN ITEMS Icons=IconResources.idx LowResolutionDataFile=IconsLowRes.dat
        HighResolutionDataFile=IconsHighRes.dat)
    string(REPLACE "=" ";" row "${row}")
    list(GET row 0 key)
    list(GET row 1 file)
    file(READ "${folder}/${file}" bytes HEX)
    string(REGEX REPLACE "([0-9a-f][0-9a-f])" "0x\\1," bytes "${bytes}")
    string(APPEND arrays "constexpr unsigned char of${key}[] = {${bytes}};\n")
    string(APPEND rows "    if (key == CResourceDataProvider::${key})\n        return std::as_bytes(std::span(of${key}));\n")
endforeach()

file(CONFIGURE OUTPUT "${folder}/iconResources.cpp" @ONLY CONTENT [=[
// Made by cmake/writeIconSource.cmake from resources/icons.
#include "framework/icons/iconResources.h"

#include "framework/icons/resourceDataProvider.h"

namespace Sarnik
{
namespace
{

@arrays@
} // namespace

std::span<const std::byte> IconResource(std::string_view key)
{
@rows@    return {};
}

} // namespace Sarnik
]=])
