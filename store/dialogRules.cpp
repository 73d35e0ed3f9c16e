#include "store/dialogRules.h"

#include "store/channelList.h"

namespace Project
{

namespace
{

std::uint32_t FirstUnlessWithin(int item, int items)
{
    return item >= 1 && item <= items ? static_cast<std::uint32_t>(item - 1) : 0;
}

void CopyExperimental(PParams &to, const PParams &from)
{
    to.pyramidSmooth = from.pyramidSmooth;
    to.smoothParameter1 = from.smoothParameter1;
    to.smoothParameter2 = from.smoothParameter2;
    to.predictorDenoise = from.predictorDenoise;
    to.pyramidLevel = from.pyramidLevel;
    to.tileSize = from.tileSize;
    to.derivativesType = from.derivativesType;
    to.deconvType = from.deconvType;
    to.randomKernelLevel = from.randomKernelLevel;
}

} // namespace

std::uint32_t PyramidSmoothOfItem(int item)
{
    return FirstUnlessWithin(item, 3);
}

std::uint32_t PredictorDenoiseOfItem(int item)
{
    return FirstUnlessWithin(item, 2);
}

std::uint32_t DerivativesTypeOfItem(int item)
{
    return FirstUnlessWithin(item, 2);
}

std::uint32_t DeconvTypeOfItem(int item)
{
    return FirstUnlessWithin(item, 2) + 1;
}

std::uint32_t TileSizeOfItem(int item)
{
    return item >= 1 && item <= 5 ? 32u << item : 128;
}

void FillExperimental(PParams &edited, const PParams &real)
{
    CopyExperimental(edited, real);
    edited.deconvChannels = real.deconvChannels;
}

ExperimentalOk AcceptExperimental(PParams &edited, const std::string &channelsText, PParams &real)
{
    CopyExperimental(real, edited);
    if (!ParseChannels(channelsText, edited.deconvChannels))
        return ExperimentalOk::InvalidChannels;
    real.deconvChannels = edited.deconvChannels;
    return ExperimentalOk::Closes;
}

void ResetExperimental(PParams &edited)
{
    edited.pyramidSmooth = 0;
    edited.smoothParameter1 = 2.0f;
    edited.smoothParameter2 = 0.0f;
    edited.predictorDenoise = 0;
    edited.pyramidLevel = 0;
    edited.tileSize = 512;
    edited.deconvType = 2;
    edited.randomKernelLevel = 0;
}

bool AcceptPreferences(bool accuratePreview, PParams &real)
{
    if (real.accuratePreview == accuratePreview)
        return false;
    real.accuratePreview = accuratePreview;
    return true;
}

} // namespace Project
