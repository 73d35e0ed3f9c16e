#pragma once

#include "framework/pixels/rect.h"
#include "platform/canvas/canvas.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <span>

namespace Sarnik
{

using CPoint = Platform::point;

inline Platform::rectangle toCanvas(const CRect &r)
{
    return {static_cast<double>(r.left), static_cast<double>(r.top), static_cast<double>(r.right),
            static_cast<double>(r.bottom)};
}

/// The whole units within.
inline CRect wholeWithin(const Platform::rectangle &r)
{
    const auto whole = [](double v) { return CRect::Clamped(static_cast<std::int64_t>(v)); };
    return {whole(std::ceil(r.left)), whole(std::ceil(r.top)), whole(std::floor(r.right)), whole(std::floor(r.bottom))};
}

/// What a view draws to: its own coordinates, clipped to what of it can be seen and has to be drawn.
class CPort
{
public:
    CPort(Platform::canvas &on, std::span<const CRect> damagedParts, const CRect &around)
        : canvas(on), parts(damagedParts), damage(around)
    {
    }

    Platform::canvas &Canvas() const { return canvas; }
    double Scale() const { return canvas.scale(); }
    /// Around everything that has to be drawn.
    const CRect &Damage() const { return damage; }
    /// The rectangles to be drawn; only for views with kView_DrawParts, one around all for others.
    std::span<const CRect> Parts() const { return parts; }
    bool Touches(const CRect &r) const
    {
        return std::any_of(parts.begin(), parts.end(), [&](const CRect &p) { return !p.Intersected(r).Empty(); });
    }

private:
    Platform::canvas &canvas;
    std::span<const CRect> parts;
    CRect damage;
};

} // namespace Sarnik
