#pragma once

#include "deblur/estimate/greySource.h"
#include "store/traces/tracePicture.h"

namespace Project
{

/// The picture within its bounds, for the engine.
class PBoundsGrey final : public CorvaneDeblur::greySource
{
public:
    explicit PBoundsGrey(PTracePicture &image) : picture(image), bounds(image.Bounds()) {}

    int cols() const override { return static_cast<int>(bounds.Width()); }
    int rows() const override { return static_cast<int>(bounds.Height()); }
    void readGrey(const CorvaneDeblur::regionRect &rect, const CorvaneDeblur::floatArray &out) override
    {
        picture.ReadGrey(ToPicture(rect), 255, out, {});
    }

    Sarnik::CRect ToPicture(const CorvaneDeblur::regionRect &rect) const
    {
        return Sarnik::CRect{rect.x, rect.y, rect.x + rect.width, rect.y + rect.height}.Moved(bounds.left, bounds.top);
    }
    /// Cut to the picture.
    CorvaneDeblur::regionRect FromPicture(const Sarnik::CRect &rect) const
    {
        const Sarnik::CRect inside = rect.Intersected(bounds);
        if (inside.Empty())
            return {};
        return {inside.left - bounds.left, inside.top - bounds.top, static_cast<int>(inside.Width()),
                static_cast<int>(inside.Height())};
    }

private:
    PTracePicture &picture;
    const Sarnik::CRect bounds;
};

} // namespace Project
