#include "deblur/estimate/kernelEstimator.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/resample.h"
#include "deblur/estimate/saturationMask.h"
#include "deblur/estimate/seedKernels.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace CorvaneDeblur
{
namespace
{

constexpr float lowNoise = 1.0f / 255.0f, mediumNoise = 3.0f / 255.0f, highNoise = 6.0f / 255.0f;

float noiseFigure(noiseMode mode, float measured)
{
    switch (mode)
    {
    case noiseMode::low:
        return lowNoise;
    case noiseMode::medium:
        return mediumNoise;
    case noiseMode::high:
        return highNoise;
    case noiseMode::automatic:
        break;
    }
    // A measurement that failed (NaN) counts as no noise.
    return measured > lowNoise ? std::min(measured, highNoise) : lowNoise;
}

floatArray resized(const floatArray &a, int rows, int cols)
{
    const floatArray out = floatArray::allocate(rows, cols);
    resize(a, out);
    return out;
}

floatArray resizedKernel(const floatArray &kernel, levelSize size)
{
    const floatArray out = resized(kernel, size.rows, size.cols);
    normaliseSum(out);
    return out;
}

floatArray impulse(levelSize size)
{
    const floatArray kernel = floatArray::allocate(size.rows, size.cols);
    fill(kernel, 0.0f);
    kernel.at((size.rows - 1) / 2, (size.cols - 1) / 2) = 1.0f;
    return kernel;
}

} // namespace

kernelEstimator::kernelEstimator() : seedKernels(makeSeedKernels())
{
}

estimateStatus kernelEstimator::status() const
{
    const std::lock_guard guard(lock);
    return outcome;
}

bool kernelEstimator::fail(estimateStatus status)
{
    const std::lock_guard guard(lock);
    outcome = status;
    return false;
}

bool kernelEstimator::enterLevel(int level)
{
    const std::lock_guard guard(lock);
    if (cancelled)
    {
        outcome = estimateStatus::cancelled;
        return false;
    }
    currentLevel = level;
    currentIteration = 0;
    return true;
}

kernelEstimator::levelTask kernelEstimator::taskOfLevel(const runPlan &plan, int level, levelSize full) const
{
    const levelSize size = plan.sizes[static_cast<std::size_t>(level)];
    const floatArray &guide = plan.guide;
    const float fx = static_cast<float>(size.cols) / static_cast<float>(full.cols);
    const float fy = static_cast<float>(size.rows) / static_cast<float>(full.rows);
    const int cols = std::min(scaledSize(guide.cols, fx), guide.cols);
    const int rows = std::min(scaledSize(guide.rows, fy), guide.rows);

    levelTask task;
    task.image = resized(guide, rows, cols);
    task.weights = task.image.sameShape(plan.weights) ? plan.weights : resized(plan.weights, rows, cols);
    const float share = static_cast<float>(rows) * static_cast<float>(cols) /
                        (static_cast<float>(guide.rows) * static_cast<float>(guide.cols));
    task.sigma = std::sqrt(plan.sigma * plan.sigma * std::sqrt(share));
    task.checkStructure = level > 0;
    const int count = static_cast<int>(plan.sizes.size());
    task.sparsify = task.trackBest = count - level <= 3 && noise != noiseMode::low;
    return task;
}

bool kernelEstimator::runLevels(const runPlan &plan, int firstLevel, floatArray &current)
{
    const int count = static_cast<int>(plan.sizes.size());
    for (int level = firstLevel; level < count; ++level)
    {
        if (!enterLevel(level))
            return false;
        levelTask task = taskOfLevel(plan, level, plan.kernel);
        task.reportIterations = true;
        if (level == count - 1)
            task.reference = current;
        const levelSize size = plan.sizes[static_cast<std::size_t>(level)];
        current = level == 0 ? impulse(size) : resizedKernel(current, size);
        if (!estimateLevel(task, current))
            return false;
        if (levelKernels)
            levelKernels->push_back(cloned(current));
    }
    return true;
}

void kernelEstimator::estimate(floatArray image, byteArray mask, floatArray kernel)
{
    if (image.cols < imageToKernelRatio * kernel.cols || image.rows < imageToKernelRatio * kernel.rows)
    {
        fail(estimateStatus::imageTooSmall);
        return;
    }
    runPlan plan;
    plan.sizes = buildPyramid(kernel.cols, kernel.rows, pyramidScale, pyramidMinimum, pyramidLevel);
    if (plan.sizes.empty())
    {
        fail(estimateStatus::noSeedFits);
        return;
    }
    plan.kernel = {kernel.cols, kernel.rows};
    plan.sigma = noiseFigure(noise, noiseLevel);
    plan.weights = floatArray::allocate(image.rows, image.cols);
    const int count = static_cast<int>(plan.sizes.size());
    {
        const std::lock_guard guard(lock);
        levelCount = count;
        iterationsPerLevel = iterations;
    }
    if (mask.empty())
    {
        plan.guide = image;
        fill(plan.weights, 1.0f);
    }
    else
    {
        plan.guide = floatArray::allocate(image.rows, image.cols);
        applySaturationMask(mask, image, kernel.rows, kernel.cols, plan.weights, plan.guide);
    }

    floatArray current;
    const int seedCount = std::min(count, randomKernelLevel);
    if (seedCount > 0)
        current = seedSearch(plan, seedCount);
    if ((seedCount > 0 && current.empty()) || !runLevels(plan, seedCount, current))
        return;

    if (pyramidLevel == 0)
        copyTo(current, kernel);
    else
    {
        resize(current, kernel);
        normaliseSum(kernel);
    }
    const std::lock_guard guard(lock);
    currentLevel = count;
    currentIteration = 0;
    outcome = estimateStatus::finished;
}

floatArray kernelEstimator::seedSearch(const runPlan &plan, int seedCount)
{
    {
        const std::lock_guard guard(lock);
        seedLevels = seedCount;
    }
    std::array<floatArray, 12> candidates;
    std::array<bool, 12> alive{};
    int best = -1;
    double bestScore = 0.0;
    for (int level = 0; level < seedCount; ++level)
    {
        const levelSize size = plan.sizes[static_cast<std::size_t>(level)];
        const bool finest = level + 1 == static_cast<int>(plan.sizes.size());
        levelTask task = taskOfLevel(plan, level, plan.sizes.back());
        for (std::size_t i = 0; i < candidates.size(); ++i)
        {
            if (!enterLevel(level))
                return {};
            {
                const std::lock_guard guard(lock);
                seedFraction = static_cast<float>(i) / 12.0f;
            }
            // A seed enters at the level of its own size; one whose size the pyramid does not have never runs.
            const bool enters = seedKernels[i].cols == size.cols;
            alive[i] = alive[i] || enters;
            if (!alive[i])
                continue;
            task.reference = finest ? candidates[i] : floatArray();
            candidates[i] =
                enters ? placedSeed(seedKernels[i], size.rows, size.cols) : resizedKernel(candidates[i], size);
            double score = 0.0;
            task.score = level + 1 == seedCount ? &score : nullptr;
            if (!estimateLevel(task, candidates[i]))
                return {};
            // A latent image without any change along an axis has no score (0 / 0): it never beats another.
            if (std::isnan(score))
                score = std::numeric_limits<double>::infinity();
            if (task.score && (best < 0 || score < bestScore))
            {
                best = static_cast<int>(i);
                bestScore = score;
            }
        }
        // Both at once: between the two, progress would seem to fall.
        const std::lock_guard guard(lock);
        currentLevel = level + 1;
        seedFraction = 0.0f;
    }
    if (best >= 0)
        return candidates[static_cast<std::size_t>(best)];
    fail(estimateStatus::noSeedFits);
    return {};
}

} // namespace CorvaneDeblur
