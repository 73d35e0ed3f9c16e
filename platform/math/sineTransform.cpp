#include "platform/math/sineTransform.h"

#include "platform/math/alignedBuffer.h"
#include "platform/math/linePlans.h"

#include <algorithm>
#include <cassert>

namespace CorvaneDeblur
{

sineTransform::sineTransform(int n) : length(n), plan(&linePlan::columns(2 * (n + 1), direction::forward))
{
    assert(n > 0);
}

void sineTransform::run(float *data, std::ptrdiff_t stride, int count, float scale) const
{
    const int period = 2 * (length + 1);
    const std::size_t samples = static_cast<std::size_t>(period) * columnLanes;
    const alignedBuffer<complexSample> odd(samples), spectrum(samples);
    std::fill_n(odd.data(), samples, complexSample{0.0f, 0.0f});
    for (int first = 0; first < count; first += 2 * columnLanes)
    {
        // Columns first .. first + 7 are the real parts, the next eight the imaginary parts.
        const int reals = std::min(columnLanes, count - first);
        const int imaginaries = std::clamp(count - first - columnLanes, 0, columnLanes);
        for (int j = 0; j < length; ++j)
        {
            const float *row = data + j * stride + first;
            complexSample *rise = odd.data() + static_cast<std::ptrdiff_t>(j + 1) * columnLanes;
            complexSample *fall = odd.data() + static_cast<std::ptrdiff_t>(period - 1 - j) * columnLanes;
            for (int c = 0; c < reals; ++c)
                rise[c] = {row[c], c < imaginaries ? row[columnLanes + c] : 0.0f};
            for (int c = 0; c < reals; ++c)
                fall[c] = {-rise[c].re, -rise[c].im};
        }
        plan->run(odd.data(), spectrum.data());
        // A real odd sequence has the spectrum -2i * S.
        for (int k = 0; k < length; ++k)
        {
            float *row = data + k * stride + first;
            const complexSample *s = spectrum.data() + static_cast<std::ptrdiff_t>(k + 1) * columnLanes;
            for (int c = 0; c < reals; ++c)
                row[c] = -0.5f * scale * s[c].im;
            for (int c = 0; c < imaginaries; ++c)
                row[columnLanes + c] = 0.5f * scale * s[c].re;
        }
    }
}

} // namespace CorvaneDeblur
