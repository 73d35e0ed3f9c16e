#pragma once

#include "deblur/estimate/floatArray.h"
#include "framework/pixels/toGrey.h"

namespace Project
{

/// The grey values of a rectangle for the estimation, and, unless `mask` is empty, 1 in it where a sample exceeds the
/// limits of `about`. `source` is as ToGrey wants it, the rectangle lies within it, and the arrays have its height and
/// width. A float sample that is no number counts as 0, one out of all proportion (beyond 1000) as that limit. Throws
/// CError for a combination of planes that has no grey.
void ReadRegionGrey(Sarnik::CPixmap &source, const Sarnik::CRect &rect, const Sarnik::CGreySource &about,
                    const CorvaneDeblur::floatArray &grey, const CorvaneDeblur::byteArray &mask);

} // namespace Project
