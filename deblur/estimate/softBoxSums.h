#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/fourier.h"

#include <vector>

namespace CorvaneDeblur
{

/// The sums of one map under soft-edged boxes of any size, at a cost per position that does not depend on the size.
///
/// A soft box of boxRows x boxCols is a rectangle of ones with a border of two zeros all around, smoothed by the 5 x 5
/// Gaussian of standard deviation 5/6; the sum under it is the convolution with it, centred by the engine's rule.
/// Smoothing commutes with summing: the map is smoothed once, and its summed-area table in double answers every box.
class softBoxSums
{
public:
    /// border: what lies outside the map, `constant` (zero) or `replicate`. With `replicate` largestRows and
    /// largestCols bound the boxes that may be asked for.
    softBoxSums(const floatArray &map, borderMode border, int largestRows = 0, int largestCols = 0);

    /// out, of the map's shape, = the sum under the box at every position, times factor. Uses all threads of the
    /// current tbb arena; may be called on several threads at once.
    void sumInto(const floatArray &out, int boxRows, int boxCols, float factor = 1.0f) const;

private:
    int rows, cols;             ///< of the map
    int marginRows, marginCols; ///< samples of the border that the table holds on each side
    int tableRows, tableCols;   ///< one more than the map with its margins
    std::vector<double> table;  ///< [y][x] = sum of the smoothed samples above and left of (y, x)
};

} // namespace CorvaneDeblur
