#include "store/kernelSettings.h"

namespace Project
{

void CopySettings(KernelSettings &to, const KernelSettings &from, std::uint32_t mask)
{
    const auto copy = [&](std::uint32_t bit, auto KernelSettings::*field) {
        if (mask & bit)
            to.*field = from.*field;
    };
    copy(kMaskMode, &KernelSettings::mode);
    copy(kMaskSize, &KernelSettings::size);
    copy(kMaskEstimatorOptions, &KernelSettings::estimatorOptions);
    copy(kMaskEstimatorTuningA, &KernelSettings::estimatorTuningA);
    copy(kMaskEstimatorTuningB, &KernelSettings::estimatorTuningB);
    copy(kMaskThreadWeight, &KernelSettings::threadWeight);
    copy(kMaskThreadFlag, &KernelSettings::threadFlag);
    copy(kMaskDeconvFlagA, &KernelSettings::deconvFlagA);
    copy(kMaskDeconvFlagB, &KernelSettings::deconvFlagB);
    copy(kMaskDeconvWeight, &KernelSettings::deconvWeight);
    copy(kMaskSmoothing, &KernelSettings::smoothing);
    copy(kMaskSuppression, &KernelSettings::suppression);
    copy(kMaskDeconvIterations, &KernelSettings::deconvIterations);
    copy(kMaskNoiseLevel, &KernelSettings::noiseLevel);
    copy(kMaskThreshold, &KernelSettings::maskThreshold);
    copy(kMaskForcedApply, &KernelSettings::forcedApply);
    copy(kMaskAnchor, &KernelSettings::anchorX);
    copy(kMaskAnchor, &KernelSettings::anchorY);
}

std::uint32_t NoiseLevelOfItem(int item)
{
    return item >= 2 && item <= 4 ? static_cast<std::uint32_t>(item - 2) : 3;
}

int ItemOfNoiseLevel(std::uint32_t level)
{
    return level <= 2 ? static_cast<int>(level) + 2 : 1;
}

} // namespace Project
