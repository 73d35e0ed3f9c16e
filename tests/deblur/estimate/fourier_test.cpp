#include "deblur/estimate/fourier.h"

#include "deblur/estimate/arrayOps.h"
#include "tests/reference/direct.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <string>
#include <utility>

using namespace CorvaneDeblur;
using namespace TestSupport;
using Reference::directDFT;
using Reference::directFilter;
using Reference::filterKind;

namespace
{

floatArray partOf(const complexArray &c, complexPart part)
{
    const floatArray out = floatArray::allocate(c.rows, c.cols);
    realPartInto(c, out, part);
    return out;
}

testing::AssertionResult spectraNear(const complexArray &actual, const complexArray &expected, double max)
{
    for (const complexPart part : {complexPart::real, complexPart::imaginary})
        if (const auto near = arrayNear(partOf(actual, part), partOf(expected, part), max); !near)
            return testing::AssertionFailure() << "part " << static_cast<int>(part) << ": " << near.message();
    return testing::AssertionSuccess();
}

class Transform : public testing::TestWithParam<std::pair<int, int>>
{
protected:
    const int rows = GetParam().first, cols = GetParam().second;
    const floatArray image = noiseImage(rows, cols, 1000 * rows + cols, -1.0f, 1.0f);
};

TEST_P(Transform, ForwardEqualsDefinitionAndInverseReturnsTheImage)
{
    const complexArray wide = complexArray::allocate(rows + 2, halfSpectrumCols(cols) + 3);
    fill(wide, {7.0f, 8.0f});
    const complexArray spectrum = wide.subRect(1, 2, rows, halfSpectrumCols(cols));
    const floatArray back = stridedCopy(image);
    for (const inverseScale scale : {inverseScale::normalised, inverseScale::none})
    {
        forwardFFT(stridedCopy(image), spectrum);
        EXPECT_TRUE(spectraNear(spectrum, directDFT(image), 2e-4));
        fill(back, 0.0f);
        inverseFFT(spectrum, back, scale);
        if (scale == inverseScale::none)
            scaleInto(back, back, 1.0f / (static_cast<float>(rows) * static_cast<float>(cols)));
        EXPECT_TRUE(arrayNear(back, image, 2e-6));
    }
    EXPECT_TRUE(marginUntouched(back));
    EXPECT_EQ(wide.at(0, 0).re, 7.0f);
    EXPECT_EQ(wide.at(rows, 1).im, 8.0f);
}

INSTANTIATE_TEST_SUITE_P(Shapes, Transform,
                         testing::Values(std::pair(1, 1), std::pair(1, 7), std::pair(7, 1), std::pair(2, 3),
                                         std::pair(3, 8), std::pair(17, 16), std::pair(26, 33), std::pair(129, 31)),
                         [](const auto &instance) {
                             return std::to_string(instance.param.first) + "x" + std::to_string(instance.param.second);
                         });

// The centre of a kernel, element ((rows - 1) / 2, (cols - 1) / 2), comes to the grid's origin; what does not fit wraps
// onto the grid.
TEST(PlaceCentred, EqualsTransformOfTheWrappedKernel)
{
    const std::pair<int, int> shapes[] = {{1, 1}, {3, 3}, {4, 6}, {9, 5}, {12, 15}, {31, 7}, {25, 40}};
    for (const auto &[rows, cols] : shapes)
    {
        SCOPED_TRACE(std::to_string(rows) + " x " + std::to_string(cols));
        const floatArray kernel = noiseImage(rows, cols, 5);
        const int gridRows = 12, gridCols = 15;
        const floatArray placed = floatArray::allocate(gridRows, gridCols);
        fill(placed, 0.0f);
        for (int r = 0; r < rows; ++r)
            for (int c = 0; c < cols; ++c)
                placed.at((r - (rows - 1) / 2 + 10 * gridRows) % gridRows,
                          (c - (cols - 1) / 2 + 10 * gridCols) % gridCols) += kernel.at(r, c);
        const complexArray spectrum = complexArray::allocate(gridRows, halfSpectrumCols(gridCols));
        placeCentred(kernel, spectrum, gridCols, gridRows);
        EXPECT_TRUE(spectraNear(spectrum, directDFT(placed), 3e-4));
    }
}

TEST(GatherCentred, ReturnsThePlacedKernelCroppedToOutsShape)
{
    for (const auto &[rows, cols] : {std::pair(1, 1), std::pair(3, 5), std::pair(7, 9)})
    {
        const floatArray kernel = noiseImage(7, 9, 6), back = stridedCopy(floatArray::allocate(rows, cols));
        const complexArray spectrum = complexArray::allocate(12, halfSpectrumCols(15));
        placeCentred(kernel, spectrum, 15, 12);
        gatherCentred(spectrum, back, 15, 12);
        EXPECT_TRUE(arrayNear(back, kernel.subRect(3 - rows / 2, 4 - cols / 2, rows, cols), 1e-6));
        EXPECT_TRUE(marginUntouched(back));
    }
}

class Filter : public testing::TestWithParam<borderMode>
{
};

TEST_P(Filter, MatchesReferenceValues)
{
    const std::string name = "convolve_mode" + std::to_string(static_cast<int>(GetParam()));
    const floatArray in = readFloats(name.c_str(), "in"), kernel = readFloats(name.c_str(), "kernel");
    const floatArray out = floatArray::allocate(in.rows, in.cols);
    convolveFFT(in, out, kernel, GetParam());
    EXPECT_TRUE(arrayNear(out, readFloats(name.c_str(), "convolved"), 3e-6));
    correlateFFT(in, out, kernel, GetParam());
    EXPECT_TRUE(arrayNear(out, readFloats(name.c_str(), "correlated"), 3e-6));
}

TEST_P(Filter, EqualsDirectSums)
{
    const std::pair<int, int> images[] = {{1, 1}, {3, 8}, {17, 16}, {29, 31}};
    const std::pair<int, int> kernels[] = {{1, 1}, {3, 3}, {4, 2}, {5, 9}, {2, 7}};
    for (const auto &[rows, cols] : images)
        for (const auto &[kernelRows, kernelCols] : kernels)
        {
            SCOPED_TRACE(std::to_string(rows) + " x " + std::to_string(cols) + " by " + std::to_string(kernelRows) +
                         " x " + std::to_string(kernelCols));
            const floatArray image = noiseImage(rows, cols, 129 + cols), kernel = noiseImage(kernelRows, kernelCols, 3);
            normaliseSum(kernel);
            const floatArray inPlace = stridedCopy(image);
            convolveFFT(inPlace, inPlace, kernel, GetParam());
            EXPECT_TRUE(arrayNear(inPlace, directFilter(image, kernel, GetParam(), filterKind::convolution), 2e-6));
            EXPECT_TRUE(marginUntouched(inPlace));
            const floatArray out = floatArray::allocate(rows, cols);
            correlateFFT(stridedCopy(image), out, stridedCopy(kernel), GetParam());
            EXPECT_TRUE(arrayNear(out, directFilter(image, kernel, GetParam(), filterKind::correlation), 2e-6));
        }
}

INSTANTIATE_TEST_SUITE_P(Borders, Filter,
                         testing::Values(borderMode::circular, borderMode::constant, borderMode::replicate),
                         [](const auto &instance) {
                             return "Mode" + std::to_string(static_cast<int>(instance.param));
                         });

} // namespace
