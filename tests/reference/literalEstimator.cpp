#include "tests/reference/literalEstimator.h"

#include "deblur/deconv/fastSize.h"
#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/resample.h"
#include "tests/reference/literalFastDeconvolver.h"
#include "tests/reference/literalKernelSolver.h"
#include "tests/reference/literalPredictor.h"
#include "tests/reference/spectra.h"

#include <algorithm>
#include <cmath>
#include <utility>

using namespace CorvaneDeblur;

namespace Reference
{
namespace
{

int rounded(double value)
{
    return static_cast<int>(value + 0.5);
}

/// (cols, rows) of the levels, coarsest first.
std::vector<std::pair<int, int>> pyramidSizes(int cols, int rows, int pyramidLevel)
{
    const double scale = 0.7071f; // not the square root of one half: some sizes would round otherwise
    const int minimumSize = 3;
    const int smaller = std::min(cols, rows);
    int n = rounded(std::log(static_cast<double>(smaller) / minimumSize) / std::log(1.0 / scale));
    while (rounded(std::pow(scale, n - 1) * smaller) > minimumSize)
        ++n;

    std::vector<std::pair<int, int>> sizes;
    for (int k = n - 1; k >= pyramidLevel; --k)
    {
        std::pair<int, int> size(cols, rows);
        if (k >= 1)
        {
            const float f = static_cast<float>(std::pow(scale, k));
            size = {rounded(static_cast<float>(cols) * f) | 1, rounded(static_cast<float>(rows) * f) | 1};
        }
        if (sizes.empty() || sizes.back() != size)
            sizes.push_back(size);
    }
    return sizes;
}

double kernelSparsity(const floatArray &k)
{
    double sum = 0.0;
    for (int y = 0; y < k.rows; ++y)
        for (int x = 0; x < k.cols; ++x)
            sum += std::sqrt(std::abs(static_cast<double>(k.at(y, x))));
    return sum / std::pow(static_cast<double>(k.rows) * k.cols, 0.25);
}

/// Mean squared difference at the reference's size.
double kernelDistance(const floatArray &k, const floatArray &reference)
{
    const floatArray resized = floatArray::allocate(reference.rows, reference.cols);
    resize(k, resized);
    normaliseSum(resized);
    double sum = 0.0;
    for (int y = 0; y < reference.rows; ++y)
        for (int x = 0; x < reference.cols; ++x)
        {
            const double d = static_cast<double>(resized.at(y, x)) - reference.at(y, x);
            sum += d * d;
        }
    return sum / (static_cast<double>(reference.rows) * reference.cols);
}

/// 1 where the kernel is near zero, falling for strong samples; very large for the samples to be driven out.
floatArray sampleWeights(const floatArray &kernel, bool sparsify)
{
    const floatArray weights = floatArray::allocate(kernel.rows, kernel.cols);
    const float floor = 0.01f / static_cast<float>(kernel.rows * kernel.cols);
    const float weakest = 0.02f * peak(kernel);
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
        {
            const float k = kernel.at(y, x);
            weights.at(y, x) = sparsify && k < weakest ? 100000.0f : floor / std::max(floor, std::abs(k));
        }
    return weights;
}

struct levelInput
{
    floatArray image, weights;
    floatArray reference; ///< kernel of the level below; empty but at the last level
    float sigma = 0.0f;
    bool track = false;
};

void estimateLevel(const estimatorSettings &settings, const levelInput &level, const floatArray &kernel)
{
    const floatArray &image = level.image;
    const int gridCols = fastSize(image.cols + kernel.cols - 1), gridRows = fastSize(image.rows + kernel.rows - 1);
    const floatArray padded = floatArray::allocate(gridRows, gridCols);
    taperedExtension(image, padded, kernel.cols, kernel.rows);

    literalFastDeconvolver deconvolver(padded, settings.derivativesOrder);
    literalPredictor predictor(level.weights, kernel.rows, kernel.cols);
    literalKernelSolver solver(padded, settings.derivativesOrder);
    const floatArray latent = floatArray::allocate(image.rows, image.cols);
    const floatArray gradX = floatArray::allocate(image.rows, image.cols);
    const floatArray gradY = floatArray::allocate(image.rows, image.cols);

    float lowPassSigma = 0.8f;
    const float lowPassDecay = std::pow(0.25f, 1.0f / static_cast<float>(settings.iterations - 1));
    const float noise = std::max(level.sigma, 1.0f / 255.0f);
    const float area = static_cast<float>(kernel.rows * kernel.cols);
    const float perSample = noise / (50.0f / area);
    const float perEdge = noise / (1.0f / (5.0f * static_cast<float>(std::max(kernel.rows, kernel.cols))));
    double bestSparsity = 1e7, bestDistance = 1e7;
    floatArray saved;

    for (int pass = 0; pass < settings.iterations; ++pass)
    {
        const floatArray lowPass = gaussianSpectrum(lowPassSigma, gridRows, gridCols);
        deconvolver.lowPass = lowPass;
        deconvolver.solve(kernel, latent, noise * noise / 0.000144f);
        predictor.predict(latent, gradX, gradY);
        solver.kernelWeights = sampleWeights(kernel, level.track && pass > 0);
        solver.lowPass = lowPass;
        solver.solve(gradX, gradY, kernel, perSample * perSample, perEdge * perEdge);
        literalCleanKernel(kernel);

        if (level.track)
        {
            const double sparsity = kernelSparsity(kernel);
            bool worse = sparsity > bestSparsity;
            if (!worse && !level.reference.empty() && pass > 0)
            {
                const double distance = kernelDistance(kernel, level.reference);
                worse = bestDistance <= distance;
                bestDistance = distance;
            }
            if (worse)
            {
                copyTo(saved, kernel);
                break;
            }
            bestSparsity = sparsity;
            saved = cloned(kernel);
        }
        lowPassSigma *= lowPassDecay;
    }
    literalRecentre(kernel);
}

/// A fresh array with src at another size.
floatArray resizedTo(const floatArray &src, int rows, int cols)
{
    const floatArray dst = floatArray::allocate(rows, cols);
    resize(src, dst);
    return dst;
}

} // namespace

void literalEstimate(const estimatorSettings &settings, const floatArray &guide, const floatArray &weights,
                     const floatArray &kernel, std::vector<floatArray> *levelKernels)
{
    const auto sizes = pyramidSizes(kernel.cols, kernel.rows, settings.pyramidLevel);
    const int levelCount = static_cast<int>(sizes.size());
    floatArray current;
    for (int i = 0; i < levelCount; ++i)
    {
        const auto [cols, rows] = sizes[i];
        const float fx = static_cast<float>(cols) / static_cast<float>(kernel.cols);
        const float fy = static_cast<float>(rows) / static_cast<float>(kernel.rows);
        const int imageCols = std::min(rounded(static_cast<float>(guide.cols) * fx), guide.cols);
        const int imageRows = std::min(rounded(static_cast<float>(guide.rows) * fy), guide.rows);

        levelInput level;
        level.image = resizedTo(guide, imageRows, imageCols);
        level.weights = resizedTo(weights, imageRows, imageCols);
        if (i == levelCount - 1)
            level.reference = current;
        const float share = static_cast<float>(imageRows * imageCols) / static_cast<float>(guide.rows * guide.cols);
        level.sigma = std::sqrt(settings.sigma * settings.sigma * std::sqrt(share));
        level.track = settings.trackFinestLevels && levelCount - i <= 3;

        if (i == 0)
        {
            current = floatArray::allocate(rows, cols);
            fill(current, 0.0f);
            current.at((rows - 1) / 2, (cols - 1) / 2) = 1.0f;
        }
        else
        {
            current = resizedTo(current, rows, cols);
            normaliseSum(current);
        }
        estimateLevel(settings, level, current);
        if (levelKernels != nullptr)
            levelKernels->push_back(cloned(current));
    }

    if (settings.pyramidLevel == 0)
        copyTo(current, kernel);
    else
    {
        resize(current, kernel);
        normaliseSum(kernel);
    }
}

} // namespace Reference
