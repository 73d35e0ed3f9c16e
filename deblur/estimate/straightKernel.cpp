#include "deblur/estimate/straightKernel.h"

#include "deblur/estimate/arrayOps.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace CorvaneDeblur
{
namespace
{

/// Keeps lengths and angles that hit whole pixels from spilling into the next one.
constexpr double epsilon = std::numeric_limits<float>::epsilon();

struct lineGeometry
{
    double half;         ///< half the distance of the end points' centres
    double cosine, sine; ///< of the direction
    int reachCols;       ///< columns from the centre to the end; its sign is that of the direction
    int reachRows;       ///< rows likewise, never negative
};

lineGeometry geometryOf(double length, double angleDegrees)
{
    lineGeometry line;
    line.half = (length - 1.0) / 2.0;
    double degrees = std::fmod(angleDegrees, 180.0);
    if (degrees < 0.0)
        degrees += 180.0;
    const double radians = degrees / 180.0 * std::numbers::pi;
    line.cosine = std::cos(radians);
    line.sine = std::sin(radians);
    // Exactly along an axis, where the rounding of pi would leave a trace of the other one.
    if (std::fabs(degrees) < epsilon)
    {
        line.cosine = 1.0;
        line.sine = 0.0;
    }
    if (std::fabs(degrees - 90.0) < epsilon)
    {
        line.cosine = 0.0;
        line.sine = 1.0;
    }
    const double sign = (line.cosine > 0.0) - (line.cosine < 0.0);
    line.reachCols = static_cast<int>(sign + line.cosine * line.half - length * epsilon);
    line.reachRows = static_cast<int>(line.sine * line.half + 1.0 - length * epsilon);
    return line;
}

/// Coverage of the pixel (x, y), counted from the line's middle, by the half of the line that starts there.
double coverage(const lineGeometry &line, double x, double y)
{
    double distance = y * line.cosine - x * line.sine;
    if (std::sqrt(x * x + y * y) >= line.half && std::fabs(distance) <= 1.0)
    {
        // Beside the end point: the distance to it, not to the line that would go on.
        const double along = std::fabs(line.cosine) >= std::fabs(line.sine)
                                 ? line.half - std::fabs((x + distance * line.sine) / line.cosine)
                                 : line.half - std::fabs((y - distance * line.cosine) / line.sine);
        distance = std::sqrt(distance * distance + along * along);
    }
    return std::max(0.0, 1.0 + epsilon - std::fabs(distance));
}

} // namespace

floatArray straightKernel(double length, double angleDegrees)
{
    if (!std::isfinite(length) || !std::isfinite(angleDegrees))
    {
        length = 1.0;
        angleDegrees = 0.0;
    }
    length = std::clamp(length, 1.0, longestStraightKernel);

    const lineGeometry line = geometryOf(length, angleDegrees);
    const int step = (line.reachCols > 0) - (line.reachCols < 0);
    const int rows = line.reachRows + 1;
    const int cols = std::abs(line.reachCols) + 1;
    const floatArray out = floatArray::allocate(2 * rows - 1, 2 * cols - 1);
    fill(out, 0.0f);

    // One quadrant holds half the line, the opposite one its point reflection. Rows count upwards in the geometry and
    // downwards in the array, so a direction to the upper right (cosine above 0) is mirrored.
    const bool mirrored = line.cosine > 0.0;
    for (int y = 0; y < rows; ++y)
    {
        for (int x = 0; x < cols; ++x)
        {
            const float value = static_cast<float>(coverage(line, step * x, y));
            const int column = mirrored ? -x : x;
            out.at(rows - 1 + y, cols - 1 + column) = value;
            out.at(rows - 1 - y, cols - 1 - column) = value;
        }
    }
    scaleInto(out, out, static_cast<float>(1.0 / (sumAbs(out) + epsilon * length * length)));
    return out;
}

} // namespace CorvaneDeblur
