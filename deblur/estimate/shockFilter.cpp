#include "deblur/estimate/edgeFilters.h"

#include "platform/math/multiversion.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{
namespace
{

/// The negative Laplacian counts only neighbours inside: in the first and last row `above` or `below` is the row
/// itself, which takes off what it adds. Sums run above, below, left, right: where an image of few levels bends by
/// nothing, the sign is that of the rounding.
float sharpenedSample(const float *above, const float *here, const float *below, int left, int x, int right,
                      float halfStep)
{
    const float gx = here[right] - here[left], gy = below[x] - above[x], c = here[x];
    const float bend = 4.0f * c - (above[x] + below[x] + here[left] + here[right]);
    const float sign = static_cast<float>((bend > 0.0f) - (bend < 0.0f));
    return c + halfStep * (std::sqrt(gx * gx + gy * gy) * sign);
}

STILLMARK_MULTIVERSION
void sharpenInside(const float *above, const float *here, const float *below, float halfStep, float *__restrict out,
                   int cols)
{
    for (int x = 1; x < cols - 1; ++x)
    {
        const float gx = here[x + 1] - here[x - 1], gy = below[x] - above[x], c = here[x];
        const float bend = 4.0f * c - (above[x] + below[x] + here[x - 1] + here[x + 1]);
        const float magnitude = std::sqrt(gx * gx + gy * gy);
        const float signedStep = bend > 0.0f ? halfStep : (bend < 0.0f ? -halfStep : 0.0f);
        out[x] = c + signedStep * magnitude;
    }
}

} // namespace

void shockFilter(const floatArray &image, const floatArray &sharpened, float step, workers who)
{
    const float halfStep = step * 0.5f;
    const int last = image.cols - 1;
    inPieces(who, image.rows, 64, [&](int begin, int end) {
        for (int y = begin; y < end; ++y)
        {
            const float *above = image.row(std::max(0, y - 1)), *here = image.row(y);
            const float *below = image.row(std::min(image.rows - 1, y + 1));
            float *out = sharpened.row(y);
            sharpenInside(above, here, below, halfStep, out, image.cols);
            out[0] = sharpenedSample(above, here, below, 0, 0, std::min(1, last), halfStep);
            out[last] = sharpenedSample(above, here, below, std::max(0, last - 1), last, last, halfStep);
        }
    });
}

} // namespace CorvaneDeblur
