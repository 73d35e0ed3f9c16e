#include "framework/layout/wyraGenerator.h"

#include "framework/layout/layoutError.h"
#include "framework/layout/viewGeometry.h"

#include <utility>

namespace Sarnik
{
namespace
{

/// The rectangle of a cell and what lies over its edges, from the left top corner of the parent's rectangle.
CRect frameOf(const CLayoutFrame &frame, const CSides &parentOutset)
{
    const std::int64_t left = frame.left - frame.outset.left + parentOutset.left;
    const std::int64_t top = frame.top - frame.outset.top + parentOutset.top;
    return {CRect::Clamped(left), CRect::Clamped(top),
            CRect::Clamped(left + frame.width + frame.outset.left + frame.outset.right),
            CRect::Clamped(top + frame.height + frame.outset.top + frame.outset.bottom)};
}

CLayoutPlacement placementOf(const CExpressViewScope &view, const CRect &rectangle)
{
    return {rectangle, CRect::Clamped(view.frame.labelWidth)};
}

void build(const CExpressViewScope &view, const CSides &parentOutset, CLayoutView &parent)
{
    if (view.builder == nullptr)
        return;
    auto made = view.builder->Create();
    if (!made)
        throw CLayoutError("view.get() != NULL", "no view was made of class " + view.builder->ClassName());
    const CWyraVariablePropertyList properties = view.Properties();
    made->TakeLayout(placementOf(view, frameOf(view.frame, parentOutset)), properties);
    for (const auto &child : view.children)
        build(*child, view.frame.outset, *made);
    parent.AdoptChild(std::move(made), properties.Integer("frame_interior"));
}

} // namespace

CWyraGenerator::CWyraGenerator(const CTextMeasure &textMeasure, const CViewBuilderMap &viewBuilders,
                               externalFunction function)
    : measure(textMeasure), builders(viewBuilders), external(std::move(function))
{
}

void CWyraGenerator::Parse(std::string_view text, CWyraListener *listener)
{
    definition.reset();
    measured = false;
    definition = ParseLayout(text, this, listener);
}

CExpressionValue CWyraGenerator::External(std::string_view name, const CWyraPropertyList &arguments)
{
    return external ? external(name, arguments) : CExpressionValue{};
}

CExpressViewScope &CWyraGenerator::Measured()
{
    if (!definition)
        throw CLayoutError("viewProxyList.get() != NULL", "no layout has been parsed");
    CExpressViewScope &root = definition->Root();
    if (!measured)
    {
        PrepareFrames(root, nullptr, builders, measure);
        MeasureFrames(root);
        const CWyraVariablePropertyList properties = root.Properties();
        if (const std::int32_t width = properties.Integer("window_size_x"); width > 0)
            root.frame.width = width;
        if (const std::int32_t height = properties.Integer("window_size_y"); height > 0)
            root.frame.height = height;
        PlaceFrames(root);
        measured = true;
    }
    return root;
}

CLayoutSize CWyraGenerator::MeasureViews()
{
    const CLayoutFrame &frame = Measured().frame;
    return {CRect::Clamped(frame.width), CRect::Clamped(frame.height)};
}

void CWyraGenerator::GenerateViews(CLayoutView &window)
{
    const CExpressViewScope &root = Measured();
    const CLayoutSize size = MeasureViews();
    window.TakeLayout(placementOf(root, {0, 0, size.width, size.height}), root.Properties());
    for (const auto &child : root.children)
        build(*child, {}, window);
}

} // namespace Sarnik
