#include "framework/layout/viewGeometry.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

using pixels = std::int64_t;
using children = std::vector<std::unique_ptr<CExpressViewScope>>;

/// One of the two axes, so that each rule is written once.
struct axis
{
    pixels CLayoutFrame::*start, CLayoutFrame::*size, CLayoutFrame::*least, CLayoutFrame::*offset;
    CAlignment CLayoutFrame::*alignment;
    pixels CSides::*before, CSides::*after;

    pixels Margins(const CLayoutFrame &frame) const { return frame.margin.*before + frame.margin.*after; }
};

constexpr axis across = {&CLayoutFrame::left,
                         &CLayoutFrame::width,
                         &CLayoutFrame::leastWidth,
                         &CLayoutFrame::leftOffset,
                         &CLayoutFrame::horizontal,
                         &CSides::left,
                         &CSides::right};
constexpr axis down = {&CLayoutFrame::top,       &CLayoutFrame::height,   &CLayoutFrame::leastHeight,
                       &CLayoutFrame::topOffset, &CLayoutFrame::vertical, &CSides::top,
                       &CSides::bottom};

bool sharesRoom(CAlignment alignment)
{
    return alignment == CAlignment::Fill || alignment == CAlignment::Center || alignment == CAlignment::Proportional;
}

/// The room that a view takes across the arrangement. What lies at the start or fills moves with its offset.
pixels extent(const CLayoutFrame &frame, const axis &a)
{
    const CAlignment alignment = frame.*a.alignment;
    const bool moves = alignment == CAlignment::Start || alignment == CAlignment::Fill;
    return frame.*a.size + (moves ? frame.*a.offset : 0);
}

pixels largestExtent(const children &views, const axis &a)
{
    pixels largest = 0;
    for (const auto &view : views)
        largest = std::max(largest, extent(view->frame, a));
    return largest;
}

pixels arrangedSize(const children &views, const axis &a, pixels spacing)
{
    pixels sum = views.empty() ? 0 : spacing * (static_cast<pixels>(views.size()) - 1);
    for (const auto &view : views)
        sum += view->frame.*a.size;
    return sum;
}

void growOutset(CLayoutFrame &frame, const CLayoutFrame &child, pixels CSides::*side)
{
    frame.outset.*side = std::max(frame.outset.*side, child.outset.*side - frame.margin.*side);
}

/// A view reaches over its cell where its children reach over its margins. Along the arrangement only the first and
/// the last child lie at an edge; at the far edge across it any of them may.
void growOutsets(CLayoutFrame &frame, const children &views)
{
    if (views.empty())
        return;
    const bool row = frame.placement == CPlacement::Row;
    const axis &along = row ? across : down;
    const axis &other = row ? down : across;
    const bool pile = frame.placement == CPlacement::Offscreen;
    for (const auto &view : views)
    {
        const bool first = pile || view == views.front(), last = pile || view == views.back();
        if (first)
        {
            growOutset(frame, view->frame, along.before);
            growOutset(frame, view->frame, other.before);
        }
        if (last)
            growOutset(frame, view->frame, along.after);
        growOutset(frame, view->frame, other.after);
    }
}

/// The labels in a column stand in a column of their own, as wide as the widest; a view with a narrower one grows by
/// the difference.
void alignLabels(const children &views)
{
    pixels widest = 0;
    for (const auto &view : views)
        widest = std::max(widest, view->frame.labelWidth);
    for (const auto &view : views)
        if (CLayoutFrame &frame = view->frame; frame.labelWidth > 0)
        {
            frame.width += widest - frame.labelWidth;
            frame.labelWidth = widest;
        }
}

/// Across the arrangement: a child in the whole room of its parent.
void placeAcross(const CLayoutFrame &parent, CLayoutFrame &child, const axis &a)
{
    const pixels room = parent.*a.size - a.Margins(parent);
    const pixels offset = child.*a.offset;
    pixels start = 0;
    switch (child.*a.alignment)
    {
    case CAlignment::Fill:
        child.*a.size = std::max<pixels>(0, room - std::max<pixels>(0, offset));
        child.height = child.Limited(child.height);
        break;
    case CAlignment::Center:
    case CAlignment::Proportional:
        start = std::max<pixels>(0, (room - child.*a.size) / 2);
        break;
    case CAlignment::End:
        start = std::max<pixels>(0, room - child.*a.size);
        break;
    case CAlignment::Start:
    case CAlignment::Unset:
        break;
    }
    child.*a.start = parent.margin.*a.before + start + offset;
}

/// Along the arrangement: one after the other, a free room divided equally among those that take it. What the division
/// leaves, and all of it where nobody takes it, stays behind the last.
void placeAlong(const CLayoutFrame &parent, const children &views, const axis &a)
{
    const pixels free = parent.*a.size - a.Margins(parent) - arrangedSize(views, a, parent.spacing);
    const auto takers = std::count_if(views.begin(), views.end(),
                                      [&a](const auto &view) { return sharesRoom(view->frame.*a.alignment); });
    const pixels share = takers > 0 && free > 0 ? free / takers : 0;
    pixels at = parent.margin.*a.before;
    for (const auto &view : views)
    {
        CLayoutFrame &child = view->frame;
        const pixels cell = child.*a.size + (sharesRoom(child.*a.alignment) ? share : 0);
        if (child.*a.alignment == CAlignment::Fill)
        {
            child.*a.size = cell;
            child.height = child.Limited(child.height);
            child.*a.start = at;
        }
        else
            child.*a.start = at + (cell - child.*a.size) / 2;
        child.*a.start += child.*a.offset;
        at += cell + parent.spacing;
    }
}

} // namespace

void PrepareFrames(CExpressViewScope &view, const CLayoutFrame *parent, const CViewBuilderMap &builders,
                   const CTextMeasure &measure)
{
    view.builder = builders.Find(view.className);
    const CWyraVariablePropertyList properties = view.Properties();
    CLayoutFrame &frame = view.frame;
    frame = ReadLayoutFrame(properties, parent);
    if (view.builder != nullptr && (frame.leastWidth < 0 || frame.leastHeight < 0))
    {
        const CLayoutSize natural = view.builder->NaturalSize(properties, measure);
        if (frame.leastWidth < 0)
            frame.leastWidth = std::clamp(natural.width, 0, CLayoutFrame::largest);
        if (frame.leastHeight < 0)
            frame.leastHeight = std::clamp(natural.height, 0, CLayoutFrame::largest);
    }
    if (frame.reverse)
        std::reverse(view.children.begin(), view.children.end());
    for (const auto &child : view.children)
        PrepareFrames(*child, &frame, builders, measure);
}

void MeasureFrames(CExpressViewScope &view)
{
    for (const auto &child : view.children)
        MeasureFrames(*child);
    CLayoutFrame &frame = view.frame;
    if (frame.placement == CPlacement::Column)
        alignLabels(view.children);
    for (const axis &a : {across, down})
    {
        const bool along = frame.placement == (&CLayoutFrame::width == a.size ? CPlacement::Row : CPlacement::Column);
        const pixels content = along ? arrangedSize(view.children, a, frame.spacing) : largestExtent(view.children, a);
        frame.*a.size = std::max({content + a.Margins(frame), frame.*a.least, pixels{0}});
    }
    frame.height = frame.Limited(frame.height);
    growOutsets(frame, view.children);
}

void PlaceFrames(CExpressViewScope &view)
{
    const CLayoutFrame &frame = view.frame;
    const bool row = frame.placement == CPlacement::Row;
    if (frame.placement != CPlacement::Offscreen)
        placeAlong(frame, view.children, row ? across : down);
    for (const auto &child : view.children)
    {
        if (frame.placement == CPlacement::Offscreen || !row)
            placeAcross(frame, child->frame, across);
        if (frame.placement == CPlacement::Offscreen || row)
            placeAcross(frame, child->frame, down);
        PlaceFrames(*child);
    }
}

} // namespace Sarnik
