#pragma once

#include "platform/canvas/geometry.h"
#include "platform/canvas/path.h"
#include "platform/canvas/raster.h"
#include "platform/canvas/text.h"

#include <memory>
#include <span>
#include <vector>

namespace Platform
{

/// How a line is drawn.
struct pen
{
    colour ink;
    double width = 1;                ///< view units; the line lies half on each side of its path
    std::vector<double> dashes = {}; ///< lengths on and off by turns; empty: one line. Unusable ones count as empty
    double dashOffset = 0;           ///< how far into the dashes the line begins
    bool roundEnds = false;
    bool roundJoins = false;
};

enum class sampling
{
    nearest, ///< sharp pixels
    smooth   ///< between pixels when enlarged, averages when made smaller
};

/// Draws into a raster, anti-aliased. The raster outlives the canvas and keeps its size. Coordinates are view units, a
/// unit being `scale` pixels; one that is further than some 4 million pixels away counts as that far, and a shape with
/// a coordinate that is no number is left out. One thread.
class canvas
{
public:
    explicit canvas(raster &target, double scale = 1);
    ~canvas();
    canvas(const canvas &) = delete;
    canvas &operator=(const canvas &) = delete;

    double scale() const;

    /// Remembers origin and clip; restore goes back to the last ones that were saved. More restores than saves do
    /// nothing.
    void save();
    void restore();
    /// Moves the origin.
    void translate(double dx, double dy);
    /// Nothing is drawn outside from now on. The edges go to the nearest whole pixels, so that neighbours neither
    /// overlap nor leave a seam.
    void clip(const rectangle &r);
    void clip(const path &outline);
    /// To the union of some rectangles of the raster, whatever the origin.
    void clipPixels(std::span<const pixelRect> parts);
    /// Pixels that may still be drawn to.
    pixelRect clipBounds() const;
    /// The smallest rectangle of pixels around r.
    pixelRect pixelsAround(const rectangle &r) const;
    /// Moved so that it lies on the edges between pixels, for shapes with sharp edges at every scale.
    point sharp(point p) const;
    rectangle sharp(const rectangle &r) const;

    void fill(const path &shape, colour ink);
    void stroke(const path &line, const pen &how);

    void fillRectangle(const rectangle &r, colour ink);
    void drawRectangle(const rectangle &r, const pen &how);
    void fillRounded(const rectangle &r, double radius, colour ink);
    void drawRounded(const rectangle &r, double radius, const pen &how);
    void fillEllipse(const rectangle &r, colour ink);
    void drawEllipse(const rectangle &r, const pen &how);
    void drawLine(point from, point to, const pen &how);
    void fillTriangle(point a, point b, point c, colour ink);
    /// From one colour at the top to another at the bottom.
    void fillGradient(const path &shape, const rectangle &r, colour top, colour bottom);

    /// The block's top left corner goes to a point.
    void drawText(const textBlock &text, point at, colour ink);
    /// One line of text, for what is drawn once.
    void drawText(std::string_view utf8, const font &f, point at, colour ink);

    /// A part of a picture over a rectangle; what lies outside the picture is left out. opacity: 0 to 1.
    void drawImage(const raster &image, const pixelRect &part, const rectangle &to, sampling how = sampling::smooth,
                   double opacity = 1);
    /// Copies a part pixel by pixel, alpha and all, onto the pixels of the raster from (left, top): no blend.
    void copyPixels(const raster &image, const pixelRect &part, int left, int top);

private:
    struct context;
    std::unique_ptr<context> drawing;
};

} // namespace Platform
