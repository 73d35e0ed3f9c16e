#include "platform/math/sineTransform.h"

#include "platform/math/multiversion.h"

#include <algorithm>
#include <cassert>
#include <cmath>
#include <numbers>

namespace CorvaneDeblur
{
namespace
{

constexpr int lanes = 16; ///< columns transformed together
constexpr int group = 4;  ///< results accumulated together: their sums stay in registers

/// Eight columns in one register (two on the baseline). Unaligned: it is laid over plain arrays.
typedef float eightFloats __attribute__((vector_size(32), aligned(4), may_alias));

/// Results of `group` rows of the matrix, rowStep apart, from folded samples of `half` rows of `lanes` columns.
STILLMARK_MULTIVERSION
void multiplyGroup(const float *matrix, std::ptrdiff_t rowStep, const float *folded, int half, float *out)
{
    eightFloats low[group] = {}, high[group] = {};
    for (int j = 0; j < half; ++j)
    {
        const eightFloats a = *reinterpret_cast<const eightFloats *>(folded + j * lanes);
        const eightFloats b = *reinterpret_cast<const eightFloats *>(folded + j * lanes + 8);
        for (int g = 0; g < group; ++g)
        {
            low[g] += matrix[g * rowStep + j] * a;
            high[g] += matrix[g * rowStep + j] * b;
        }
    }
    for (int g = 0; g < group; ++g)
    {
        *reinterpret_cast<eightFloats *>(out + g * lanes) = low[g];
        *reinterpret_cast<eightFloats *>(out + g * lanes + 8) = high[g];
    }
}

} // namespace

sineTransform::sineTransform(int n)
    : length(n), half((n + 1) / 2),
      // Rows past the last, so that the last group needs no exception.
      matrix(static_cast<std::size_t>(n + 2 * group) * static_cast<std::size_t>(half))
{
    assert(n > 0);
    std::fill_n(matrix.data(), matrix.count(), 0.0f);
    const long long period = 2 * (static_cast<long long>(n) + 1);
    for (int k = 0; k < n; ++k)
        for (int j = 0; j < half; ++j)
        {
            const long long turn = (static_cast<long long>(j) + 1) * (k + 1) % period;
            matrix[static_cast<std::size_t>(k) * static_cast<std::size_t>(half) + static_cast<std::size_t>(j)] =
                static_cast<float>(
                    std::sin(2.0 * std::numbers::pi * static_cast<double>(turn) / static_cast<double>(period)));
        }
}

void sineTransform::run(float *data, std::ptrdiff_t stride, int count, float scale) const
{
    // sin(pi (m + 1 - i) k / (m + 1)) = -(-1)^k sin(pi i k / (m + 1)): results with an even index see the sum of a
    // sample and its mirror image, those with an odd index the difference.
    const std::size_t foldedCount = static_cast<std::size_t>(half) * lanes;
    const alignedBuffer<float> folded(2 * foldedCount);
    float *sum = folded.data(), *difference = sum + foldedCount;
    float results[group * lanes];
    for (int first = 0; first < count; first += lanes)
    {
        const int cols = std::min(lanes, count - first);
        std::fill_n(folded.data(), folded.count(), 0.0f);
        for (int j = 0; j < half; ++j)
        {
            const float *a = data + j * stride + first, *b = data + (length - 1 - j) * stride + first;
            const bool middle = j == length - 1 - j;
            for (int c = 0; c < cols; ++c)
            {
                sum[j * lanes + c] = middle ? a[c] : a[c] + b[c];
                difference[j * lanes + c] = middle ? 0.0f : a[c] - b[c];
            }
        }
        for (int parity = 0; parity < 2; ++parity)
            for (int k = parity; k < length; k += 2 * group)
            {
                multiplyGroup(matrix.data() + static_cast<std::ptrdiff_t>(k) * half,
                              2 * static_cast<std::ptrdiff_t>(half), parity == 0 ? sum : difference, half, results);
                for (int g = 0; g < group && k + 2 * g < length; ++g)
                    for (int c = 0; c < cols; ++c)
                        data[(k + 2 * g) * stride + first + c] = scale * results[g * lanes + c];
            }
    }
}

} // namespace CorvaneDeblur
