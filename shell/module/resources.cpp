// The plug-in's resources, in sections of the library that a host reads without running anything: "TPPL" and "AETE".

#include "shell/resources/propertyList.h"
#include "shell/resources/terminology.h"

#include <algorithm>
#include <array>

namespace Project
{
namespace
{

template <auto Build> constexpr auto asArray()
{
    std::array<std::uint8_t, Build().bytes.size()> bytes{};
    std::ranges::copy(Build().bytes, bytes.begin());
    return bytes;
}

[[gnu::used, gnu::section("TPPL")]] constexpr auto properties = asArray<propertyList>();
[[gnu::used, gnu::section("AETE")]] constexpr auto terms = asArray<terminology>();

} // namespace
} // namespace Project
