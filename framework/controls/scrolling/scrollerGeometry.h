#pragma once

#include "framework/layout/viewBuilder.h"
#include "framework/pixels/rect.h"

#include <cstdint>

namespace Sarnik
{

/// The bits of scroller_attributes, as layouts write them.
enum EScrollerAttributes : std::uint32_t
{
    kScroller_NoControls = 0,
    kScroller_XBar = 1,
    kScroller_YBar = 2,
    kScroller_SizeBox = 4, ///< keeps the corner at the bottom right free, also where there is one bar only
    kScroller_WellFrame = 8,
    kScroller_AutoHideScrollBars = 16 ///< a bar with nothing to scroll is not there
};

/// The parts of a scroller, each the kInterior_... number by which a layout's child names it.
enum EScrollerInterior : std::int32_t
{
    kInterior_ScrollerPane = 0,
    kInterior_ScrollerGapLeft = 5, ///< to the left of the horizontal bar
    kInterior_ScrollerGapTop = 6,  ///< above the vertical bar
    kInterior_ScrollerGapRight = 7,
    kInterior_ScrollerGapBottom = 8
};

/// Where the parts of a scroller lie, in its own coordinates. What is not there is empty; no two overlap.
struct CScrollerGeometry
{
    CRect frame; ///< of the well: around everything, less the room for the focus ring
    CRect well;  ///< where the content is seen
    CRect xBar, yBar, corner;
    CRect gapLeft, gapTop, gapRight, gapBottom;

    struct gaps
    {
        std::int32_t left = 0, top = 0, right = 0, bottom = 0;
    };
    /// content: as large as the content wants to be for a well of a size; asked up to three times, since a bar takes
    /// room from the well.
    template <class Content>
    static CScrollerGeometry For(CLayoutSize room, std::uint32_t attributes, std::int32_t barThickness, const gaps &gap,
                                 Content content)
    {
        bool x = (attributes & kScroller_XBar) != 0, y = (attributes & kScroller_YBar) != 0;
        if ((attributes & kScroller_AutoHideScrollBars) == 0)
            return Arrange(room, attributes, barThickness, gap, x, y);
        const bool mayX = x, mayY = y;
        x = y = false;
        CScrollerGeometry g;
        // A bar that has come stays: otherwise two might take turns.
        for (int i = 0; i < 3; ++i)
        {
            g = Arrange(room, attributes, barThickness, gap, x, y);
            const CLayoutSize seen{static_cast<std::int32_t>(g.well.Width()),
                                   static_cast<std::int32_t>(g.well.Height())};
            const CLayoutSize wanted = content(seen);
            const bool moreX = mayX && !x && wanted.width > seen.width;
            const bool moreY = mayY && !y && wanted.height > seen.height;
            if (!moreX && !moreY)
                break;
            x = x || moreX;
            y = y || moreY;
        }
        return g;
    }

private:
    static CScrollerGeometry Arrange(CLayoutSize room, std::uint32_t attributes, std::int32_t barThickness,
                                     const gaps &gap, bool x, bool y);
};

} // namespace Sarnik
