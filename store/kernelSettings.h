#pragma once

#include <cstdint>

namespace Project
{

/// What one Blur Trace is estimated and rendered with. A plain record; copying it whole is ordinary assignment.
struct KernelSettings
{
    std::uint32_t mode = 0; ///< state of the estimation, 0..3; changing the bounds sets 3
    std::int32_t size = 45; ///< Blur Trace Bounds in pixels; a collection puts its own default there at once
    std::uint32_t estimatorOptions = 0; ///< bit 1: the estimator for text
    float estimatorTuningA = 0.5f;      ///< kept in files, computed with nowhere; so is B
    float estimatorTuningB = 0.3f;
    float threadWeight = 1.0f; ///< this and the flag: of the threaded estimator
    bool threadFlag = true;
    bool forcedApply = false; ///< the user wants the trace in spite of its poor mark
    bool deconvFlagA = true;  ///< A, B, weight and iterations are handed on to the deconvolution
    bool deconvFlagB = false;
    float deconvWeight = 0.0005f;
    float smoothing = 0.3f;   ///< 0..1, the slider over 100
    float suppression = 0.3f; ///< 0..1, the slider over 100
    std::uint32_t deconvIterations = 20;
    std::uint32_t noiseLevel = 3;    ///< 0 low, 1 medium, 2 high, 3 found automatically
    std::int32_t maskThreshold = -1; ///< its low byte is the threshold of the saturation mask; 255 is no mask
    std::int32_t anchorX = 0;        ///< the preview's position that belongs to the trace
    std::int32_t anchorY = 0;

    friend bool operator==(const KernelSettings &, const KernelSettings &) = default;
};

/// One bit for each field that CopySettings can take over. The anchor's two numbers share a bit; 0x4000 is unused.
enum KernelSettingsMask : std::uint32_t
{
    kMaskMode = 0x1,
    kMaskSize = 0x2,
    kMaskEstimatorOptions = 0x4,
    kMaskEstimatorTuningA = 0x8,
    kMaskEstimatorTuningB = 0x10,
    kMaskThreadWeight = 0x20,
    kMaskThreadFlag = 0x40,
    kMaskDeconvFlagA = 0x80,
    kMaskDeconvFlagB = 0x100,
    kMaskDeconvWeight = 0x200,
    kMaskSmoothing = 0x400,
    kMaskSuppression = 0x800,
    kMaskDeconvIterations = 0x1000,
    kMaskNoiseLevel = 0x2000,
    kMaskThreshold = 0x8000,
    kMaskForcedApply = 0x10000,
    kMaskAnchor = 0x20000
};

/// Copies the fields whose bits are set in mask (KernelSettingsMask values, or-ed); other bits do nothing.
void CopySettings(KernelSettings &to, const KernelSettings &from, std::uint32_t mask);

/// The noise popup shows Auto, Low, Medium, High as items 1 to 4. Any other item, and any other level, is Auto.
std::uint32_t NoiseLevelOfItem(int item);
int ItemOfNoiseLevel(std::uint32_t level);

} // namespace Project
