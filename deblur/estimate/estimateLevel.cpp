#include "deblur/deconv/fastSize.h"
#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/blurredGrid.h"
#include "deblur/estimate/fastDeconvolver.h"
#include "deblur/estimate/gradientPredictor.h"
#include "deblur/estimate/kernelEstimator.h"
#include "deblur/estimate/kernelMeasures.h"
#include "deblur/estimate/kernelSolver.h"
#include "deblur/estimate/resample.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{
namespace
{

constexpr float firstLowPassSigma = 0.8f;
constexpr float sparsifiedWeight = 100000.0f;

floatArray extendedImage(const floatArray &image, const floatArray &kernel)
{
    const floatArray padded =
        floatArray::allocate(fastSize(image.rows + kernel.rows - 1), fastSize(image.cols + kernel.cols - 1));
    taperedExtension(image, padded, kernel.cols, kernel.rows);
    return padded;
}

/// 1 where the kernel is near zero, falling for strong samples; with `sparsify` very much more where the sample is
/// below 2% of the peak, which drives it to zero.
void weighSamples(const floatArray &kernel, bool sparsify, const floatArray &weights)
{
    const float floor = 0.01f / (static_cast<float>(kernel.rows) * static_cast<float>(kernel.cols));
    const float weak = sparsify ? 0.02f * peak(kernel) : 0.0f;
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
        {
            const float k = kernel.row(y)[x];
            weights.row(y)[x] = sparsify && k < weak ? sparsifiedWeight : floor / std::max(floor, std::fabs(k));
        }
}

/// Watches a level's kernels and remembers the best: one is worse that is less sparse than the best, or (from the
/// second pass on, with a reference) no nearer to the kernel of the level below.
class bestKernel
{
public:
    bestKernel(const floatArray &kernel, const floatArray &levelBelow)
        : reference(levelBelow), saved(floatArray::allocate(kernel.rows, kernel.cols))
    {
    }

    /// True while the kernel is not worse; otherwise the kernel becomes the best one again.
    bool accept(const floatArray &kernel, int pass)
    {
        const double sparsity = kernelSparsity(kernel);
        if (sparsity > bestSparsity)
            return restore(kernel);
        if (!reference.empty() && pass > 0)
        {
            const double distance = kernelDistance(kernel, reference);
            if (bestDistance <= distance)
                return restore(kernel);
            bestDistance = distance;
        }
        bestSparsity = sparsity;
        copyTo(kernel, saved);
        return true;
    }

private:
    bool restore(const floatArray &kernel) const
    {
        copyTo(saved, kernel);
        return false;
    }

    floatArray reference, saved;
    double bestSparsity = 1e7, bestDistance = 1e7;
};

} // namespace

bool kernelEstimator::enterPass(int pass, bool report)
{
    const std::lock_guard guard(lock);
    if (cancelled)
    {
        outcome = estimateStatus::cancelled;
        return false;
    }
    if (report)
        currentIteration = pass + 1;
    return true;
}

bool kernelEstimator::estimateLevel(const levelTask &task, const floatArray &kernel)
{
    const floatArray &image = task.image;
    const floatArray latent = floatArray::allocate(image.rows, image.cols);
    const floatArray gradX = floatArray::allocate(image.rows, image.cols);
    const floatArray gradY = floatArray::allocate(image.rows, image.cols);
    const derivativeOrder order = derivativesOrder == 1 ? derivativeOrder::second : derivativeOrder::first;
    const blurredGrid blurred(extendedImage(image, kernel), workers::all);
    fastDeconvolver deconvolver(blurred, order);
    gradientPredictor predictor(image.rows, image.cols, kernel.rows, kernel.cols, task.weights);
    kernelSolver solver(blurred, kernel.rows, kernel.cols, order);
    solver.kernelWeights = floatArray::allocate(kernel.rows, kernel.cols);
    bestKernel best(kernel, task.reference);

    // Regularisation follows the noise and the kernel's size.
    const float level = std::max(task.sigma, 1.0f / 255.0f);
    const float mu = level * level / 0.000144f;
    const float area = static_cast<float>(kernel.rows) * static_cast<float>(kernel.cols);
    const float longest = static_cast<float>(std::max(kernel.rows, kernel.cols));
    const float sampleRoot = level / (50.0f / area), smoothRoot = level / (1.0f / (5.0f * longest));

    // Early passes see coarse structure only: the low-pass narrows from 0.8 to 0.2 over the level.
    float lowPassSigma = firstLowPassSigma;
    const float lowPassDecay = std::pow(0.25f, 1.0f / static_cast<float>(iterations - 1));
    for (int pass = 0; pass < iterations; ++pass)
    {
        if (!enterPass(pass, task.reportIterations))
            return false;
        const lowPassProfile lowPass = gaussianLowPass(blurred.grid, lowPassSigma);
        deconvolver.setLowPass(lowPass);
        deconvolver.solve(kernel, latent, mu);
        predictor.predict(latent, gradX, gradY);
        // The predictor keeps its threshold at 0.1 or more, so this guard speaks only if that floor is ever lowered.
        if (task.checkStructure && pass == 0 && 0.05f > predictor.threshold)
            return fail(estimateStatus::noStructure);
        weighSamples(kernel, task.sparsify && pass > 0, solver.kernelWeights);
        solver.setLowPass(lowPass);
        solver.solve(gradX, gradY, kernel, sampleRoot * sampleRoot, smoothRoot * smoothRoot);
        kernelSolver::cleanKernel(kernel);
        if (task.trackBest && !best.accept(kernel, pass))
            break;
        lowPassSigma *= lowPassDecay;
    }
    if (task.score)
        *task.score = gradientSparsity(latent);
    kernelSolver::recentre(kernel);
    return true;
}

} // namespace CorvaneDeblur
