#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/regionRect.h"

namespace CorvaneDeblur
{

/// A photograph as the engine sees it: its full-scale grey, of any rectangle. It may be far too large to hold at once.
class greySource
{
public:
    virtual ~greySource() = default;

    virtual int cols() const = 0;
    virtual int rows() const = 0;

    /// Fills `out` (rect.height x rect.width) with the grey values, 0..1 (greyValue.h). The rectangle lies within the
    /// image. Errors are thrown and pass through the caller. Called on one thread at a time.
    virtual void readGrey(const regionRect &rect, const floatArray &out) = 0;
};

} // namespace CorvaneDeblur
