#include "deblur/estimate/suggestRegion.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/finiteSamples.h"
#include "deblur/estimate/fourier.h"
#include "deblur/estimate/regionScores.h"
#include "deblur/estimate/resample.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace CorvaneDeblur
{
namespace
{

/// Sizes of a search: the source's, the blur's, and how both look on the thumbnail.
struct searchScale
{
    int imageCols, imageRows;
    int kernelCols, kernelRows; ///< at least 31
    int largestSide;            ///< of the kernel
    int thumbCols, thumbRows;
    int kernelExtent; ///< the blur's length on the thumbnail, about 5
    int angleBins;    ///< directions told apart: a longer blur needs edges in more of them
};

searchScale scaleOf(int imageCols, int imageRows, int kernelCols, int kernelRows)
{
    searchScale scale{};
    scale.imageCols = imageCols;
    scale.imageRows = imageRows;
    scale.kernelCols = std::max(kernelCols, 31);
    scale.kernelRows = std::max(kernelRows, 31);
    scale.largestSide = std::max(scale.kernelCols, scale.kernelRows);
    const float s = std::min({1.0f, 5.0f / static_cast<float>(scale.largestSide),
                              1000.0f / static_cast<float>(std::max(imageCols, imageRows))});
    const auto scaled = [s](int length) { return static_cast<int>(static_cast<float>(length) * s + 0.5f); };
    scale.thumbCols = scaled(imageCols);
    scale.thumbRows = scaled(imageRows);
    scale.kernelExtent = std::max(scaled(scale.kernelCols), scaled(scale.kernelRows));
    scale.angleBins = std::max(4, static_cast<int>(static_cast<float>(scale.largestSide) / 10.0f + 0.5f));
    return scale;
}

/// One rectangle size to try, as a multiple of the kernel.
struct boxSize
{
    int regionCols, regionRows; ///< the rectangle in source pixels
    int halfCols, halfRows;     ///< half of it on the thumbnail
    int cols, rows;             ///< the box on the thumbnail: smaller, as an estimation uses a rectangle's rim less
};

bool boxFor(const searchScale &scale, int factor, boxSize &box)
{
    const auto onThumb = [](double length, int thumb, int image) {
        return static_cast<int>(length * thumb / image + 0.5);
    };
    box.regionCols = factor * scale.kernelCols;
    box.regionRows = factor * scale.kernelRows;
    box.halfCols = onThumb(box.regionCols, scale.thumbCols, scale.imageCols) / 2;
    box.halfRows = onThumb(box.regionRows, scale.thumbRows, scale.imageRows) / 2;
    box.cols = onThumb((factor - 2.0) * scale.kernelCols, scale.thumbCols, scale.imageCols);
    box.rows = onThumb((factor - 2.0) * scale.kernelRows, scale.thumbRows, scale.imageRows);
    // A box of no samples (a very large image, a kernel narrow in one direction) holds no edge.
    return 2 * box.halfCols + 1 < scale.thumbCols && 2 * box.halfRows + 1 < scale.thumbRows && box.cols > 0 &&
           box.rows > 0;
}

/// The rectangle sizes that fit the image, best first: the size that suits it, the larger ones, then the smaller ones.
std::vector<boxSize> boxesToTry(const searchScale &scale, noiseMode noise, float noiseLevel)
{
    int base = std::clamp(std::max(scale.imageCols, scale.imageRows) / (scale.largestSide * 3), 7, 20);
    if (noise == noiseMode::high || (noise == noiseMode::automatic && noiseLevel > 3.0f / 255.0f))
        base += 2; // noise averages out over more pixels

    std::vector<boxSize> boxes;
    const auto tryFactor = [&](int factor) {
        boxSize box{};
        if (boxFor(scale, factor, box))
            boxes.push_back(box);
    };
    for (int factor = base; factor <= 22; ++factor)
        tryFactor(factor);
    for (int factor = base - 1; factor >= 5; --factor)
        tryFactor(factor);
    return boxes;
}

floatArray thumbnailOf(const floatArray &grey, const searchScale &scale)
{
    const floatArray small = floatArray::allocate(scale.thumbRows, scale.thumbCols);
    resize(grey, small);
    zeroNonFinite(small);
    const floatArray gaussian = floatArray::allocate(5, 5);
    gaussianFill(gaussian, 5.0f / 6.0f);
    convolveFFT(small, small, gaussian, borderMode::replicate);
    return small;
}

/// Clears the edges inside the existing regions, so that these attract no new one.
void clearRegions(const edgeMaps &edges, const searchScale &scale, const std::vector<regionRect> &existing)
{
    const int cols = scale.thumbCols, rows = scale.thumbRows;
    const double fx = (cols - 1.0) / (scale.imageCols - 1.0);
    const double fy = (rows - 1.0) / (scale.imageRows - 1.0);
    for (const regionRect &region : existing)
    {
        const int left = std::clamp(static_cast<int>(region.x * fx + 0.5), 0, cols);
        const int top = std::clamp(static_cast<int>(region.y * fy + 0.5), 0, rows);
        const int width = std::clamp(static_cast<int>(region.width * fx + 0.5), 0, cols - left);
        const int height = std::clamp(static_cast<int>(region.height * fy + 0.5), 0, rows - top);
        for (int y = top; y < top + height; ++y)
        {
            std::fill_n(edges.magnitude.row(y) + left, width, 0.0f);
            std::fill_n(edges.angleBin.row(y) + left, width, -1);
        }
    }
}

/// What a position's score is multiplied by, or an empty array for no preference.
floatArray priorFor(const searchScale &scale, regionMode mode, imagePoint point)
{
    if (mode == regionMode::more)
        return {};
    const floatArray prior = floatArray::allocate(scale.thumbRows, scale.thumbCols);
    const float side = static_cast<float>(std::max(scale.thumbCols, scale.thumbRows));
    if (mode == regionMode::first)
    {
        gaussianFill(prior, side * 0.5f);
    }
    else
    {
        const auto onThumb = [](int position, int thumb, int image) {
            return static_cast<int>(std::clamp(position, 0, image - 1) * (thumb - 1.0) / (image - 1.0) + 0.5);
        };
        gaussianFill(prior, side * 0.25f, 0.0f, static_cast<float>(onThumb(point.x, scale.thumbCols, scale.imageCols)),
                     static_cast<float>(onThumb(point.y, scale.thumbRows, scale.imageRows)));
    }
    scaleInto(prior, prior, 1.0f / peak(prior));
    if (mode == regionMode::first)
        for (int y = 0; y < prior.rows; ++y)
            for (int x = 0; x < prior.cols; ++x)
                prior.at(y, x) += 1.0f;
    return prior;
}

/// The positions whose score suffices, in row order.
std::vector<regionCandidate> candidatesOf(const floatArray &scores, const floatArray &prior, const boxSize &box,
                                          int angleBins)
{
    const float required = std::max(4.0f, static_cast<float>(angleBins) * 3.0f * 0.25f);
    std::vector<regionCandidate> candidates;
    for (int y = box.halfRows; y < scores.rows - box.halfRows; ++y)
    {
        for (int x = box.halfCols; x < scores.cols - box.halfCols; ++x)
        {
            const float score = scores.at(y, x);
            const float rank = prior.empty() ? score : score * prior.at(y, x);
            if (score >= required && std::isfinite(rank))
                candidates.push_back({score, rank, x - box.halfCols, y - box.halfRows});
        }
    }
    return candidates;
}

/// The source rectangle of a candidate, within the image.
regionRect rectangleOf(const regionCandidate &candidate, const searchScale &scale, const boxSize &box)
{
    regionRect rect;
    rect.x = static_cast<int>(candidate.x * (scale.imageCols - 1.0) / (scale.thumbCols - 1.0) + 0.5);
    rect.y = static_cast<int>(candidate.y * (scale.imageRows - 1.0) / (scale.thumbRows - 1.0) + 0.5);
    rect.width = std::min(box.regionCols, scale.imageCols - rect.x);
    rect.height = std::min(box.regionRows, scale.imageRows - rect.y);
    return rect;
}

/// Whether more than four fifths of a rectangle lie in one of the existing regions.
bool repeats(const regionRect &rect, const std::vector<regionRect> &existing)
{
    return std::any_of(existing.begin(), existing.end(), [&](const regionRect &other) {
        const std::int64_t width =
            std::min<std::int64_t>(std::int64_t{rect.x} + rect.width, std::int64_t{other.x} + other.width) -
            std::max(rect.x, other.x);
        const std::int64_t height =
            std::min<std::int64_t>(std::int64_t{rect.y} + rect.height, std::int64_t{other.y} + other.height) -
            std::max(rect.y, other.y);
        const std::int64_t overlap = std::max<std::int64_t>(width, 0) * std::max<std::int64_t>(height, 0);
        return 5 * overlap > 4 * std::int64_t{rect.width} * rect.height;
    });
}

/// Takes the candidates from the highest rank down until one repeats no region.
bool bestCandidate(std::vector<regionCandidate> candidates, const searchScale &scale, const boxSize &box,
                   const std::vector<regionRect> &existing, regionRect &result)
{
    // Equal ranks: the lower right one first, so that the answer is the same everywhere.
    const auto before = [](const regionCandidate &a, const regionCandidate &b) {
        if (a.rank != b.rank)
            return a.rank < b.rank;
        return a.y != b.y ? a.y < b.y : a.x < b.x;
    };
    // A heap, as hardly ever more than a few of up to a million are looked at.
    std::make_heap(candidates.begin(), candidates.end(), before);
    while (!candidates.empty())
    {
        const regionRect rect = rectangleOf(candidates.front(), scale, box);
        if (!repeats(rect, existing))
        {
            result = rect;
            return true;
        }
        std::pop_heap(candidates.begin(), candidates.end(), before);
        candidates.pop_back();
    }
    return false;
}

} // namespace

bool suggestRegion(const floatArray &grey, int imageCols, int imageRows, int kernelCols, int kernelRows,
                   noiseMode noise, float noiseLevel, const std::vector<regionRect> &existing, regionMode mode,
                   imagePoint point, regionRect &result)
{
    if (grey.empty() || imageCols < 1 || imageRows < 1 || kernelCols > imageCols || kernelRows > imageRows)
        return false;
    const searchScale scale = scaleOf(imageCols, imageRows, kernelCols, kernelRows);
    if (scale.thumbCols < 2 || scale.thumbRows < 2)
        return false;
    const std::vector<boxSize> boxes = boxesToTry(scale, noise, noiseLevel);
    if (boxes.empty())
        return false;

    const floatArray small = thumbnailOf(grey, scale);
    const edgeMaps edges = edgesOf(small, scale.angleBins);
    clearRegions(edges, scale, existing);
    const floatArray prior = priorFor(scale, mode, point);
    int largestRows = 0, largestCols = 0;
    for (const boxSize &box : boxes)
    {
        largestRows = std::max(largestRows, box.rows);
        largestCols = std::max(largestCols, box.cols);
    }
    regionScores maps(small, edges, scale.angleBins, scale.kernelExtent, largestRows, largestCols);

    for (const boxSize &box : boxes)
    {
        const floatArray scores = maps.scores(box.rows, box.cols);
        if (bestCandidate(candidatesOf(scores, prior, box, scale.angleBins), scale, box, existing, result))
            return true;
    }
    return false;
}

} // namespace CorvaneDeblur
