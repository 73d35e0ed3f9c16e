#pragma once

#include "framework/layout/viewBuilder.h"
#include "framework/layout/wyraProperty.h"
#include "framework/views/view.h"

#include <cstdint>
#include <optional>
#include <string_view>

namespace Sarnik
{

/// A view that a layout may name. The class "CPane" of layouts is this one itself: an empty room for others.
///
/// A class below it that layouts name
///   - is built without arguments,
///   - overrides ReadProperties for its own properties, and calls its base class's first,
///   - hides LayoutDefault and NaturalSize where it has defaults or a size of its own,
///   - has a row in controlBuilders.cpp.
class CLayoutPane : public CPane, public CLayoutView
{
public:
    explicit CLayoutPane(const CRect &viewFrame = {}, std::uint32_t viewOptions = 0) : CPane(viewFrame, viewOptions) {}

    /// A default of the class; none by default.
    static std::optional<std::int32_t> LayoutDefault(std::string_view) { return std::nullopt; }
    /// The size without children; nothing by default.
    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &) { return {}; }

    /// Frame, id, options, binding, tips and help; then ReadProperties.
    void TakeLayout(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) final;
    /// Puts the child in front of the others. Throws CLayoutError for one that is no view.
    void AdoptChild(std::unique_ptr<CLayoutView> child, std::int32_t interior) override;
    /// All views of the layout stand in their window.
    virtual void LayoutDone() {}

protected:
    virtual void ReadProperties(const CLayoutPlacement &, const CWyraVariablePropertyList &) {}
    /// A built child, to be added wherever the class wants it.
    virtual void TakeChild(std::unique_ptr<CView> child, std::int32_t) { Add(std::move(child)); }
};

/// The view that a layout's view is; throws CLayoutError where it is none.
std::unique_ptr<CView> viewOf(std::unique_ptr<CLayoutView> built);

} // namespace Sarnik
