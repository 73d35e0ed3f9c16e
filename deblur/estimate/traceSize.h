#pragma once

#include "deblur/estimate/regionRect.h"

/// Rules for the size of a blur trace (its kernel's side) and of its region.
namespace CorvaneDeblur
{

/// Largest trace size for an image: a third of its smaller side, odd, 11 to 199.
int maxKernelSize(int imageCols, int imageRows);

enum class sizePreset
{
    small = 0,  ///< a twentieth of the smaller side
    medium = 1, ///< a tenth
    large = 2,  ///< a fifth
    fixed = 3   ///< 45 pixels
};
/// Trace size of a preset, never above maxKernelSize; for a very small image it may be as low as 0.
int sizeForPreset(sizePreset preset, int imageCols, int imageRows);

/// A region cut to at most 2000 x 2000 pixels around its centre; the zero rectangle if nothing remains.
regionRect limitRegion(const regionRect &region);

} // namespace CorvaneDeblur
