#pragma once

#include "framework/layout/wyraProperty.h"

#include <cstdint>

namespace Sarnik
{

enum class CPlacement
{
    Column = 0,
    Row = 1,
    Offscreen = 2 ///< children lie on top of each other
};

/// Along either axis; Start is left or top, End is right or bottom.
enum class CAlignment
{
    Unset = 0,
    Fill = 1,
    Center = 2,
    Proportional = 3, ///< takes its part of a free room as Center does
    Start = 4,
    End = 5
};

/// Four sides, in pixels.
struct CSides
{
    std::int64_t left = 0, top = 0, right = 0, bottom = 0;
};

/// The geometry of one view: what the layout says of it, its measured size, its place. In pixels of scale 1. Integers
/// are 64 bits wide because a layout may add up any number of views of any size.
struct CLayoutFrame
{
    /// Properties beyond +-largest are cut to it: wide enough for any screen, small enough for any sum.
    static constexpr std::int32_t largest = 1'000'000;

    CPlacement placement = CPlacement::Column;
    CAlignment horizontal = CAlignment::Unset, vertical = CAlignment::Unset;
    CAlignment childHorizontal = CAlignment::Unset, childVertical = CAlignment::Unset;
    std::int64_t spacing = 0;
    CSides margin, outset;
    std::int64_t leftOffset = 0, topOffset = 0;
    std::int64_t leastWidth = 0, leastHeight = 0;
    std::int64_t maxHeight = 0; ///< 0 is none
    std::int64_t labelWidth = 0;
    bool reverse = false;

    /// Measured, then as placed; left and top from the parent's cell, outsets left out on both sides.
    std::int64_t left = 0, top = 0, width = 0, height = 0;

    /// A height within the upper limit.
    std::int64_t Limited(std::int64_t aHeight) const
    {
        return maxHeight > 0 && aHeight > maxHeight ? maxHeight : aHeight;
    }
};

/// The geometry that a view's properties ask for; measured and placed fields are 0. parent: null for the outermost
/// view. leastWidth and leastHeight are those of the properties, and -1 where the class's natural size is meant.
/// Alignments are resolved: never Unset but for those of children.
CLayoutFrame ReadLayoutFrame(const CWyraVariablePropertyList &properties, const CLayoutFrame *parent);

} // namespace Sarnik
