#include "framework/controls/tools/tool.h"

#include "framework/icons/iconCursor.h"
#include "framework/views/application.h"
#include "framework/views/window.h"

namespace Sarnik
{

void CTool::Detach(CToolSet &set)
{
    if (toolSet == &set)
        toolSet = nullptr;
}

CTool &CTool::Resolved(CMouseEvent &event)
{
    constexpr int most = 8; // two that pass an event to each other come to an end
    CTool *serving = this;
    for (int i = 0; i < most; ++i)
    {
        CTool *const other = serving->ResolveTool(event);
        if (other == nullptr || other == serving)
            break;
        serving = other;
    }
    return *serving;
}

bool CTool::Down(CView &view, const CMouseEvent &event)
{
    CMouseEvent copy = event;
    CTool &serving = Resolved(copy);
    return copy.clicks > 1 ? serving.MouseClicks(view, copy) : serving.MouseDown(view, copy);
}

Platform::cursor CTool::CursorAt(CView &view, CPoint at)
{
    const CWindow *const window = view.Window();
    if (window == nullptr || !window->IsOpen())
        return {};
    CMouseEvent event;
    event.at = at;
    event.inWindow = view.ToWindow(at);
    event.modifiers = CApplication::Current()->Display().modifiers();
    CTool &serving = Resolved(event);
    const bool inside = toCanvas(view.Bounds()).contains(at);
    return CIconCursor(inside ? serving.UpdateCursor(view, event) : serving.UpdateCursorOutside(view, event),
                       window->Screen()->scale());
}

} // namespace Sarnik
