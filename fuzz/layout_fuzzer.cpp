#include "framework/layout/layoutError.h"
#include "framework/layout/wyraGenerator.h"
#include "fuzz/fuzzing.h"

#include <memory>
#include <optional>
#include <vector>

using namespace Sarnik;
using Fuzzing::require;

namespace
{

/// Every character is 7 by 15.
struct evenMeasure final : CTextMeasure
{
    CLayoutSize Measure(std::string_view text, std::int32_t) const override
    {
        return {static_cast<std::int32_t>(text.size()) * 7, 15};
    }
};

/// Reads what real classes read of each kind, and counts the views of a tree.
struct plainView final : CLayoutView
{
    void TakeLayout(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override
    {
        require(placement.frame.left <= placement.frame.right && placement.frame.top <= placement.frame.bottom);
        // What is answered lives in the layout's own text; the address sanitizer watches over it.
        require(properties.LocalisedText("text").size() <= CWyraLimits::bytes);
        require(properties.Number("slider_minimum", 1) == properties.Number("slider_minimum", 1));
    }
    void AdoptChild(std::unique_ptr<CLayoutView> child, std::int32_t) override
    {
        views += static_cast<plainView &>(*child).views;
    }

    int views = 1;
};

struct plainBuilder final : CViewBuilderBase
{
    using CViewBuilderBase::CViewBuilderBase;

    std::optional<std::int32_t> DefaultOf(std::string_view property) const override
    {
        return property == "margin" ? std::optional(3) : std::nullopt;
    }
    CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure) const override
    {
        return measure.Measure(properties.LocalisedText("text"), properties.Integer("text_font"));
    }
    std::unique_ptr<CLayoutView> Create() const override { return std::make_unique<plainView>(); }
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    static CViewBuilderMap map;
    static const plainBuilder pane("CPane", map), text("CStaticText", map), slider("CEditSlider", map),
        window("PDialog", map);
    static const evenMeasure measure;

    CWyraGenerator generator(measure, map, [](std::string_view, const CWyraPropertyList &arguments) {
        return CExpressionValue{static_cast<std::int32_t>(arguments.Count()), {}};
    });
    try
    {
        generator.Parse({reinterpret_cast<const char *>(data), size});
    }
    catch (const CLayoutError &e)
    {
        require(e.Line() <= size + 1);
        return 0;
    }
    plainView root;
    generator.GenerateViews(root);
    require(root.views <= CWyraLimits::views);
    return 0;
}
