#pragma once

#include "deblur/estimate/floatArray.h"

namespace CorvaneDeblur
{

/// One Blur Trace as the deconvolution sees it.
struct latentKernel
{
    floatArray kernel;   ///< at the render scale; setKernels scales it to a sum of 1
    int regionLeft = 0;  ///< the trace's estimation region in pixels of the image at the render scale,
    int regionTop = 0;   ///< right and bottom exclusive; its centre decides where several traces
    int regionRight = 0; ///< hand over to one another
    int regionBottom = 0;
    float smoothing = 0.3f;   ///< 0 sharp and noisy .. 1 smooth
    float suppression = 0.3f; ///< 0 .. 1: pull towards the blurred input against ringing
    bool isManual = false;    ///< drawn by hand: takes no part in alignKernels
};

} // namespace CorvaneDeblur
