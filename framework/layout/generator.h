#pragma once

#include "framework/layout/viewBuilder.h"
#include "framework/layout/wyraProperty.h"

#include <string_view>

namespace Sarnik
{

/// The back end of the layout language: what the parser asks, and what becomes of a parsed layout.
class CGenerator
{
public:
    /// The value of a call `name(property: value, ...)` that is none of the language's own functions.
    virtual CExpressionValue External(std::string_view name, const CWyraPropertyList &arguments) = 0;

    /// The size that the layout asks for; makes no view.
    virtual CLayoutSize MeasureViews() = 0;
    /// Gives the outermost view's placement and properties to the window, and builds all others below it.
    virtual void GenerateViews(CLayoutView &window) = 0;

protected:
    ~CGenerator() = default;
};

} // namespace Sarnik
