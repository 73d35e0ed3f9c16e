#pragma once

#include <cstdint>
#include <span>
#include <string_view>

namespace Sarnik
{

struct CLayoutConstant
{
    std::string_view name;
    std::int32_t value;
};

/// The names that every layout may use without defining them. No name occurs twice.
std::span<const CLayoutConstant> LayoutConstants();

} // namespace Sarnik
