#pragma once

#include "deblur/estimate/floatArray.h"
#include "framework/pixels/rect.h"

#include <cstdint>

namespace Project
{

/// The picture that traces are estimated from. Whoever has the picture fills it; it outlives the collection. Called on
/// the main thread only.
class PTracePicture
{
public:
    /// In picture coordinates, wherever their origin is; fixed for a run.
    virtual Sarnik::CRect Bounds() const = 0;
    /// Colour planes, and bits a sample (8, 16 or 32).
    virtual int Planes() const = 0;
    virtual int Depth() const = 0;

    /// Fills `grey` with the grey values, 0..1, of `rect`, which lies within the bounds and is not empty; the caller
    /// has allocated rect's height x width, possibly as a view with a stride. Where maskThreshold is below 255, `mask`
    /// has the same shape and becomes 1 where any channel exceeds the threshold (of 255; times 257 in 16 bits, over
    /// 255 in floats), else 0; with 255 it is empty. Throws what reading throws.
    virtual void ReadGrey(const Sarnik::CRect &rect, std::uint8_t maskThreshold, const CorvaneDeblur::floatArray &grey,
                          const CorvaneDeblur::byteArray &mask) = 0;

protected:
    ~PTracePicture() = default;
};

} // namespace Project
