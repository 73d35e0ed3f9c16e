#include "framework/views/application.h"
#include "framework/views/view.h"
#include "framework/views/window.h"

#include <algorithm>

namespace Sarnik
{

void CWindow::InvalidateRect(const CRect &rect)
{
    const CRect inside = rect.Intersected(Bounds());
    if (inside.Empty())
        return;
    if (damage.Empty())
        damagedSince = CApplication::Now();
    damage.Add(inside);
}

bool CWindow::Paint()
{
    if (damage.Empty() || !IsVisible())
        return false;
    // What drawing itself marks waits for the next paint.
    const std::vector<CRect> parts = damage.Take();
    Platform::canvas canvas(screen->pixels(), screen->scale());
    const Platform::pixelRect all = screen->pixels().bounds();
    std::vector<Platform::pixelRect> pixels;
    for (const CRect &part : parts)
    {
        const Platform::pixelRect p = canvas.pixelsAround(toCanvas(part));
        pixels.push_back({std::max(p.left, all.left), std::max(p.top, all.top), std::min(p.right, all.right),
                          std::min(p.bottom, all.bottom)});
    }
    canvas.clipPixels(pixels);
    canvas.fillRectangle({-1e5, -1e5, 1e5, 1e5}, settings.background);
    DrawChildren(*this, canvas, parts, Bounds(), {});
    screen->present(pixels);
    return true;
}

/// Draws the children that can be seen within a clip, all in the window's coordinates; origin is the parent's.
void CWindow::DrawChildren(const CContext &of, Platform::canvas &canvas, std::span<const CRect> parts,
                           const CRect &clip, CPoint origin)
{
    // By index: drawing does not change the tree, and must not crash where somebody's does.
    for (std::size_t i = 0; i < of.Children().size(); ++i)
    {
        CView &view = *of.Children()[i];
        if (view.HasOption(kView_Invisible))
            continue;
        const auto dx = static_cast<std::int64_t>(origin.x), dy = static_cast<std::int64_t>(origin.y);
        const CRect frame = view.Frame().Moved(dx, dy);
        const CRect seen = frame.Intersected(clip);
        std::vector<CRect> own;
        CRect around;
        for (const CRect &part : parts)
            if (const CRect shared = part.Intersected(seen); !shared.Empty())
            {
                own.push_back(shared.Moved(-std::int64_t{frame.left}, -std::int64_t{frame.top}));
                around = joined(around, own.back());
            }
        if (own.empty())
            continue;
        if (!view.HasOption(kView_DrawParts))
            own.assign(1, around);

        canvas.save();
        canvas.clip(toCanvas(seen));
        canvas.translate(frame.left, frame.top);
        CPort port(canvas, own, around);
        canvas.save();
        view.Draw(port);
        canvas.restore();
        canvas.translate(-frame.left, -frame.top);
        DrawChildren(view, canvas, parts, seen, {static_cast<double>(frame.left), static_cast<double>(frame.top)});
        canvas.restore();
    }
}

} // namespace Sarnik
