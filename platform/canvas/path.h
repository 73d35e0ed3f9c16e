#pragma once

#include "platform/canvas/geometry.h"

#include <vector>

namespace Platform
{

/// Lines and curves, to be filled or drawn along. Several closed figures may overlap: where an odd number of them lie
/// over a point it is inside.
class path
{
public:
    enum class verb
    {
        move,  ///< 1 point
        line,  ///< 1 point
        curve, ///< 3 points: two controls of a cubic curve, and its end
        close  ///< none
    };

    path &moveTo(point p) { return add(verb::move, {p}); }
    path &lineTo(point p) { return add(verb::line, {p}); }
    path &curveTo(point first, point second, point end) { return add(verb::curve, {first, second, end}); }
    path &close() { return add(verb::close, {}); }

    path &addRectangle(const rectangle &r);
    /// The radius is limited to half the smaller side.
    path &addRoundedRectangle(const rectangle &r, double radius);
    path &addEllipse(const rectangle &r);
    path &addPolygon(const std::vector<point> &corners);
    /// A part of a circle, from one angle to another in radians, 0 to the right, growing clockwise as y points down. It
    /// begins a new figure.
    path &addArc(point centre, double radius, double from, double to);

    const std::vector<verb> &verbs() const { return steps; }
    const std::vector<point> &points() const { return places; }
    bool empty() const { return steps.empty(); }

private:
    path &add(verb v, std::initializer_list<point> p)
    {
        steps.push_back(v);
        places.insert(places.end(), p);
        return *this;
    }

    std::vector<verb> steps;
    std::vector<point> places;
};

} // namespace Platform
