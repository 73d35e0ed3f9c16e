#pragma once

#include "deblur/estimate/floatArray.h"

/// Made-up pictures and kernels, the same for the same seed on every machine.
namespace TestSupport
{

/// Independent samples, uniform in low..high.
CorvaneDeblur::floatArray noiseImage(int rows, int cols, unsigned seed, float low = 0.0f, float high = 1.0f);
/// A sharp scene in 0.1..0.9: flat discs and rectangles over a soft ramp, edges in every direction.
CorvaneDeblur::floatArray edgeScene(int rows, int cols, unsigned seed);
/// A hand-shake path: a smooth random walk drawn into a rows x cols kernel, sum 1, no negative samples.
CorvaneDeblur::floatArray shakeKernel(int rows, int cols, unsigned seed);
/// `scene` blurred by the kernel with replicated borders, plus Gaussian noise of standard deviation `sigma`.
CorvaneDeblur::floatArray blurred(const CorvaneDeblur::floatArray &scene, const CorvaneDeblur::floatArray &kernel,
                                  float sigma, unsigned seed);
/// The same samples in the middle of a larger allocation whose other samples are NaN: what reads past a row shows.
CorvaneDeblur::floatArray stridedCopy(const CorvaneDeblur::floatArray &a);
/// Whether all samples around a view made by stridedCopy are still NaN: nothing wrote outside of it.
bool marginUntouched(const CorvaneDeblur::floatArray &view);

} // namespace TestSupport
