#pragma once

#include "deblur/estimate/floatArray.h"

namespace CorvaneDeblur
{

/// Whether anything in a grey image (0..1) is large and strong enough to be seen after a blur of `size` pixels. Without
/// that an estimator answers with a kernel that means nothing. `reduction`: how many times fewer samples a side the
/// array has than the picture that the size is counted in.
///
/// What a blur of `size` has left of an edge is a slope of that length, so the image is shrunk until the blur is some 5
/// samples wide; there a real edge shows as a step between neighbours of 3 levels of 255, while noise has averaged out.
/// (Our own rule; tried on the photographs that the measures were tried on.)
bool hasStructure(const floatArray &grey, int size, double reduction = 1.0);

} // namespace CorvaneDeblur
