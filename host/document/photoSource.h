#pragma once

#include "host/document/pictureSource.h"

#include <array>
#include <cstdint>
#include <vector>

namespace Stillmark
{

/// A photo as a source. A plug-in asks for one plane after the other, but a photo has the planes of a pixel side by
/// side: all planes of an area are taken apart when the first of them is asked for, and the last few areas are kept.
class photoSource final : public pictureSource
{
public:
    explicit photoSource(photo shownPhoto);

    int width() const override { return picture.width(); }
    int height() const override { return picture.height(); }
    int depth() const override { return picture.depth(); }
    colourMode mode() const override { return picture.mode(); }
    int extraPlanes() const override { return picture.extraPlanes(); }

    planeSamples plane(int number, const rectangle &area) override;

private:
    struct keptArea
    {
        rectangle area; ///< width 0: none yet
        std::vector<std::byte> planes;
        std::uint64_t used = 0; ///< when last
    };
    planeSamples within(const keptArea &kept, int number, const rectangle &area) const;

    const photo picture;
    const int keptPlanes; ///< colours and transparency; masks behind are seldom asked for
    std::array<keptArea, 4> kept;
    std::uint64_t clock = 0;
    std::vector<std::byte> mask; ///< of the last area that a further plane was asked for
};

} // namespace Stillmark
