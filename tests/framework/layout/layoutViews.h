#pragma once

#include "framework/layout/viewBuilder.h"
#include "framework/layout/wyraGenerator.h"

#include <deque>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace Sarnik
{

/// A view that remembers what a layout gave it.
class noteView final : public CLayoutView
{
public:
    void TakeLayout(const CLayoutPlacement &taken, const CWyraVariablePropertyList &properties) override
    {
        placement = taken;
        id = properties.Text("view_id");
        text = properties.LocalisedText("text");
        font = properties.Integer("text_font", -1);
    }
    void AdoptChild(std::unique_ptr<CLayoutView> child, std::int32_t interior) override
    {
        children.emplace_back(static_cast<noteView *>(child.release()));
        interiors.push_back(interior);
    }

    /// This view or one in it; null without one.
    const noteView *Find(std::string_view wanted) const
    {
        if (id == wanted)
            return this;
        for (const auto &child : children)
            if (const noteView *const found = child->Find(wanted))
                return found;
        return nullptr;
    }

    CLayoutPlacement placement;
    std::string id, text;
    std::int32_t font = -1;
    std::vector<std::unique_ptr<noteView>> children;
    std::vector<std::int32_t> interiors;
};

/// Any class: of a fixed natural size, or of the size of its text. A class named "Framed" has a margin of 5.
class noteBuilder final : public CViewBuilderBase
{
public:
    noteBuilder(std::string_view name, CViewBuilderMap &map, std::optional<CLayoutSize> fixed = {})
        : CViewBuilderBase(name, map), size(fixed)
    {
    }

    std::optional<std::int32_t> DefaultOf(std::string_view property) const override
    {
        return ClassName() == "Framed" && property == "margin" ? std::optional(5) : std::nullopt;
    }
    CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure) const override
    {
        return size ? *size : measure.Measure(properties.LocalisedText("text"), properties.Integer("text_font"));
    }
    std::unique_ptr<CLayoutView> Create() const override { return std::make_unique<noteView>(); }

private:
    std::optional<CLayoutSize> size;
};

/// 7 pixels a character; 15 high, with font kFont_UILarge 20.
class evenMeasure final : public CTextMeasure
{
public:
    CLayoutSize Measure(std::string_view text, std::int32_t font) const override
    {
        return {static_cast<std::int32_t>(text.size()) * 7, text.empty() ? 0 : font == 6 ? 20 : 15};
    }
};

/// The classes of the tests: Box is 10 x 10, Text is as large as its text, Pane and Framed are as large as what they
/// hold; `more` are like Text.
struct layoutBench
{
    explicit layoutBench(const std::vector<std::string> &more = {})
    {
        builders.emplace_back("Box", map, CLayoutSize{10, 10});
        builders.emplace_back("Pane", map, CLayoutSize{});
        builders.emplace_back("Framed", map, CLayoutSize{});
        builders.emplace_back("Text", map);
        for (const std::string &name : more)
            builders.emplace_back(name, map);
    }

    std::unique_ptr<noteView> Build(std::string_view text) const
    {
        CWyraGenerator generator(measure, map);
        generator.Parse(text);
        auto window = std::make_unique<noteView>();
        generator.GenerateViews(*window);
        return window;
    }

    CViewBuilderMap map;
    std::deque<noteBuilder> builders;
    evenMeasure measure;
};

} // namespace Sarnik
