#include "bench/scenes.h"

#include "deblur/estimate/fourier.h"
#include "tests/support/synthetic.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <numbers>
#include <utility>

using namespace CorvaneDeblur;

namespace Bench
{
namespace
{

constexpr int textureSide = 256;     // a power of two: the texture repeats
constexpr float smallestLeaf = 5.0f; // most of a photograph is smoother than its finest detail
constexpr float coverage = 4.0f;     // leaves over a pixel, on average

/// Periodic 1/f noise, zero on average: octaves of a coarse grid of random values, each half as strong as the last.
floatArray texture(unsigned seed)
{
    const floatArray sum = floatArray::allocate(textureSide, textureSide);
    std::fill_n(sum.data, textureSide * textureSide, 0.0f);
    float strength = 0.5f;
    for (int cells = 4; cells <= textureSide; cells *= 2, strength *= 0.5f)
    {
        const floatArray lattice = TestSupport::noiseImage(cells, cells, seed++, -1.0f, 1.0f);
        const int step = textureSide / cells;
        for (int y = 0; y < textureSide; ++y)
            for (int x = 0; x < textureSide; ++x)
            {
                const int x0 = x / step, y0 = y / step, x1 = (x0 + 1) % cells, y1 = (y0 + 1) % cells;
                const float fx = static_cast<float>(x % step) / static_cast<float>(step);
                const float fy = static_cast<float>(y % step) / static_cast<float>(step);
                const float top = std::lerp(lattice.at(y0, x0), lattice.at(y0, x1), fx);
                const float bottom = std::lerp(lattice.at(y1, x0), lattice.at(y1, x1), fx);
                sum.at(y, x) += strength * std::lerp(top, bottom, fy);
            }
    }
    return sum;
}

struct leaf
{
    float x, y, radius, cosine, sine, slopeX, slopeY, grain;
    bool disc;
    float value[3];

    bool covers(float dx, float dy) const
    {
        if (disc)
            return dx * dx + dy * dy < radius * radius;
        return std::fabs(cosine * dx + sine * dy) < radius && std::fabs(cosine * dy - sine * dx) < 0.6f * radius;
    }
};

constexpr int randomsPerLeaf = 11;

/// random: randomsPerLeaf samples in 0..1.
leaf makeLeaf(const float *random, int rows, int cols, float largest)
{
    leaf l;
    l.x = random[0] * static_cast<float>(cols);
    l.y = random[1] * static_cast<float>(rows);
    const float span = 1.0f - (smallestLeaf * smallestLeaf) / (largest * largest);
    l.radius = smallestLeaf / std::sqrt(1.0f - random[2] * span); // density 1 / r^3
    const float angle = random[3] * std::numbers::pi_v<float>;
    l.cosine = std::cos(angle);
    l.sine = std::sin(angle);
    l.disc = random[4] < 0.5f;
    l.slopeX = 0.2f * (random[5] - 0.5f) / l.radius;
    l.slopeY = 0.2f * (random[6] - 0.5f) / l.radius;
    l.grain = 0.15f * random[7] * random[7];
    // Colours are mostly grey: the planes differ less than the leaves.
    for (int p = 0; p < 3; ++p)
        l.value[p] = 0.1f + 0.65f * random[8] + 0.15f * random[p == 0 ? 9 : p == 1 ? 10 : 4];
    return l;
}

void paint(const leaf &l, const floatArray &grain, const std::vector<floatArray> &planes)
{
    const float reach = l.disc ? l.radius : 1.17f * l.radius; // a leaf of 2 by 1.2 radii has this half diagonal
    const int top = std::max(static_cast<int>(l.y - reach), 0);
    const int bottom = std::min(static_cast<int>(l.y + reach) + 1, planes[0].rows - 1);
    const int left = std::max(static_cast<int>(l.x - reach), 0);
    const int right = std::min(static_cast<int>(l.x + reach) + 1, planes[0].cols - 1);
    for (int y = top; y <= bottom; ++y)
        for (int x = left; x <= right; ++x)
        {
            const float dx = static_cast<float>(x) - l.x, dy = static_cast<float>(y) - l.y;
            if (!l.covers(dx, dy))
                continue;
            const float shade =
                l.slopeX * dx + l.slopeY * dy + l.grain * grain.data[(y % textureSide) * textureSide + x % textureSide];
            for (std::size_t p = 0; p < planes.size(); ++p)
                planes[p].row(y)[x] = std::clamp(l.value[p % 3] + shade, 0.0f, 1.0f);
        }
}

} // namespace

std::vector<floatArray> naturalScene(int rows, int cols, int planes, unsigned seed)
{
    std::vector<floatArray> scene;
    for (int p = 0; p < planes; ++p)
    {
        scene.push_back(floatArray::allocate(rows, cols));
        std::fill_n(scene.back().data, static_cast<std::ptrdiff_t>(rows) * cols, 0.5f);
    }

    const float largest = std::max(0.15f * static_cast<float>(std::max(rows, cols)), 2.0f * smallestLeaf);
    const double meanArea = 2.0 * std::numbers::pi * smallestLeaf * smallestLeaf * std::log(largest / smallestLeaf);
    const int leaves = static_cast<int>(coverage * static_cast<double>(rows) * cols / meanArea) + 1;
    const floatArray grain = texture(seed + 1);
    const floatArray random = TestSupport::noiseImage(leaves, randomsPerLeaf, seed);
    for (int i = 0; i < leaves; ++i)
        paint(makeLeaf(random.row(i), rows, cols, largest), grain, scene);
    return scene;
}

floatArray shake(int size, unsigned seed)
{
    return TestSupport::shakeKernel(size, size, seed);
}

std::vector<floatArray> shakenScene(int rows, int cols, int planes, int size, unsigned seed)
{
    const std::vector<floatArray> scene = naturalScene(rows, cols, planes, seed);
    const floatArray kernel = shake(size, seed);
    const float reach = std::sqrt(3.0f) / 255.0f; // uniform noise of this half width deviates by one level
    for (const floatArray &plane : scene)
    {
        convolveFFT(plane, plane, kernel, borderMode::replicate);
        const floatArray noise = TestSupport::noiseImage(rows, cols, ++seed, -reach, reach);
        for (std::ptrdiff_t i = 0; i < static_cast<std::ptrdiff_t>(rows) * cols; ++i)
            plane.data[i] = std::clamp(plane.data[i] + noise.data[i], 0.0f, 1.0f);
    }
    return scene;
}

memoryPhoto::memoryPhoto(int photoCols, int photoRows, int photoPlanes)
    : cols(photoCols), rows(photoRows), planes(photoPlanes),
      samples(static_cast<std::size_t>(photoCols) * static_cast<std::size_t>(photoRows) *
              static_cast<std::size_t>(photoPlanes))
{
}

memoryPhoto::memoryPhoto(const std::vector<floatArray> &content)
    : memoryPhoto(content[0].cols, content[0].rows, static_cast<int>(content.size()))
{
    for (int p = 0; p < planes; ++p)
        for (int y = 0; y < rows; ++y)
            for (int x = 0; x < cols; ++x)
                *at(p, y, x) = static_cast<std::byte>(content[static_cast<std::size_t>(p)].row(y)[x] * 255.0f + 0.5f);
}

void memoryPhoto::read(const pixelRect &area, std::byte *to, std::ptrdiff_t rowBytes)
{
    for (int p = 0; p < planes; ++p)
        for (int y = 0; y < area.height; ++y)
            std::memcpy(to + (static_cast<std::ptrdiff_t>(p) * area.height + y) * rowBytes, at(p, area.y + y, area.x),
                        static_cast<std::size_t>(area.width));
    const std::lock_guard guard(lock);
    reads.push_back(area);
}

void memoryPhoto::write(const pixelRect &area, const std::byte *from, std::ptrdiff_t rowBytes)
{
    for (int p = 0; p < planes; ++p)
        for (int y = 0; y < area.height; ++y)
            std::memcpy(at(p, area.y + y, area.x), from + (static_cast<std::ptrdiff_t>(p) * area.height + y) * rowBytes,
                        static_cast<std::size_t>(area.width));
}

std::vector<pixelRect> memoryPhoto::takeReads()
{
    const std::lock_guard guard(lock);
    return std::exchange(reads, {});
}

} // namespace Bench
