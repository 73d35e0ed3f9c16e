#pragma once

#include "host/document/pictureResult.h"
#include "host/document/pictureSource.h"
#include "tests/support/synthetic.h"

#include <cmath>
#include <cstring>
#include <vector>

namespace Stillmark
{

/// A shaken picture in memory: edges in every direction, blurred, each plane a little different; a ramp as
/// transparency.
class memorySource : public pictureSource
{
public:
    memorySource(colourMode mode, int depth, int extraPlanes, int width = 240, int height = 200)
        : kind(mode), bits(depth), extras(extraPlanes), columns(width), lines(height)
    {
        using namespace TestSupport;
        const auto grey = blurred(edgeScene(height, width, 5), shakeKernel(13, 13, 3), 0.004f, 4);
        for (int plane = 0; plane < planes(); ++plane)
            for (int y = 0; y < height; ++y)
                for (int x = 0; x < width; ++x)
                    append(plane >= colourPlanes() ? static_cast<float>(x) / static_cast<float>(width)
                                                   : grey.at(y, x) * (1.0f - 0.07f * static_cast<float>(plane)));
    }

    int width() const override { return columns; }
    int height() const override { return lines; }
    int depth() const override { return bits; }
    colourMode mode() const override { return kind; }
    int extraPlanes() const override { return extras; }
    planeSamples plane(int number, const rectangle &area) override
    {
        return {samples.data() + offset(number, area.x, area.y), static_cast<std::size_t>(columns * sampleBytes())};
    }

    const std::vector<std::byte> &codes() const { return samples; }
    std::size_t offset(int plane, int x, int y) const
    {
        return (static_cast<std::size_t>(plane * lines + y) * static_cast<std::size_t>(columns) +
                static_cast<std::size_t>(x)) *
               static_cast<std::size_t>(sampleBytes());
    }

private:
    template <class Sample> void appendSample(Sample sample)
    {
        const auto *bytes = reinterpret_cast<const std::byte *>(&sample);
        samples.insert(samples.end(), bytes, bytes + sizeof sample);
    }
    void append(float value)
    {
        const float limited = std::clamp(value, 0.0f, 1.0f);
        if (bits == 8)
            appendSample(static_cast<std::uint8_t>(std::lround(limited * 255.0f)));
        else if (bits == 16)
            appendSample(static_cast<std::uint16_t>(std::lround(limited * 65535.0f)));
        else
            appendSample(value);
    }

    colourMode kind;
    int bits, extras, columns, lines;
    std::vector<std::byte> samples;
};

/// What comes back, over a copy of the source.
class memoryResult : public pictureResult
{
public:
    explicit memoryResult(const memorySource &of) : source(of), samples(of.codes()) {}

    void write(int plane, const rectangle &area, const planeSamples &codes) override
    {
        for (int y = 0; y < area.height; ++y)
            std::memcpy(samples.data() + source.offset(plane, area.x, area.y + y), codes.row(y),
                        static_cast<std::size_t>(area.width * source.sampleBytes()));
    }

    const std::vector<std::byte> &codes() const { return samples; }
    bool sameAsSource(int plane, int x, int y) const
    {
        const std::size_t at = source.offset(plane, x, y);
        return std::memcmp(samples.data() + at, source.codes().data() + at,
                           static_cast<std::size_t>(source.sampleBytes())) == 0;
    }

private:
    const memorySource &source;
    std::vector<std::byte> samples;
};

} // namespace Stillmark
