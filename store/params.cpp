#include "store/params.h"

#include <algorithm>
#include <numeric>

namespace Project
{

PParams::PParams(int planeCount) : deconvChannels(static_cast<std::size_t>(std::max(planeCount, 0))), planes(planeCount)
{
    std::iota(deconvChannels.begin(), deconvChannels.end(), 0u);
}

PParams::PParams(const PParams &other) : PParams(other.planes)
{
    version = other.version;
    showPreview = other.showPreview;
    showRegions = other.showRegions;
    fineResult = other.fineResult;
    lastFolder = other.lastFolder;
    lastWorkspaceName = other.lastWorkspaceName;
    lastTraceName = other.lastTraceName;
    lastTraceExtension = other.lastTraceExtension;
    overflowColour = other.overflowColour;
    autoTraceCount = other.autoTraceCount;
    advancedOpen = other.advancedOpen;
    previewWindowOpen = other.previewWindowOpen;
    accuratePreview = other.accuratePreview;
    randomKernelLevel = other.randomKernelLevel;
    previewCap = other.previewCap;
}

void CopySelected(PParams &to, const PParams &from)
{
    to.showPreview = from.showPreview;
    to.showRegions = from.showRegions;
    to.accuratePreview = from.accuratePreview;
    to.lastFolder = from.lastFolder;
    to.tileSize = from.tileSize;
    to.derivativesType = from.derivativesType;
    to.overflowColour = from.overflowColour;
    to.autoTraceCount = from.autoTraceCount;
    to.advancedOpen = from.advancedOpen;
    to.fineResult = from.fineResult;
    to.previewWindowOpen = from.previewWindowOpen;
}

} // namespace Project
