#pragma once

#include "framework/layout/viewBuilder.h"
#include "framework/views/window.h"

#include <string_view>

namespace Sarnik
{

/// A window that a layout fills: the classes "CDialog" and "CWindow" of layouts. Interface thread.
///
///     CDialog dialog;
///     dialog.LoadLayout("PParamDialog.wyra");
///     if (dialog.RunModal(owner) == okButton) ...
class CDialog : public CWindow, public CLayoutView
{
public:
    explicit CDialog(CWindowSettings with = {}) : CWindow(std::move(with)) {}

    /// Builds the views of a layout among the program's resources. Does nothing to a dialog with views. Throws CError
    /// where there is no such layout, CLayoutError where its text is of no use.
    void LoadLayout(std::string_view resourceName);
    /// The same from a text.
    void LoadText(std::string_view layout);

    /// Id, title, features, position and size.
    void TakeLayout(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    void AdoptChild(std::unique_ptr<CLayoutView> child, std::int32_t interior) override;

    static std::optional<std::int32_t> LayoutDefault(std::string_view) { return std::nullopt; }
    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &) { return {}; }

protected:
    /// All views stand: the first of the tab order takes the focus.
    virtual void Loaded();
};

} // namespace Sarnik
