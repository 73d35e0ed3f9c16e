#pragma once

#include "shell/tintorel.h"

#include <cstdint>

namespace Stillmark
{

/// What a run of the plug-in works on: the picture as the host shows it through the interface. Its functions are called
/// on the run's thread, the colour conversion excepted, and may throw: what they throw reaches the caller of runPlugin,
/// the plug-in sees an error code.
class pluginPicture
{
public:
    virtual ~pluginPicture() = default;

    virtual TNImageMode imageMode() const = 0;
    virtual TNPoint32 imageSize() const = 0;
    /// What is to be filtered, in picture coordinates.
    virtual TNRect32 filterRect() const = 0;
    /// The lists of channels; null to show none. Stays good while the picture lives.
    virtual const TNDocument *document() const = 0;

    /// Where the run's autoMask stands, from its beginning; null at its end. While it is not 0 the picture itself
    /// leaves as it was what is not selected. For pictures with a selection.
    virtual void watchAutoMask(const std::uint8_t *) {}

    /// As the channel ports suite has them. The pointers are not null, the rectangle not empty and the strides sound;
    /// whether the port exists and the rectangle lies within its channel is for the picture to check.
    virtual TNError readPixels(TNPort port, const TNRect32 &area, const TNPixelMemory &destination) = 0;
    virtual TNError writePixels(TNPort port, const TNRect32 &area, const TNPixelMemory &source) = 0;

    /// Pixels of four samples from CMYK to RGB, in place. Any threads at once.
    virtual TNError cmykToRgb8(std::uint8_t *quads, std::uint64_t pixels) = 0;
    virtual TNError cmykToRgb16(std::uint16_t *quads, std::uint64_t pixels) = 0;
};

} // namespace Stillmark
