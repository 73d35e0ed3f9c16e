#pragma once

#include "deblur/estimate/floatArray.h"

namespace Reference
{

/// Transform of a.
CorvaneDeblur::complexArray spectrumOf(const CorvaneDeblur::floatArray &a);
/// Transform of a kernel placed centred on a grid.
CorvaneDeblur::complexArray centredSpectrum(const CorvaneDeblur::floatArray &kernel, int gridRows, int gridCols);
/// The real part of it: all there is for a symmetric kernel.
CorvaneDeblur::floatArray realSpectrum(const CorvaneDeblur::floatArray &kernel, int gridRows, int gridCols);
/// realSpectrum of the Gaussian of standard deviation sigma samples, cut at three sigma.
CorvaneDeblur::floatArray gaussianSpectrum(float sigma, int gridRows, int gridCols);

} // namespace Reference
