#pragma once

#include "deblur/estimate/floatArray.h"
#include "platform/math/workers.h"

namespace CorvaneDeblur
{

/// Cleans and sharpens a latent image and keeps its strongest gradients, chosen so that every edge orientation stays
/// represented. One object serves one level: its thresholds fall from call to call, and a pixel once selected stays so.
class gradientPredictor
{
public:
    /// weights: 0..1 per pixel of the image's shape, from the saturation mask; kept as a view.
    gradientPredictor(int imageRows, int imageCols, int kernelRows, int kernelCols, floatArray weights,
                      workers who = workers::all);

    /// gradX, gradY: forward differences of the sharpened image where it is selected, 0 elsewhere; the image's shape.
    void predict(const floatArray &latent, const floatArray &gradX, const floatArray &gradY);

    /// The threshold of the next call on the gradient's magnitude, at least 0.1 after the first; 0 before it.
    float threshold = 0.0f;
    float rangeSigma = 0.5f;
    float shockStep = 1.0f;
    /// 1 at pixels that were not selected so far.
    floatArray rejected;

private:
    void sharpen(const floatArray &latent);
    void selectFirst(const floatArray &gradX, const floatArray &gradY);
    void selectMore(const floatArray &gradX, const floatArray &gradY);

    int kernelRows, kernelCols;
    floatArray weights;
    workers who;
    floatArray smooth, working; ///< after the bilateral filter, after the shock filter
};

/// The largest magnitude at which each of four orientation bands (45 degrees of the gradient's direction modulo 180)
/// still has minimumCount pixels. Magnitudes above `cap` share the last bin of the histogram (cap 0: no cap). 0 when
/// there is none, or when no magnitude reaches 0.0001.
float orientationThreshold(const floatArray &gradX, const floatArray &gradY, const floatArray &magnitude,
                           int minimumCount, float cap);

} // namespace CorvaneDeblur
