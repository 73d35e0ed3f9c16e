#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/greySource.h"
#include "deblur/estimate/kernelEstimator.h"
#include "deblur/estimate/regionRect.h"

#include <atomic>
#include <optional>
#include <vector>

namespace CorvaneDeblur
{

/// Regions found by autoRegions.
struct autoRegionList
{
    std::vector<regionRect> regions;
    int size = 0;                ///< the trace size that they were found with
    bool smallSizeTried = false; ///< nothing was found at the size asked for, and the search went on with size 10
};

/// What a photograph tells before any blur is estimated: its noise, a trace size, regions worth estimating.
///
/// The constructor reads the source once, reduced to at most 1000 pixels a side, and measures the noise on a full-scale
/// patch; the rest works on that and reads windows of the source where it says so. The source must outlive the object.
/// When `stop` is given and becomes true, work ends within a fraction of a second and answers hold nothing.
/// One thread at a time; inside, all threads of the current tbb arena are used.
class analysedImage
{
public:
    explicit analysedImage(greySource &source, const std::atomic<bool> *stop = nullptr);

    /// Whether *stop became true.
    bool stopped() const;
    /// The whole image in grey, at most 1000 pixels a side.
    const floatArray &analysis() const { return reduced; }
    /// Standard deviation of the noise (noiseMeasure.h), and the patch that it was measured on.
    float noise() const { return noiseLevel; }
    const regionRect &noisePatch() const { return patch; }

    /// Trace size for this image: the mean blur size of the windows of 1500 x 1500 pixels around up to three suggested
    /// regions, or around the middle if there is none. Reads those windows at full scale. Odd or even, at least 31,
    /// and not limited by maxKernelSize. 0 if stopped.
    int findDefaultSize(noiseMode mode) const;

    /// Another region for a trace of the given size, at most 2000 x 2000 pixels, beside the existing ones; none if no
    /// place qualifies. The first one prefers the middle of the image.
    std::optional<regionRect> addSuggestedRegion(int size, noiseMode mode,
                                                 const std::vector<regionRect> &existing) const;
    /// The same near a point, whatever exists.
    std::optional<regionRect> suggestRegionAt(imagePoint point, int size, noiseMode mode) const;

    /// Up to `count` regions, one after the other, beside the existing ones. If nothing at all is found, the search
    /// goes on once with a size of 10: a small box may fit where a large one does not.
    autoRegionList autoRegions(int count, int size, noiseMode mode, const std::vector<regionRect> &existing = {}) const;

private:
    int blurSizeAround(int centreX, int centreY) const;

    greySource &image;
    const std::atomic<bool> *stop;
    floatArray reduced;
    regionRect patch;
    float noiseLevel = 0.0f;
};

} // namespace CorvaneDeblur
