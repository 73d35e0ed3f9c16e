#pragma once

#include "deblur/deconv/latentKernel.h"

#include <vector>

/// How several Blur Traces share a picture: each pixel takes the result of the trace whose region centre is nearest,
/// with a soft transition where two are about equally near.
namespace CorvaneDeblur
{

/// Width of the transition in pixels, at every render scale: two traces mix where their distances differ by no more.
constexpr double blendWidth = 20.0;

/// Weight of trace a against trace b at image pixel (x, y); b's against a's is 1 less it. With d the distance to a's
/// region centre less that to b's: exactly 1 for d < -blendWidth, exactly 0 for d > blendWidth, in between the logistic
/// 1 / (1 + exp(8 d / blendWidth)), from 0.99966 to 0.00034.
double pairWeight(int x, int y, const latentKernel &a, const latentKernel &b);

/// Indices, ascending, of the traces that matter in a rectangle (bounds inclusive): at one of nine sample points, no
/// other trace is nearer by more than blendWidth. With fewer than two traces just {0}.
std::vector<int> selectActiveKernels(const std::vector<latentKernel> &kernels, int left, int top, int right,
                                     int bottom);

/// tile = mix of results[i], the plane deconvolved with trace kernels[activeKernels[i]], all of tile's shape. The
/// weight of a trace at a pixel is the product of its pair weights against the other active traces, scaled so that the
/// weights sum to 1. originX, originY: image position of tile's top left pixel.
void blendResults(const floatArray &tile, const std::vector<latentKernel> &kernels,
                  const std::vector<int> &activeKernels, const std::vector<floatArray> &results, int originX,
                  int originY);

} // namespace CorvaneDeblur
