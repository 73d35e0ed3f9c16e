#pragma once

#include "cli/greyOfPhoto.h"
#include "cli/runContext.h"
#include "cli/traceRegion.h"
#include "deblur/estimate/autoTraces.h"

#include <memory>
#include <utility>
#include <vector>

namespace Stillmark
{

/// Measures a part of a photo when first asked, for the commands that need to know its noise, blur size or good
/// regions. Regions and points are in pixels of the photo. Throws Platform::cancelled after Ctrl-C. One thread at a
/// time.
class photoAnalysis
{
public:
    photoAnalysis(const photo &analysed, const rectangle &part, runContext &run);

    float noise();
    rectangle noisePatch();

    /// Size of the largest blur to look for: odd and no more than a third of the picture.
    int blurSize(CorvaneDeblur::noiseMode noise);

    /// Where blurs of one size may be found, best first.
    struct regionList
    {
        std::vector<rectangle> regions;
        int size = 0; ///< as asked for, or smaller if nothing was found for that
    };
    regionList regions(int count, int size, CorvaneDeblur::noiseMode noise);
    /// At most one region, around a point.
    std::vector<rectangle> regionNear(std::pair<int, int> point, int size, CorvaneDeblur::noiseMode noise);

    /// Whether anything in the picture is large and strong enough to be seen after a blur of that size.
    bool hasStructure(int size);

private:
    CorvaneDeblur::analysedImage &measured();

    rectangle fromArea(const CorvaneDeblur::regionRect &region) const;

    const rectangle area;
    runContext &context;
    greyOfArea source;
    std::unique_ptr<CorvaneDeblur::analysedImage> analysis;
};

/// Smallest picture whose regions can be searched; of a smaller one the whole is taken.
constexpr int smallestSearchedSide = 160;

} // namespace Stillmark
