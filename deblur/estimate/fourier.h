#pragma once

#include "deblur/estimate/floatArray.h"

/// Transforms of whole arrays, the placing of kernels on a periodic grid, and filtering by kernels.
///
/// The centre of an array is element ((rows - 1) / 2, (cols - 1) / 2), integer division: the engine's one centring
/// rule. Spectra are half spectra (halfSpectrumCols) in natural order, row frequency first.
namespace CorvaneDeblur
{

/// What lies outside an array.
enum class borderMode
{
    circular = 0,  ///< the array repeats
    constant = 1,  ///< a fixed value, 0 when filtering
    replicate = 2, ///< the nearest edge sample
};

/// spectrum = unnormalised transform of a; spectrum is a.rows x halfSpectrumCols(a.cols).
void forwardFFT(const floatArray &a, const complexArray &spectrum);

enum class inverseScale
{
    none,      ///< unnormalised: forward then inverse multiplies by rows * cols
    normalised ///< exact inverse of forwardFFT
};
/// a = inverse transform of spectrum, which is overwritten.
void inverseFFT(const complexArray &spectrum, const floatArray &a, inverseScale scale);

/// Transform of `kernel` on a zero grid of gridRows x gridCols with its centre at the origin, wrapped around.
/// A kernel larger than the grid wraps onto it (its samples add up).
void placeCentred(const floatArray &kernel, const complexArray &spectrum, int gridCols, int gridRows);

/// The inverse of placeCentred, with a crop to out's own shape (at most the grid's). Overwrites the spectrum.
void gatherCentred(const complexArray &spectrum, const floatArray &out, int gridCols, int gridRows);

/// A fresh array: src with margins, filled with `value` (constant) or with the nearest edge samples (replicate).
floatArray padArray(const floatArray &src, int top, int bottom, int left, int right, borderMode mode,
                    float value = 0.0f);

/// dst = src filtered by the kernel, centred; `border` tells what lies outside src. dst has src's shape and may be src.
void convolveFFT(const floatArray &src, const floatArray &dst, const floatArray &kernel, borderMode border);
void correlateFFT(const floatArray &src, const floatArray &dst, const floatArray &kernel, borderMode border);

} // namespace CorvaneDeblur
