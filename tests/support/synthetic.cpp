#include "tests/support/synthetic.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <numbers>

using CorvaneDeblur::floatArray;

namespace TestSupport
{
namespace
{

/// splitmix64 (S. Vigna): the distributions of <random> differ between standard libraries.
class randomSource
{
public:
    explicit randomSource(unsigned seed) : state(seed * 0x9E3779B97F4A7C15ull + 1) {}

    float uniform(float low, float high)
    {
        state += 0x9E3779B97F4A7C15ull;
        std::uint64_t z = state;
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ull;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBull;
        z ^= z >> 31;
        return low + (high - low) * (static_cast<float>(z >> 40) / 16777216.0f);
    }

    /// Sum of twelve uniform samples: close enough to a normal distribution of mean 0 and deviation 1.
    float normal()
    {
        float sum = -6.0f;
        for (int i = 0; i < 12; ++i)
            sum += uniform(0.0f, 1.0f);
        return sum;
    }

private:
    std::uint64_t state;
};

} // namespace

floatArray noiseImage(int rows, int cols, unsigned seed, float low, float high)
{
    randomSource random(seed);
    const floatArray image = floatArray::allocate(rows, cols);
    for (int y = 0; y < rows; ++y)
        for (int x = 0; x < cols; ++x)
            image.at(y, x) = random.uniform(low, high);
    return image;
}

floatArray edgeScene(int rows, int cols, unsigned seed)
{
    randomSource random(seed);
    const floatArray image = floatArray::allocate(rows, cols);
    for (int y = 0; y < rows; ++y)
        for (int x = 0; x < cols; ++x)
            image.at(y, x) = 0.4f + 0.1f * static_cast<float>(x) / static_cast<float>(cols);

    const int shapes = 8 + rows * cols / 1500;
    for (int i = 0; i < shapes; ++i)
    {
        const float cx = random.uniform(0.0f, static_cast<float>(cols));
        const float cy = random.uniform(0.0f, static_cast<float>(rows));
        const float size = random.uniform(0.03f, 0.12f) * static_cast<float>(std::max(rows, cols));
        const float angle = random.uniform(0.0f, std::numbers::pi_v<float>);
        const float value = random.uniform(0.1f, 0.9f);
        const bool disc = i % 2 == 0;
        for (int y = 0; y < rows; ++y)
            for (int x = 0; x < cols; ++x)
            {
                const float dx = static_cast<float>(x) - cx, dy = static_cast<float>(y) - cy;
                const float u = std::cos(angle) * dx + std::sin(angle) * dy;
                const float v = std::cos(angle) * dy - std::sin(angle) * dx;
                if (disc ? u * u + v * v < size * size : std::abs(u) < size && std::abs(v) < 0.6f * size)
                    image.at(y, x) = value;
            }
    }
    return image;
}

floatArray shakeKernel(int rows, int cols, unsigned seed)
{
    randomSource random(seed);
    const floatArray kernel = floatArray::allocate(rows, cols);
    std::fill_n(kernel.data, rows * cols, 0.0f);
    float x = 0.5f * static_cast<float>(cols - 1), y = 0.5f * static_cast<float>(rows - 1);
    float dx = random.uniform(-0.3f, 0.3f), dy = random.uniform(-0.3f, 0.3f);
    float sum = 0.0f;
    for (int step = 0; step < 6 * std::max(rows, cols); ++step)
    {
        const int c = static_cast<int>(x + 0.5f), r = static_cast<int>(y + 0.5f);
        kernel.at(r, c) += 1.0f;
        sum += 1.0f;
        dx += random.uniform(-0.1f, 0.1f);
        dy += random.uniform(-0.1f, 0.1f);
        if (x + dx < 0.0f || x + dx > static_cast<float>(cols - 1))
            dx = -dx;
        if (y + dy < 0.0f || y + dy > static_cast<float>(rows - 1))
            dy = -dy;
        x = std::clamp(x + dx, 0.0f, static_cast<float>(cols - 1));
        y = std::clamp(y + dy, 0.0f, static_cast<float>(rows - 1));
    }
    for (int i = 0; i < rows * cols; ++i)
        kernel.data[i] /= sum;
    return kernel;
}

floatArray blurred(const floatArray &scene, const floatArray &kernel, float sigma, unsigned seed)
{
    randomSource random(seed);
    const floatArray out = floatArray::allocate(scene.rows, scene.cols);
    for (int y = 0; y < scene.rows; ++y)
        for (int x = 0; x < scene.cols; ++x)
        {
            float sum = 0.0f;
            for (int r = 0; r < kernel.rows; ++r)
                for (int c = 0; c < kernel.cols; ++c)
                {
                    const int sy = std::clamp(y - (r - (kernel.rows - 1) / 2), 0, scene.rows - 1);
                    const int sx = std::clamp(x - (c - (kernel.cols - 1) / 2), 0, scene.cols - 1);
                    sum += kernel.at(r, c) * scene.at(sy, sx);
                }
            out.at(y, x) = std::clamp(sum + (sigma > 0.0f ? sigma * random.normal() : 0.0f), 0.0f, 1.0f);
        }
    return out;
}

floatArray stridedCopy(const floatArray &a)
{
    const floatArray larger = floatArray::allocate(a.rows + 5, a.cols + 7);
    std::fill_n(larger.data, larger.rows * larger.cols, std::numeric_limits<float>::quiet_NaN());
    const floatArray view = larger.subRect(2, 3, a.rows, a.cols);
    for (int y = 0; y < a.rows; ++y)
        std::copy_n(a.row(y), a.cols, view.row(y));
    return view;
}

bool marginUntouched(const floatArray &view)
{
    floatArray larger = view;
    larger.data = view.samples.get();
    larger.rows = view.rows + 5;
    larger.cols = view.cols + 7;
    for (int y = 0; y < larger.rows; ++y)
        for (int x = 0; x < larger.cols; ++x)
        {
            const bool inside = y >= 2 && y < 2 + view.rows && x >= 3 && x < 3 + view.cols;
            if (!inside && !std::isnan(larger.at(y, x)))
                return false;
        }
    return true;
}

} // namespace TestSupport
