#pragma once

#include "framework/pixels/memoryPixmap.h"
#include "stages/render/renderSettings.h"

namespace Project
{

/// Deconvolves a rectangle of the picture. `source` holds more around it than `destination` wants, as margin, and at
/// least the same planes; it stays as it is. The colour planes whose flag in settings.channels is set are deconvolved;
/// the others, and what follows them, are copied bit for bit.
///
/// originX, originY: position of the source's top left pixel in the picture, at the render scale. The estimator has its
/// kernels set; it serves one call at a time, different estimators different threads. After a stop (setStopFlag) what
/// the destination holds is undefined.
void renderRectangle(const renderSettings &settings, CorvaneDeblur::latentEstimator &estimator,
                     Sarnik::CMemoryPixmap &destination, Sarnik::CMemoryPixmap &source, int originX, int originY,
                     int colourPlanes);

} // namespace Project
