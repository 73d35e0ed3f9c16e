#include "platform/canvas/canvas.h"

#include "platform/canvas/textLayout.h"

#include <cairo.h>

#include <algorithm>
#include <cmath>
#include <utility>

namespace Platform
{
namespace
{

/// The library's own coordinates are fixed-point numbers that wrap around at 2^23 pixels.
constexpr double farthest = 4e6;

cairo_surface_t *surfaceOver(const raster &image, const pixelRect &part)
{
    // The library takes memory that it could write to; a source is never written to.
    auto *const first = const_cast<std::uint32_t *>(image.row(part.top)) + part.left;
    return cairo_image_surface_create_for_data(reinterpret_cast<unsigned char *>(first), CAIRO_FORMAT_ARGB32,
                                               part.width(), part.height(), static_cast<int>(image.rowBytes()));
}

pixelRect common(const pixelRect &a, const pixelRect &b)
{
    return {std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right), std::min(a.bottom, b.bottom)};
}

bool usable(const std::vector<double> &dashes)
{
    double sum = 0;
    for (const double d : dashes)
    {
        if (!(d >= 0 && d < farthest))
            return false;
        sum += d;
    }
    // Much finer than a pixel would only take time.
    return sum > 0.05 * static_cast<double>(dashes.size());
}

} // namespace

struct canvas::context
{
    context(raster &target, double unit)
        : scale(unit > 0 && std::isfinite(unit) ? unit : 1),
          surface(surfaceOver(target, target.empty() ? pixelRect{} : target.bounds())), cairo(cairo_create(surface)),
          bounds(target.bounds())
    {
        cairo_set_fill_rule(cairo, CAIRO_FILL_RULE_EVEN_ODD);
    }
    ~context()
    {
        cairo_destroy(cairo);
        cairo_surface_finish(surface);
        cairo_surface_destroy(surface);
    }

    point toPixels(point p) const
    {
        return {std::clamp((p.x + origin.x) * scale, -farthest, farthest),
                std::clamp((p.y + origin.y) * scale, -farthest, farthest)};
    }

    /// False where a coordinate is no number: then there is no path.
    bool follow(const path &shape)
    {
        cairo_new_path(cairo);
        for (const point &p : shape.points())
            if (std::isnan(p.x) || std::isnan(p.y))
                return false;
        const point *next = shape.points().data();
        const auto take = [&] { return toPixels(*next++); };
        for (const path::verb v : shape.verbs())
            switch (v)
            {
            case path::verb::move:
            case path::verb::line:
            {
                const point p = take();
                v == path::verb::move ? cairo_move_to(cairo, p.x, p.y) : cairo_line_to(cairo, p.x, p.y);
                break;
            }
            case path::verb::curve:
            {
                const point a = take(), b = take(), c = take();
                cairo_curve_to(cairo, a.x, a.y, b.x, b.y, c.x, c.y);
                break;
            }
            case path::verb::close:
                cairo_close_path(cairo);
                break;
            }
        return true;
    }

    void setInk(colour c)
    {
        cairo_set_source_rgba(cairo, c.red / 255.0, c.green / 255.0, c.blue / 255.0, c.alpha / 255.0);
    }

    void setPen(const pen &how)
    {
        setInk(how.ink);
        cairo_set_line_width(cairo, std::clamp(how.width * scale, 0.0, farthest));
        cairo_set_line_cap(cairo, how.roundEnds ? CAIRO_LINE_CAP_ROUND : CAIRO_LINE_CAP_BUTT);
        cairo_set_line_join(cairo, how.roundJoins ? CAIRO_LINE_JOIN_ROUND : CAIRO_LINE_JOIN_MITER);
        std::vector<double> dashes;
        if (usable(how.dashes))
            for (const double d : how.dashes)
                dashes.push_back(d * scale);
        const double offset =
            std::isfinite(how.dashOffset) ? std::clamp(how.dashOffset * scale, -farthest, farthest) : 0;
        cairo_set_dash(cairo, dashes.data(), static_cast<int>(dashes.size()), offset);
    }

    double scale;
    cairo_surface_t *surface;
    cairo_t *cairo;
    pixelRect bounds;
    point origin;
    std::vector<point> savedOrigins;
};

canvas::canvas(raster &target, double scale) : drawing(std::make_unique<context>(target, scale))
{
}

canvas::~canvas() = default;

double canvas::scale() const
{
    return drawing->scale;
}

void canvas::save()
{
    cairo_save(drawing->cairo);
    drawing->savedOrigins.push_back(drawing->origin);
}

void canvas::restore()
{
    if (drawing->savedOrigins.empty())
        return;
    cairo_restore(drawing->cairo);
    drawing->origin = drawing->savedOrigins.back();
    drawing->savedOrigins.pop_back();
}

void canvas::translate(double dx, double dy)
{
    if (std::isfinite(dx) && std::isfinite(dy))
        drawing->origin = {drawing->origin.x + dx, drawing->origin.y + dy};
}

void canvas::clip(const rectangle &r)
{
    const point a = drawing->toPixels({r.left, r.top}), b = drawing->toPixels({r.right, r.bottom});
    const double left = std::round(a.x), top = std::round(a.y);
    cairo_new_path(drawing->cairo);
    if (!r.empty())
        cairo_rectangle(drawing->cairo, left, top, std::round(b.x) - left, std::round(b.y) - top);
    cairo_clip(drawing->cairo);
}

void canvas::clip(const path &outline)
{
    drawing->follow(outline);
    cairo_clip(drawing->cairo);
}

void canvas::clipPixels(std::span<const pixelRect> parts)
{
    cairo_new_path(drawing->cairo);
    for (const pixelRect &part : parts)
    {
        const pixelRect p = common(part, drawing->bounds);
        if (!p.empty())
            cairo_rectangle(drawing->cairo, p.left, p.top, p.width(), p.height());
    }
    // Rectangles may overlap, and where two do is inside.
    cairo_set_fill_rule(drawing->cairo, CAIRO_FILL_RULE_WINDING);
    cairo_clip(drawing->cairo);
    cairo_set_fill_rule(drawing->cairo, CAIRO_FILL_RULE_EVEN_ODD);
}

pixelRect canvas::clipBounds() const
{
    double left = 0, top = 0, right = 0, bottom = 0;
    cairo_clip_extents(drawing->cairo, &left, &top, &right, &bottom);
    const pixelRect clip{static_cast<int>(std::floor(left)), static_cast<int>(std::floor(top)),
                         static_cast<int>(std::ceil(right)), static_cast<int>(std::ceil(bottom))};
    return common(clip, drawing->bounds);
}

pixelRect canvas::pixelsAround(const rectangle &r) const
{
    const point a = drawing->toPixels({r.left, r.top}), b = drawing->toPixels({r.right, r.bottom});
    return {static_cast<int>(std::floor(a.x)), static_cast<int>(std::floor(a.y)), static_cast<int>(std::ceil(b.x)),
            static_cast<int>(std::ceil(b.y))};
}

point canvas::sharp(point p) const
{
    const point pixels = drawing->toPixels(p);
    return {std::round(pixels.x) / drawing->scale - drawing->origin.x,
            std::round(pixels.y) / drawing->scale - drawing->origin.y};
}

rectangle canvas::sharp(const rectangle &r) const
{
    const point a = sharp(point{r.left, r.top}), b = sharp(point{r.right, r.bottom});
    return {a.x, a.y, b.x, b.y};
}

void canvas::fill(const path &shape, colour ink)
{
    if (!drawing->follow(shape))
        return;
    drawing->setInk(ink);
    cairo_fill(drawing->cairo);
}

void canvas::stroke(const path &line, const pen &how)
{
    if (!(how.width > 0) || !drawing->follow(line))
        return;
    drawing->setPen(how);
    cairo_stroke(drawing->cairo);
}

void canvas::fillRectangle(const rectangle &r, colour ink)
{
    fill(path().addRectangle(r), ink);
}

void canvas::drawRectangle(const rectangle &r, const pen &how)
{
    stroke(path().addRectangle(r), how);
}

void canvas::fillRounded(const rectangle &r, double radius, colour ink)
{
    fill(path().addRoundedRectangle(r, radius), ink);
}

void canvas::drawRounded(const rectangle &r, double radius, const pen &how)
{
    stroke(path().addRoundedRectangle(r, radius), how);
}

void canvas::fillEllipse(const rectangle &r, colour ink)
{
    fill(path().addEllipse(r), ink);
}

void canvas::drawEllipse(const rectangle &r, const pen &how)
{
    stroke(path().addEllipse(r), how);
}

void canvas::drawLine(point from, point to, const pen &how)
{
    stroke(path().moveTo(from).lineTo(to), how);
}

void canvas::fillTriangle(point a, point b, point c, colour ink)
{
    fill(path().addPolygon({a, b, c}), ink);
}

void canvas::fillGradient(const path &shape, const rectangle &r, colour top, colour bottom)
{
    if (!drawing->follow(shape))
        return;
    cairo_pattern_t *const gradient =
        cairo_pattern_create_linear(0, drawing->toPixels({0, r.top}).y, 0, drawing->toPixels({0, r.bottom}).y);
    for (const auto &[at, c] : {std::pair{0.0, top}, std::pair{1.0, bottom}})
        cairo_pattern_add_color_stop_rgba(gradient, at, c.red / 255.0, c.green / 255.0, c.blue / 255.0,
                                          c.alpha / 255.0);
    cairo_set_source(drawing->cairo, gradient);
    cairo_fill(drawing->cairo);
    cairo_pattern_destroy(gradient);
}

void canvas::drawText(const textBlock &text, point at, colour ink)
{
    if (std::isnan(at.x) || std::isnan(at.y))
        return;
    const point p = drawing->toPixels(at);
    cairo_save(drawing->cairo);
    drawing->setInk(ink);
    cairo_translate(drawing->cairo, p.x, p.y);
    cairo_scale(drawing->cairo, drawing->scale, drawing->scale);
    pango_cairo_show_layout(drawing->cairo, text.made->pango);
    cairo_restore(drawing->cairo);
}

void canvas::drawText(std::string_view utf8, const font &f, point at, colour ink)
{
    drawText(textBlock(utf8, f), at, ink);
}

void canvas::drawImage(const raster &image, const pixelRect &part, const rectangle &to, sampling how, double opacity)
{
    if (part.empty() || to.empty() || !(opacity > 0))
        return;
    const pixelRect inside = common(part, image.bounds());
    if (inside.empty())
        return;
    const point a = drawing->toPixels({to.left, to.top}), b = drawing->toPixels({to.right, to.bottom});
    const double across = (b.x - a.x) / part.width(), down = (b.y - a.y) / part.height();
    if (!(across > 1e-6 && down > 1e-6)) // the library cannot invert less
        return;

    cairo_surface_t *const source = surfaceOver(image, inside);
    cairo_save(drawing->cairo);
    cairo_translate(drawing->cairo, a.x + (inside.left - part.left) * across, a.y + (inside.top - part.top) * down);
    cairo_scale(drawing->cairo, across, down);
    cairo_new_path(drawing->cairo);
    cairo_rectangle(drawing->cairo, 0, 0, inside.width(), inside.height());
    cairo_clip(drawing->cairo);
    cairo_set_source_surface(drawing->cairo, source, 0, 0);
    cairo_pattern_t *const pattern = cairo_get_source(drawing->cairo);
    cairo_pattern_set_filter(pattern, how == sampling::nearest ? CAIRO_FILTER_NEAREST : CAIRO_FILTER_GOOD);
    // The part's own edge goes on outwards, so that neither the rest of the picture nor nothing shines in.
    cairo_pattern_set_extend(pattern, CAIRO_EXTEND_PAD);
    cairo_paint_with_alpha(drawing->cairo, std::min(opacity, 1.0));
    cairo_restore(drawing->cairo);
    cairo_surface_destroy(source);
}

void canvas::copyPixels(const raster &image, const pixelRect &part, int left, int top)
{
    const pixelRect inside = common(part, image.bounds());
    if (inside.empty())
        return;
    cairo_surface_t *const source = surfaceOver(image, inside);
    const int x = left + inside.left - part.left, y = top + inside.top - part.top;
    cairo_save(drawing->cairo);
    cairo_set_operator(drawing->cairo, CAIRO_OPERATOR_SOURCE);
    cairo_set_source_surface(drawing->cairo, source, x, y);
    cairo_new_path(drawing->cairo);
    cairo_rectangle(drawing->cairo, x, y, inside.width(), inside.height());
    cairo_fill(drawing->cairo);
    cairo_restore(drawing->cairo);
    cairo_surface_destroy(source);
}

} // namespace Platform
