#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/kernelEstimatorThread.h"
#include "deblur/estimate/kernelPyramid.h"

#include <array>
#include <vector>

namespace CorvaneDeblur
{

/// How an estimation ended.
enum class estimateStatus
{
    finished = 0,
    imageTooSmall = 1, ///< the image is smaller than imageToKernelRatio times the kernel on an axis
    noStructure = 2,   ///< no usable edges
    cancelled = 3,
    noSeedFits = 4, ///< nothing to start with: no seed has the size of a level that the seed search covers, or more
                    ///< levels are skipped than there are
};

/// The figure of the source's noise that the estimation's strengths follow.
enum class noiseMode
{
    low = 0,      ///< 1/255; the finest levels neither sparsify nor stop early
    medium = 1,   ///< 3/255
    high = 2,     ///< 6/255
    automatic = 3 ///< the measured level, limited to 1/255 .. 6/255
};

/// Recovers one blur kernel from one grey image, knowing only the kernel's largest size: coarse to fine over a pyramid,
/// each level an alternation of edge prediction and kernel solving after S. Cho and S. Lee, "Fast motion deblurring",
/// ACM Transactions on Graphics 28(5), 2009, with regularisation, saturation and seed rules of our own.
class kernelEstimator : public kernelEstimatorThread
{
public:
    kernelEstimator();

    /// Settings; write them before the run.
    int pyramidLevel = 0; ///< number of finest levels not run; the result is then enlarged
    noiseMode noise = noiseMode::medium;
    float noiseLevel = 1.0f / 255.0f; ///< measured standard deviation of the noise, for noiseMode::automatic
    int derivativesOrder = 0;         ///< 0 first order, 1 second order derivatives in the data term
    int imageToKernelRatio = 1;       ///< the image is at least this many times the kernel on each axis
    int randomKernelLevel = 0;        ///< coarsest levels handled by the seed search
    int iterations = 7;               ///< alternations per level

    /// Runs the estimation on the calling thread; its loops use all threads of the current tbb arena.
    ///
    /// image: grey, 0..1. mask: the image's shape, 1 at saturated pixels, or empty. kernel: allocated by the caller,
    /// odd and at least 3 on both axes; its shape is the largest blur looked for. It receives the result (sum 0.965 to
    /// 1, never negative) only when the status is `finished`, and stays untouched otherwise.
    void estimate(floatArray image, byteArray mask, floatArray kernel);

    /// The outcome; read it after the run.
    estimateStatus status() const;
    /// When set before a run, receives a copy of the kernel that each level ended with, coarsest first.
    std::vector<floatArray> *levelKernels = nullptr;

private:
    /// What a level is given.
    struct levelTask
    {
        floatArray image, weights;
        float sigma = 0.0f; ///< noise figure at this level's scale
        bool checkStructure = false, sparsify = false, trackBest = false, reportIterations = false;
        floatArray reference;    ///< kernel of the level below, or empty
        double *score = nullptr; ///< receives the gradient sparsity of the latent image
    };
    /// What all levels of a run share.
    struct runPlan
    {
        floatArray guide, weights;
        float sigma = 0.0f;
        std::vector<levelSize> sizes; ///< coarsest first
        levelSize kernel;             ///< the caller's; larger than the last of sizes when levels are skipped
    };

    bool fail(estimateStatus status);
    bool enterLevel(int level);
    bool enterPass(int pass, bool report);
    /// full: the kernel size at which a level's image has its full size.
    levelTask taskOfLevel(const runPlan &plan, int level, levelSize full) const;
    bool runLevels(const runPlan &plan, int firstLevel, floatArray &current);
    /// Improves `kernel`; false when it was cancelled, with the status set.
    bool estimateLevel(const levelTask &task, const floatArray &kernel);
    /// Runs the seeds through levels 0 to seedCount - 1; the kernel whose latent image has the sparsest gradients, or
    /// an empty array when the run failed or no seed fits.
    floatArray seedSearch(const runPlan &plan, int seedCount);

    std::array<floatArray, 12> seedKernels;
    estimateStatus outcome = estimateStatus::finished;
};

} // namespace CorvaneDeblur
