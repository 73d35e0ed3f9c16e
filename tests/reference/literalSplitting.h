#pragma once

#include "deblur/deconv/shrinkageTableStore.h"
#include "deblur/estimate/floatArray.h"

/// Steps that both hyper-Laplacian methods share.
namespace Reference
{

/// Real spectrum D of the circular negative Laplacian.
CorvaneDeblur::floatArray laplacianSpectrum(int gridRows, int gridCols);
/// |K|^2
CorvaneDeblur::floatArray powerOf(const CorvaneDeblur::complexArray &k);

/// Spectrum of the negative adjoint of the circular differences, applied to the differences of x after shrinkage.
CorvaneDeblur::complexArray shrunkGradientSpectrum(const CorvaneDeblur::floatArray &x,
                                                   const CorvaneDeblur::shrinkageTable &table);

} // namespace Reference
