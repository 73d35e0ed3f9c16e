#include "tests/reference/literalPredictor.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <vector>

using namespace CorvaneDeblur;

namespace Reference
{

void literalBilateral(const floatArray &source, const floatArray &destination, float spatialSigma, float rangeSigma,
                      int radius)
{
    const floatArray g = floatArray::allocate(2 * radius + 1, 2 * radius + 1);
    gaussianFill(g, spatialSigma);
    const floatArray weightSum = floatArray::allocate(source.rows, source.cols);
    fill(weightSum, g.at(radius, radius));
    scaleInto(source, destination, g.at(radius, radius));

    // Each pair of opposite offsets once: the weight of a pixel for its neighbour is the neighbour's for the pixel.
    for (int dy = 0; dy <= radius; ++dy)
        for (int dx = dy == 0 ? 1 : -radius; dx <= radius; ++dx)
            for (int y = 0; y + dy < source.rows; ++y)
                for (int x = std::max(0, -dx); x < std::min(source.cols, source.cols - dx); ++x)
                {
                    const float pixel = source.at(y, x), neighbour = source.at(y + dy, x + dx);
                    const float d = pixel - neighbour;
                    const float e =
                        std::exp(-0.5f * d * d / (rangeSigma * rangeSigma)) * g.at(radius + dy, radius + dx);
                    destination.at(y, x) += e * neighbour;
                    weightSum.at(y, x) += e;
                    destination.at(y + dy, x + dx) += e * pixel;
                    weightSum.at(y + dy, x + dx) += e;
                }

    for (int y = 0; y < source.rows; ++y)
        for (int x = 0; x < source.cols; ++x)
            destination.at(y, x) /= weightSum.at(y, x);
}

void literalShock(const floatArray &image, float step)
{
    const floatArray magnitude = floatArray::allocate(image.rows, image.cols);
    for (int y = 0; y < image.rows; ++y)
        for (int x = 0; x < image.cols; ++x)
        {
            const float gx = image.at(y, std::min(x + 1, image.cols - 1)) - image.at(y, std::max(x - 1, 0));
            const float gy = image.at(std::min(y + 1, image.rows - 1), x) - image.at(std::max(y - 1, 0), x);
            magnitude.at(y, x) = std::sqrt(gx * gx + gy * gy);
        }
    const floatArray direction = floatArray::allocate(image.rows, image.cols);
    laplacian(image, direction, laplacianEdge::centre);
    signInto(direction, direction);
    multiplyInto(magnitude, direction, magnitude);
    combine(1.0f, image, step * 0.5f, magnitude, image);
}

float literalOrientationThreshold(const floatArray &gradX, const floatArray &gradY, const floatArray &magnitude,
                                  int groups, int minimumCount, float cap)
{
    const float top = peak(magnitude);
    if (0.0001f > top)
        return 0.0f;
    const float range = cap != 0.0f && top > cap ? cap : top;
    const float scale = 2.0f / range;

    constexpr int bins = 130050;
    std::vector<std::vector<int>> histogram(groups, std::vector<int>(bins, 0));
    const float pi = std::numbers::pi_v<float>;
    int highest = 0;
    for (int y = 0; y < magnitude.rows; ++y)
        for (int x = 0; x < magnitude.cols; ++x)
        {
            float angle = std::atan2(gradY.at(y, x), gradX.at(y, x));
            if (angle < 0.0f)
                angle += pi;
            const int group = std::clamp(static_cast<int>(angle / (pi / static_cast<float>(groups))), 0, groups - 1);
            const int bin = std::min(static_cast<int>(scale * magnitude.at(y, x) * 255.0f * 255.0f), bins - 1);
            ++histogram[group][bin];
            highest = std::max(highest, bin);
        }

    for (int b = highest; b >= 1; --b)
    {
        int fewest = magnitude.rows * magnitude.cols;
        for (std::vector<int> &counts : histogram)
        {
            fewest = std::min(fewest, counts[b]);
            counts[b - 1] += counts[b];
        }
        if (fewest >= minimumCount)
            return static_cast<float>(b) / 65025.0f / scale;
    }
    return 0.0f;
}

literalPredictor::literalPredictor(const floatArray &pixelWeights, int kernelRows, int kernelCols)
    : weights(pixelWeights), minimumCount(std::max(10, 2 * std::max(kernelRows, kernelCols)))
{
}

void literalPredictor::predict(const floatArray &latent, const floatArray &gradX, const floatArray &gradY)
{
    const floatArray working = floatArray::allocate(latent.rows, latent.cols);
    literalBilateral(latent, working, 2.0f, rangeSigma, 2);
    literalShock(working, shockStep);
    forwardDiffX(working, gradX);
    forwardDiffY(working, gradY);

    const floatArray magnitude = floatArray::allocate(latent.rows, latent.cols);
    const floatArray magnitudeSquared = floatArray::allocate(latent.rows, latent.cols);
    for (int y = 0; y < latent.rows; ++y)
        for (int x = 0; x < latent.cols; ++x)
        {
            const float gx = gradX.at(y, x), gy = gradY.at(y, x);
            magnitude.at(y, x) = std::sqrt(gx * gx + gy * gy) * weights.at(y, x);
            magnitudeSquared.at(y, x) = (gx * gx + gy * gy) * weights.at(y, x);
        }

    const bool firstCall = threshold == 0.0f;
    if (firstCall)
    {
        threshold = literalOrientationThreshold(gradX, gradY, magnitude, 4, minimumCount, std::sqrt(2.0f));
        rejected = floatArray::allocate(latent.rows, latent.cols);
        fill(rejected, 1.0f);
    }
    for (int y = 0; y < latent.rows; ++y)
        for (int x = 0; x < latent.cols; ++x)
        {
            // The weights count once on the plain magnitude, and once on the squared one in later calls.
            const bool below =
                firstCall ? !(magnitude.at(y, x) >= threshold) : threshold * threshold > magnitudeSquared.at(y, x);
            if (!below)
                rejected.at(y, x) = 0.0f;
            gradX.at(y, x) *= 1.0f - rejected.at(y, x);
            gradY.at(y, x) *= 1.0f - rejected.at(y, x);
        }

    selectionThreshold = threshold;
    rangeSigma *= 0.9f;
    shockStep *= 0.9f;
    threshold = std::max(threshold * 0.9f, 0.1f);
}

} // namespace Reference
