#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/greySource.h"
#include "host/photo.h"

#include <vector>

namespace Stillmark
{

/// The grey values of `count` pixels whose colour planes stand one after the other, `planeStep` samples apart: the luma
/// of RGB, L* of Lab, the plane of grey. CMYK becomes RGB by the plain rule (1 - ink)(1 - black), which needs no
/// profile and keeps edges where they are; that is all an estimate looks at.
///
/// 8 and 16-bit codes are divided by their largest; float samples are taken as they are, but one that is not finite
/// counts as 0 and magnitudes are cut at 1000, far outside any picture and safe to square and sum.
void greyOfSamples(const void *samples, std::size_t planeStep, std::size_t count, int depth, colourMode mode,
                   float *grey);

/// A photo as the engine's source of grey, read in strips.
class greyOfPhoto : public CorvaneDeblur::greySource
{
public:
    explicit greyOfPhoto(const photo &source) : picture(source) {}

    int cols() const override { return picture.width(); }
    int rows() const override { return picture.height(); }
    void readGrey(const CorvaneDeblur::regionRect &rect, const CorvaneDeblur::floatArray &out) override;

    /// 1 where any colour channel is above threshold, a code of 8 bits (times 257 for 16-bit samples, a 255th for
    /// floats), else 0. Empty for a threshold of 255, which means no mask.
    CorvaneDeblur::byteArray readMask(const CorvaneDeblur::regionRect &rect, int threshold);

private:
    template <typename Use> void forEachStrip(const CorvaneDeblur::regionRect &rect, const Use &use);

    photo picture;
    std::vector<std::byte> strip;
};

/// A rectangle of a photo as a picture of its own.
class greyOfArea : public CorvaneDeblur::greySource
{
public:
    /// The rectangle lies within the photo.
    greyOfArea(const photo &source, const rectangle &part) : whole(source), area(part) {}

    int cols() const override { return area.width; }
    int rows() const override { return area.height; }
    void readGrey(const CorvaneDeblur::regionRect &rect, const CorvaneDeblur::floatArray &out) override
    {
        whole.readGrey({rect.x + area.x, rect.y + area.y, rect.width, rect.height}, out);
    }

private:
    greyOfPhoto whole;
    const rectangle area;
};

} // namespace Stillmark
