#include "framework/controls/layoutPane.h"

#include "framework/layout/layoutError.h"
#include "framework/layout/layoutFlags.h"

#include <string>
#include <utility>

namespace Sarnik
{

void CLayoutPane::TakeLayout(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    SetFrame(placement.frame);
    if (const std::string_view name = properties.Text("view_id"); !name.empty())
        SetId(CObjID(name));

    const auto options =
        static_cast<std::uint32_t>(ReadFlags(properties, "view_options", static_cast<std::int32_t>(Options())));
    SetOptions(options);
    Show((options & kView_Invisible) == 0);
    Enable((options & kView_Disabled) == 0);
    SetBinding(static_cast<std::uint32_t>(properties.Integer("view_binding")));

    const auto text = [&](std::string_view enabled, std::string_view otherwise) {
        const std::string_view own = properties.Text(enabled);
        return std::string(own.empty() ? properties.Text(otherwise) : own);
    };
    SetTip(text("view_tip_enabled", "view_tip"), text("view_tip_disabled", "view_tip"));
    SetHelp(text("view_help_enabled", "view_help"), text("view_help_disabled", "view_help"));
    ReadProperties(placement, properties);
}

void CLayoutPane::AdoptChild(std::unique_ptr<CLayoutView> child, std::int32_t interior)
{
    TakeChild(viewOf(std::move(child)), interior);
}

std::unique_ptr<CView> viewOf(std::unique_ptr<CLayoutView> built)
{
    auto *const view = dynamic_cast<CView *>(built.get());
    if (view == nullptr)
        throw CLayoutError("view.get() != NULL", "a window cannot lie within a view");
    built.release();
    return std::unique_ptr<CView>(view);
}

} // namespace Sarnik
