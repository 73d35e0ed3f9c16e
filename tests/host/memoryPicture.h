#pragma once

#include "host/plugin/pluginPicture.h"

#include <cstdint>
#include <functional>
#include <vector>

namespace Stillmark
{

/// A grey picture of 8 bits in memory, for tests of a run.
class memoryPicture final : public pluginPicture
{
public:
    memoryPicture(int width, int height) : samples(static_cast<std::size_t>(width) * height)
    {
        for (std::size_t i = 0; i < samples.size(); i++)
            samples[i] = static_cast<std::uint8_t>(i * 7 + i / 251);
        channel.bounds = {0, 0, width, height};
        channel.depth = 8;
        channel.present = 1;
        channel.readPort = channel.writePort = reinterpret_cast<TNPort>(this);
        shown.version = 4;
        shown.depth = 8;
        shown.size = size = {width, height};
        shown.targetComposite = &channel;
        rect = channel.bounds;
    }

    TNImageMode imageMode() const override { return TNModeGrey; }
    TNPoint32 imageSize() const override { return size; }
    TNRect32 filterRect() const override { return rect; }
    const TNDocument *document() const override { return &shown; }
    void watchAutoMask(const std::uint8_t *place) override { autoMask = place; }

    TNError readPixels(TNPort port, const TNRect32 &area, const TNPixelMemory &to) override
    {
        return copy(port, area, to, [](std::uint8_t &sample, std::uint8_t &there) { there = sample; });
    }
    TNError writePixels(TNPort port, const TNRect32 &area, const TNPixelMemory &from) override
    {
        return copy(port, area, from, [](std::uint8_t &sample, std::uint8_t &there) { sample = there; });
    }
    TNError cmykToRgb8(std::uint8_t *, std::uint64_t) override { return TNNoError; }
    TNError cmykToRgb16(std::uint16_t *, std::uint64_t) override { return TNNoError; }

    std::vector<std::uint8_t> samples;
    TNPoint32 size; ///< as shown; may be made larger than what there is
    TNRect32 rect;
    TNDocument shown{};
    TNChannel channel{};
    const std::uint8_t *autoMask = nullptr;
    std::function<void()> onPixels; ///< before each read and write

private:
    template <class Move> TNError copy(TNPort port, const TNRect32 &area, const TNPixelMemory &memory, Move move)
    {
        if (onPixels)
            onPixels();
        if (port != channel.readPort || area.left < 0 || area.top < 0 || area.right > channel.bounds.right ||
            area.bottom > channel.bounds.bottom)
            return TNErrParameter;
        for (int y = area.top; y < area.bottom; y++)
            for (int x = area.left; x < area.right; x++)
                move(samples[static_cast<std::size_t>(y) * channel.bounds.right + x],
                     static_cast<std::uint8_t *>(memory.data)[(y - area.top) * (memory.rowBits / 8) +
                                                              (x - area.left) * (memory.columnBits / 8)]);
        return TNNoError;
    }
};

} // namespace Stillmark
