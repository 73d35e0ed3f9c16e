#include "cli/greyOfPhoto.h"

#include "deblur/estimate/greyValue.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <type_traits>

namespace Stillmark
{
namespace
{

constexpr std::size_t stripBytes = 4 << 20;

template <typename Sample> double largestCode()
{
    return std::is_floating_point_v<Sample> ? 1.0 : static_cast<double>(std::numeric_limits<Sample>::max());
}

template <typename Sample> double usable(Sample sample)
{
    if constexpr (std::is_floating_point_v<Sample>)
        return std::isfinite(sample) ? std::clamp(sample, -1000.0f, 1000.0f) : 0.0f;
    else
        return sample;
}

template <typename Sample>
void convert(const Sample *samples, std::size_t planeStep, std::size_t count, colourMode mode, float *grey)
{
    const double maximum = largestCode<Sample>();
    const auto at = [&](std::size_t plane, std::size_t i) { return usable(samples[plane * planeStep + i]); };
    switch (mode)
    {
    case colourMode::grey:
    case colourMode::lab:
        for (std::size_t i = 0; i < count; ++i)
            grey[i] = static_cast<float>(at(0, i) / maximum);
        break;
    case colourMode::rgb:
        for (std::size_t i = 0; i < count; ++i)
            grey[i] = CorvaneDeblur::greyValue(at(0, i), at(1, i), at(2, i), maximum);
        break;
    case colourMode::cmyk:
        for (std::size_t i = 0; i < count; ++i)
        {
            const double paper = 1 - at(3, i) / maximum;
            grey[i] = CorvaneDeblur::greyValue((1 - at(0, i) / maximum) * paper, (1 - at(1, i) / maximum) * paper,
                                               (1 - at(2, i) / maximum) * paper);
        }
        break;
    }
}

template <typename Sample>
void markAbove(const Sample *samples, std::size_t planeStep, std::size_t count, int planes, double limit,
               std::uint8_t *mask)
{
    for (std::size_t plane = 0; plane < static_cast<std::size_t>(planes); ++plane)
        for (std::size_t i = 0; i < count; ++i)
            if (samples[plane * planeStep + i] > limit)
                mask[i] = 1;
}

} // namespace

void greyOfSamples(const void *samples, std::size_t planeStep, std::size_t count, int depth, colourMode mode,
                   float *grey)
{
    if (depth == 8)
        convert(static_cast<const std::uint8_t *>(samples), planeStep, count, mode, grey);
    else if (depth == 16)
        convert(static_cast<const std::uint16_t *>(samples), planeStep, count, mode, grey);
    else
        convert(static_cast<const float *>(samples), planeStep, count, mode, grey);
}

/// Calls use(first row within rect, rows, samples, samples from one plane to the next).
template <typename Use> void greyOfPhoto::forEachStrip(const CorvaneDeblur::regionRect &rect, const Use &use)
{
    const auto width = static_cast<std::size_t>(rect.width);
    const std::size_t rowBytes = width * static_cast<std::size_t>(picture.sampleBytes());
    const std::size_t bytesPerRow = rowBytes * static_cast<std::size_t>(picture.colourPlanes());
    const int rowsAtOnce =
        static_cast<int>(std::clamp<std::size_t>(stripBytes / bytesPerRow, 1, static_cast<std::size_t>(rect.height)));
    strip.resize(bytesPerRow * static_cast<std::size_t>(rowsAtOnce));
    for (int row = 0; row < rect.height; row += rowsAtOnce)
    {
        const int rows = std::min(rowsAtOnce, rect.height - row);
        picture.read({rect.x, rect.y + row, rect.width, rows}, strip.data(), rowBytes);
        use(row, rows, strip.data(), width * static_cast<std::size_t>(rows));
    }
}

void greyOfPhoto::readGrey(const CorvaneDeblur::regionRect &rect, const CorvaneDeblur::floatArray &out)
{
    forEachStrip(rect, [&](int first, int rows, const std::byte *samples, std::size_t planeStep) {
        for (int row = 0; row < rows; ++row)
        {
            const std::size_t offset = static_cast<std::size_t>(row) * static_cast<std::size_t>(rect.width);
            greyOfSamples(samples + offset * static_cast<std::size_t>(picture.sampleBytes()), planeStep,
                          static_cast<std::size_t>(rect.width), picture.depth(), picture.mode(), out.row(first + row));
        }
    });
}

CorvaneDeblur::byteArray greyOfPhoto::readMask(const CorvaneDeblur::regionRect &rect, int threshold)
{
    if (threshold >= 255)
        return {};
    const auto mask = CorvaneDeblur::byteArray::allocate(rect.height, rect.width);
    std::fill_n(mask.data, static_cast<std::size_t>(rect.height) * static_cast<std::size_t>(rect.width),
                std::uint8_t{0});
    const int planes = picture.colourPlanes();
    forEachStrip(rect, [&](int first, int, const std::byte *samples, std::size_t count) {
        const void *data = samples;
        std::uint8_t *out = mask.row(first);
        if (picture.depth() == 8)
            markAbove(static_cast<const std::uint8_t *>(data), count, count, planes, threshold, out);
        else if (picture.depth() == 16)
            markAbove(static_cast<const std::uint16_t *>(data), count, count, planes, threshold * 257, out);
        else
            markAbove(static_cast<const float *>(data), count, count, planes, threshold / 255.0f, out);
    });
    return mask;
}

} // namespace Stillmark
