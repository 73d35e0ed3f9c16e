#pragma once

#include "framework/layout/generator.h"
#include "framework/layout/wyraParser.h"

#include <functional>
#include <memory>
#include <string_view>

namespace Sarnik
{

/// From a layout's text to views:
///
///     CWyraGenerator generator(measure);
///     generator.Parse(text);
///     generator.GenerateViews(window);
///
/// A class without a builder takes its place in the layout, but neither it nor what lies in it is made. The thread of
/// the views.
class CWyraGenerator final : public CGenerator
{
public:
    /// Answers calls of functions that the language does not have; the answer's text is copied.
    using externalFunction = std::function<CExpressionValue(std::string_view name, const CWyraPropertyList &arguments)>;

    /// The measure and the builders outlive the generator. Without a function every external call is undefined.
    explicit CWyraGenerator(const CTextMeasure &textMeasure,
                            const CViewBuilderMap &viewBuilders = CViewBuilderMap::Global(),
                            externalFunction function = {});

    /// Replaces what was parsed before, also when it throws CLayoutError. The text need not outlive the call.
    void Parse(std::string_view text, CWyraListener *listener = nullptr);

    CExpressionValue External(std::string_view name, const CWyraPropertyList &arguments) override;
    /// Both throw CLayoutError before a successful Parse. The outermost view is as large as it has been measured,
    /// unless its window_size_x or window_size_y is above 0.
    CLayoutSize MeasureViews() override;
    void GenerateViews(CLayoutView &window) override;

private:
    CExpressViewScope &Measured();

    const CTextMeasure &measure;
    const CViewBuilderMap &builders;
    externalFunction external;
    std::unique_ptr<CWyraDefinition> definition;
    bool measured = false;
};

} // namespace Sarnik
