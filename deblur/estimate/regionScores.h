#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/softBoxSums.h"

#include <memory>
#include <vector>

/// How well every position of a picture suits the estimation of a blur: the measure behind suggestRegion, on its
/// thumbnail.
namespace CorvaneDeblur
{

/// The edges of the thumbnail: how strong, and in which direction modulo 180 degrees.
struct edgeMaps
{
    floatArray magnitude;
    intArray angleBin; ///< number of the direction's bin at edge pixels, -1 elsewhere
};

/// Directions of 0..pi fall into `angleBins` equal bins. Both maps have the thumbnail's shape.
edgeMaps edgesOf(const floatArray &small, int angleBins);

/// The maps of one search, ready to be summed under boxes of any size up to the one given.
class regionScores
{
public:
    /// small: the thumbnail, finite. kernelExtent: length in its pixels from which edges of a direction count.
    regionScores(const floatArray &small, const edgeMaps &edges, int angleBins, int kernelExtent, int largestBoxRows,
                 int largestBoxCols);

    /// The score of every position as the middle of a soft box (softBoxSums.h): the number of directions with more
    /// edge pixels under the box than the kernel is long, plus ten times the mean edge strength, both multiplied by
    /// the mean exposure. Not on several threads at once.
    floatArray scores(int boxRows, int boxCols);

private:
    void countDirections(const edgeMaps &edges, int angleBins);

    int kernelExtent;
    std::vector<std::unique_ptr<softBoxSums>> directions; ///< edge pixels of each direction that occurs
    std::unique_ptr<softBoxSums> strength, exposure;
    floatArray scratch;
};

} // namespace CorvaneDeblur
