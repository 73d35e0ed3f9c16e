#pragma once

#include "deblur/estimate/floatArray.h"

namespace Reference
{

/// Latent image by one regularised division per frequency.
class literalFastDeconvolver
{
public:
    literalFastDeconvolver(const CorvaneDeblur::floatArray &padded, int derivativesOrder);

    /// latent: the image's shape, from the grid's top left corner.
    void solve(const CorvaneDeblur::floatArray &kernel, const CorvaneDeblur::floatArray &latent, float mu) const;

    CorvaneDeblur::floatArray lowPass; ///< factor of the numerator, on the half spectrum; empty for none

private:
    int gridRows, gridCols;
    CorvaneDeblur::floatArray regulariser;
    CorvaneDeblur::floatArray dataWeight;
    CorvaneDeblur::complexArray imageSpectrum; ///< times dataWeight
};

} // namespace Reference
