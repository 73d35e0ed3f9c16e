#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/greySource.h"

#include <atomic>

namespace CorvaneDeblur
{

/// A rectangle of the source in full-scale grey; samples that are not finite become 0.
floatArray readFinite(greySource &source, const regionRect &rect);

/// The grey of a whole source with its larger side at most `largestSide`: as it is if it is no larger, otherwise what
/// `resize` of the whole would give, built from strips so that the full-scale grey is never held. Samples that are not
/// finite become 0 before that. Empty if *stop became true, or the source has no pixels.
floatArray reducedGrey(greySource &source, int largestSide, const std::atomic<bool> *stop = nullptr);

} // namespace CorvaneDeblur
