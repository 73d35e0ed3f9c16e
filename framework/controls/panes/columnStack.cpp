#include "framework/controls/panes/columnStack.h"

#include "framework/views/view.h"

#include <algorithm>

namespace Sarnik
{

void stackColumn(CContext &column, std::int32_t top, std::int32_t spacing)
{
    const auto shown = [](const CView &view) { return !view.HasOption(kView_Invisible); };
    const auto grows = [](const CView &view) { return (view.Binding() & kBind_YSizeable) != 0; };

    std::int64_t free = std::int64_t{column.Bounds().bottom} - 2 * std::int64_t{top} + spacing, growing = 0;
    for (const auto &child : column.Children())
        if (shown(*child))
        {
            free -= spacing + (grows(*child) ? 0 : child->Frame().Height());
            growing += grows(*child);
        }
    std::int64_t at = top;
    for (const auto &child : column.Children())
    {
        if (!shown(*child))
            continue;
        std::int64_t height = child->Frame().Height();
        if (grows(*child))
        {
            // What the division leaves goes to the last ones.
            height = std::max<std::int64_t>(0, free / growing);
            free -= height;
            --growing;
        }
        CRect frame = child->Frame();
        frame.top = CRect::Clamped(at);
        frame.bottom = CRect::Clamped(at + height);
        child->SetFrame(frame);
        at += height + spacing;
    }
}

} // namespace Sarnik
