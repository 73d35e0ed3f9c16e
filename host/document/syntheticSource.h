#pragma once

#include "host/document/pictureSource.h"

#include <cstdint>
#include <vector>

namespace Stillmark
{

/// A picture that is computed where it is looked at: smooth waves with fine noise on them, each plane different, the
/// same for the same settings on every machine. Takes no memory but for the area last asked for.
class syntheticSource final : public pictureSource
{
public:
    struct settings
    {
        int width = 1, height = 1;
        int depth = 8; ///< 8, 16 or 32; floats lie between 0 and 1
        colourMode mode = colourMode::rgb;
        int extraPlanes = 0;
        std::uint32_t seed = 0;
    };
    explicit syntheticSource(const settings &what) : s(what) {}

    int width() const override { return s.width; }
    int height() const override { return s.height; }
    int depth() const override { return s.depth; }
    colourMode mode() const override { return s.mode; }
    int extraPlanes() const override { return s.extraPlanes; }

    planeSamples plane(int number, const rectangle &area) override;

private:
    const settings s;
    std::vector<std::byte> samples;
    int lastPlane = -1;
    rectangle lastArea;
};

} // namespace Stillmark
