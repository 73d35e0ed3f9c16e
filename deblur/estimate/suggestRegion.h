#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/kernelEstimator.h"
#include "deblur/estimate/regionRect.h"

#include <vector>

namespace CorvaneDeblur
{

/// Which places a search for a region prefers.
enum class regionMode
{
    first = 0, ///< the middle of the image
    near = 1,  ///< a given point
    more = 2   ///< no place before another: for regions beside existing ones
};

/// A place that qualified, in the coordinates of the search's thumbnail.
struct regionCandidate
{
    float score; ///< how many edge directions it holds, how strong they are, how well it is exposed
    float rank;  ///< the score weighted by the preferred place; the highest one that repeats no region wins
    int x, y;    ///< top left corner
};

/// Finds a rectangle that suits the estimation of a blur: strong edges in many directions, neither dark nor clipped.
///
/// The search runs on a thumbnail of at most 1000 pixels a side on which the blur is about 5 pixels across: it counts,
/// under a soft-edged box at every position, the edge directions that have at least a kernel's length of edge pixels,
/// and tries boxes of several sizes, the one that suits the image first.
///
/// grey: the whole image, 0..1, at any scale; a sample that is not finite counts as 0. imageCols, imageRows: the size
/// of the source; the result, `existing` and `point` (mode `near` only) are in its pixels. kernelCols, kernelRows: the
/// size of the blur looked for; below 31 counts as 31. noise, noiseLevel: as kernelEstimator has them. existing:
/// regions to avoid; no result lies in one of them by more than four fifths of its own area.
///
/// Returns false, and leaves `result`, when no rectangle qualifies: a flat or badly exposed image, one too small for
/// the kernel, or one whose good places are taken.
bool suggestRegion(const floatArray &grey, int imageCols, int imageRows, int kernelCols, int kernelRows,
                   noiseMode noise, float noiseLevel, const std::vector<regionRect> &existing, regionMode mode,
                   imagePoint point, regionRect &result);

} // namespace CorvaneDeblur
