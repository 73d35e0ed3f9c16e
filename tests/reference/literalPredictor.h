#pragma once

#include "deblur/estimate/floatArray.h"

namespace Reference
{

/// Mean of the (2 radius + 1) square window, weighted by distance and by difference from the pixel; neighbours outside
/// the image do not count.
void literalBilateral(const CorvaneDeblur::floatArray &source, const CorvaneDeblur::floatArray &destination,
                      float spatialSigma, float rangeSigma, int radius);

/// Steepens edges in place: image += step / 2 * sign(negative Laplacian) * length of the undivided central differences.
void literalShock(const CorvaneDeblur::floatArray &image, float step);

/// The largest magnitude that at least `minimumCount` pixels of each of `groups` orientation bands reach, to the
/// resolution of the histogram; 0 when there is none.
float literalOrientationThreshold(const CorvaneDeblur::floatArray &gradX, const CorvaneDeblur::floatArray &gradY,
                                  const CorvaneDeblur::floatArray &magnitude, int groups, int minimumCount, float cap);

/// Strong edges of a latent image, call after call with falling thresholds.
class literalPredictor
{
public:
    literalPredictor(const CorvaneDeblur::floatArray &weights, int kernelRows, int kernelCols);

    /// gradX, gradY: forward differences of the filtered image where selected, 0 elsewhere.
    void predict(const CorvaneDeblur::floatArray &latent, const CorvaneDeblur::floatArray &gradX,
                 const CorvaneDeblur::floatArray &gradY);

    float threshold = 0.0f;          ///< of the next call
    float selectionThreshold = 0.0f; ///< that of the last call's selection

private:
    CorvaneDeblur::floatArray weights;
    CorvaneDeblur::floatArray rejected; ///< 1 at pixels not selected so far
    int minimumCount;
    float rangeSigma = 0.5f;
    float shockStep = 1.0f;
};

} // namespace Reference
