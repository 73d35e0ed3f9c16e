#include "framework/controls/dialog.h"

#include "framework/controls/controlBuilders.h"
#include "framework/controls/drawTools.h"
#include "framework/controls/layoutPane.h"
#include "framework/icons/programIcons.h"
#include "framework/layout/layoutFlags.h"
#include "framework/layout/layoutResources.h"
#include "framework/layout/wyraGenerator.h"

#include <string>

namespace Sarnik
{
namespace
{

void tellDone(const CContext &context)
{
    for (const auto &child : context.Children())
    {
        tellDone(*child);
        if (auto *const pane = dynamic_cast<CLayoutPane *>(child.get()))
            pane->LayoutDone();
    }
}

} // namespace

void CDialog::LoadLayout(std::string_view resourceName)
{
    LoadText(LayoutResource(resourceName));
}

void CDialog::LoadText(std::string_view layout)
{
    if (!Children().empty())
        return;
    enterControlBuilders();
    CProgramIcons::Get(); // from now on names of icons mean something
    const CDrawMeasure measure;
    CWyraGenerator generator(measure);
    generator.Parse(layout);
    generator.GenerateViews(*this);
    tellDone(*this);
    Loaded();
}

void CDialog::TakeLayout(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    if (const std::string_view name = properties.Text("view_id"); !name.empty())
        SetId(CObjID(name));
    CWindowSettings with = Settings();
    if (const std::string_view title = properties.Text("window_title"); !title.empty())
        with.title = title;
    with.background = CDrawTools::Colours().window;
    with.features =
        static_cast<std::uint32_t>(ReadFlags(properties, "window_features", static_cast<std::int32_t>(with.features)));
    with.frame = placement.frame.Moved(properties.Integer("window_position_x", with.frame.left),
                                       properties.Integer("window_position_y", with.frame.top));
    SetSettings(std::move(with));
}

void CDialog::AdoptChild(std::unique_ptr<CLayoutView> child, std::int32_t)
{
    Add(viewOf(std::move(child)));
}

void CDialog::Loaded()
{
    MoveFocus(true);
}

} // namespace Sarnik
