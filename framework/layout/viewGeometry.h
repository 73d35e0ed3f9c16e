#pragma once

#include "framework/layout/viewBuilder.h"
#include "framework/layout/viewScope.h"

namespace Sarnik
{

/// Looks up the builders of a view and all below it and reads their frames; reversed lists of children are turned
/// round. Once per parsed layout.
void PrepareFrames(CExpressViewScope &view, const CLayoutFrame *parent, const CViewBuilderMap &builders,
                   const CTextMeasure &measure);

/// Bottom up: the size that each view needs.
void MeasureFrames(CExpressViewScope &view);

/// Top down, from the size that the view has got: where its children lie, and how large they become. A room that is too
/// small for its children is never divided; they reach over its end.
void PlaceFrames(CExpressViewScope &view);

} // namespace Sarnik
