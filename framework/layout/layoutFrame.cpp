#include "framework/layout/layoutFrame.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

using names = std::initializer_list<std::string_view>;

std::int64_t pixels(const CWyraVariablePropertyList &properties, names named, std::int32_t otherwise = 0)
{
    properties.ReadAny(named, &otherwise);
    return std::clamp(otherwise, -CLayoutFrame::largest, CLayoutFrame::largest);
}

CAlignment asAlignment(std::int32_t value)
{
    return value >= 1 && value <= 5 ? static_cast<CAlignment>(value) : CAlignment::Unset;
}

/// Head, then what the parent asks of its children, then class and variables; then the rule of the parent's placement.
CAlignment alignment(const CWyraVariablePropertyList &properties, std::string_view name, CAlignment ofParent,
                     bool alongArrangement)
{
    CAlignment found = CAlignment::Unset;
    if (const CExpressionValue *const own = properties.InHead(name))
        found = asAlignment(own->integer);
    if (found == CAlignment::Unset)
        found = ofParent;
    if (found == CAlignment::Unset)
        found = asAlignment(properties.Integer(name));
    if (found == CAlignment::Unset)
        found = alongArrangement ? CAlignment::Start : CAlignment::Center;
    return found;
}

/// A least size is asked of the head alone: the class has its natural size instead, which a variable does not replace.
std::int64_t leastSize(const CWyraVariablePropertyList &properties, std::string_view name)
{
    const CExpressionValue *const own = properties.InHead(name);
    std::int32_t size = 0;
    if (own != nullptr && own->Defined())
        size = own->integer;
    else if (!properties.OfClass(name, &size))
        return -1;
    return std::clamp(size, 0, CLayoutFrame::largest);
}

} // namespace

CLayoutFrame ReadLayoutFrame(const CWyraVariablePropertyList &properties, const CLayoutFrame *parent)
{
    CLayoutFrame frame;
    const std::int32_t placement = properties.Integer("placement");
    frame.placement = placement >= 0 && placement <= 2 ? static_cast<CPlacement>(placement) : CPlacement::Column;

    const bool inRow = parent != nullptr && parent->placement == CPlacement::Row;
    const auto ofParent = [parent](CAlignment CLayoutFrame::*which) {
        return parent != nullptr ? parent->*which : CAlignment::Unset;
    };
    frame.horizontal = alignment(properties, "horizontal", ofParent(&CLayoutFrame::childHorizontal), inRow);
    frame.vertical = alignment(properties, "vertical", ofParent(&CLayoutFrame::childVertical), !inRow);
    frame.childHorizontal = asAlignment(properties.Integer("child_horizontal"));
    frame.childVertical = asAlignment(properties.Integer("child_vertical"));
    if (frame.childHorizontal == CAlignment::Unset && frame.placement == CPlacement::Offscreen)
        frame.childHorizontal = CAlignment::Fill;

    const CExpressionValue *const space = properties.InScope("gSpace");
    frame.spacing = pixels(properties, {"spacing"}, space != nullptr && space->Defined() ? space->integer : 0);

    frame.margin.left =
        pixels(properties, {"margin_left", "cushion_left", "margin_width", "cushion_x", "margin", "cushion"});
    frame.margin.right =
        pixels(properties, {"margin_right", "cushion_right", "margin_width", "cushion_x", "margin", "cushion"});
    frame.margin.top =
        pixels(properties, {"margin_top", "cushion_top", "margin_height", "cushion_y", "margin", "cushion"});
    frame.margin.bottom =
        pixels(properties, {"margin_bottom", "cushion_bottom", "margin_height", "cushion_y", "margin", "cushion"});

    frame.outset.left = pixels(properties, {"left_outset", "outset_left", "width_outset", "outset_width", "outset"});
    frame.outset.right = pixels(properties, {"right_outset", "outset_right", "width_outset", "outset_width", "outset"});
    frame.outset.top = pixels(properties, {"top_outset", "outset_top", "height_outset", "outset_height", "outset"});
    frame.outset.bottom =
        pixels(properties, {"bottom_outset", "outset_bottom", "height_outset", "outset_height", "outset"});

    frame.leftOffset = pixels(properties, {"left_offset"});
    frame.topOffset = pixels(properties, {"top_offset"});
    frame.leastWidth = leastSize(properties, "width");
    frame.leastHeight = leastSize(properties, "height");
    frame.maxHeight = std::max<std::int64_t>(0, pixels(properties, {"max_height"}));
    frame.labelWidth = std::max<std::int64_t>(0, pixels(properties, {"label_width"}));
    frame.reverse = properties.Boolean("reverse");
    return frame;
}

} // namespace Sarnik
