#include "platform/canvas/path.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace Platform
{
namespace
{

/// Distance of a cubic's controls from its ends, for a quarter of a unit circle: the middle of the curve lies on it.
constexpr double quarter = 4.0 / 3.0 * (std::numbers::sqrt2 - 1);

} // namespace

path &path::addRectangle(const rectangle &r)
{
    return moveTo({r.left, r.top})
        .lineTo({r.right, r.top})
        .lineTo({r.right, r.bottom})
        .lineTo({r.left, r.bottom})
        .close();
}

path &path::addRoundedRectangle(const rectangle &r, double radius)
{
    const double c = std::max(0.0, std::min({radius, r.width() / 2, r.height() / 2}));
    if (!(c > 0))
        return addRectangle(r);
    const double k = c * (1 - quarter);
    moveTo({r.left + c, r.top}).lineTo({r.right - c, r.top});
    curveTo({r.right - k, r.top}, {r.right, r.top + k}, {r.right, r.top + c}).lineTo({r.right, r.bottom - c});
    curveTo({r.right, r.bottom - k}, {r.right - k, r.bottom}, {r.right - c, r.bottom}).lineTo({r.left + c, r.bottom});
    curveTo({r.left + k, r.bottom}, {r.left, r.bottom - k}, {r.left, r.bottom - c}).lineTo({r.left, r.top + c});
    return curveTo({r.left, r.top + k}, {r.left + k, r.top}, {r.left + c, r.top}).close();
}

path &path::addEllipse(const rectangle &r)
{
    const double cx = (r.left + r.right) / 2, cy = (r.top + r.bottom) / 2;
    const double kx = (r.right - r.left) / 2 * quarter, ky = (r.bottom - r.top) / 2 * quarter;
    moveTo({cx, r.top});
    curveTo({cx + kx, r.top}, {r.right, cy - ky}, {r.right, cy});
    curveTo({r.right, cy + ky}, {cx + kx, r.bottom}, {cx, r.bottom});
    curveTo({cx - kx, r.bottom}, {r.left, cy + ky}, {r.left, cy});
    return curveTo({r.left, cy - ky}, {cx - kx, r.top}, {cx, r.top}).close();
}

path &path::addPolygon(const std::vector<point> &corners)
{
    for (std::size_t i = 0; i < corners.size(); ++i)
        i == 0 ? moveTo(corners[i]) : lineTo(corners[i]);
    return corners.empty() ? *this : close();
}

path &path::addArc(point centre, double radius, double from, double to)
{
    const double sweep = std::clamp(to - from, -2 * std::numbers::pi, 2 * std::numbers::pi);
    const int pieces = std::max(1, static_cast<int>(std::ceil(std::abs(sweep) / (std::numbers::pi / 2) - 1e-9)));
    const double step = sweep / pieces, k = 4.0 / 3.0 * std::tan(step / 4) * radius;
    const auto on = [&](double a) { return point{centre.x + radius * std::cos(a), centre.y + radius * std::sin(a)}; };
    moveTo(on(from));
    for (int i = 0; i < pieces; ++i)
    {
        const double a = from + i * step, b = a + step;
        const point p = on(a), q = on(b);
        curveTo({p.x - k * std::sin(a), p.y + k * std::cos(a)}, {q.x + k * std::sin(b), q.y - k * std::cos(b)}, q);
    }
    return *this;
}

} // namespace Platform
