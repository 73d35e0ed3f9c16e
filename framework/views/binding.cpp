#include "framework/views/binding.h"

#include "framework/views/viewOptions.h"

namespace Sarnik
{
namespace
{

struct axisBits
{
    bool sizeable, centre, low, high;
};

/// How far a place at `quarters` fourths of the parent moves.
std::int64_t shift(std::int32_t oldSize, std::int32_t newSize, int quarters)
{
    return std::int64_t{newSize} * quarters / 4 - std::int64_t{oldSize} * quarters / 4;
}

void bind(std::int32_t &low, std::int32_t &high, const axisBits &bits, std::int32_t oldSize, std::int32_t newSize)
{
    int lowQuarters = 0, highQuarters = 0;
    if (bits.sizeable)
    {
        lowQuarters = bits.centre && bits.high ? 2 : 0;
        highQuarters = bits.centre && bits.low ? 2 : 4;
    }
    else if (bits.centre)
        lowQuarters = highQuarters = bits.low ? 1 : bits.high ? 3 : 2;
    else if (bits.high)
        lowQuarters = highQuarters = 4;
    low = CRect::Clamped(low + shift(oldSize, newSize, lowQuarters));
    high = CRect::Clamped(high + shift(oldSize, newSize, highQuarters));
}

} // namespace

CRect boundFrame(const CRect &frame, std::uint32_t binding, std::int32_t oldWidth, std::int32_t oldHeight,
                 std::int32_t newWidth, std::int32_t newHeight)
{
    const auto has = [&](std::uint32_t bit) { return (binding & bit) != 0; };
    CRect result = frame;
    bind(result.left, result.right, {has(kBind_XSizeable), has(kBind_XCenter), has(kBind_Left), has(kBind_Right)},
         oldWidth, newWidth);
    bind(result.top, result.bottom, {has(kBind_YSizeable), has(kBind_YCenter), has(kBind_Top), has(kBind_Bottom)},
         oldHeight, newHeight);
    return result;
}

} // namespace Sarnik
