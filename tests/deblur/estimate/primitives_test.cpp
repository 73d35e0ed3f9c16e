#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/resample.h"
#include "tests/reference/direct.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <gmock/gmock.h>

#include <cmath>
#include <functional>
#include <limits>
#include <string>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

floatArray arrayOf(int rows, int cols, std::initializer_list<float> values)
{
    const floatArray a = floatArray::allocate(rows, cols);
    std::copy(values.begin(), values.end(), a.data);
    return a;
}

TEST(ArrayOps, PeaksAndSums)
{
    const floatArray negative = arrayOf(2, 2, {-0.5f, -3.0f, -0.1f, -2.0f});
    EXPECT_EQ(peak(negative), std::numeric_limits<float>::min());
    EXPECT_EQ(peakAbs(negative), -3.0f);
    EXPECT_EQ(peakAbs(arrayOf(2, 2, {1.0f, -4.0f, 4.0f, 2.0f})), -4.0f) << "the first of equals";
    EXPECT_FLOAT_EQ(sumAbs(negative), 5.6f);

    const floatArray a = noiseImage(61, 53, 1, -1.0f, 1.0f), b = noiseImage(61, 53, 2, -1.0f, 1.0f);
    double products = 0.0, absolute = 0.0;
    for (int i = 0; i < 61 * 53; ++i)
    {
        products += static_cast<double>(a.data[i]) * b.data[i];
        absolute += std::abs(a.data[i]);
    }
    EXPECT_NEAR(dot(a, b), products, 1e-3);
    EXPECT_NEAR(sumAbs(a), absolute, 1e-2);
    EXPECT_EQ(dot(stridedCopy(a), stridedCopy(b)), dot(a, b));
    EXPECT_EQ(sumAbs(stridedCopy(a)), sumAbs(a));
    EXPECT_EQ(peak(stridedCopy(a)), peak(a));
    EXPECT_EQ(peakAbs(stridedCopy(a)), peakAbs(a));
}

TEST(ArrayOps, ThresholdNormalisationAndSigns)
{
    const floatArray a = arrayOf(1, 5, {-1.0f, 0.25f, 0.5f, 0.75f, 0.0f});
    const floatArray out = floatArray::allocate(1, 5);
    thresholdInto(a, out, 0.5f);
    EXPECT_TRUE(arrayIdentical(out, arrayOf(1, 5, {0.0f, 0.0f, 0.0f, 0.75f, 0.0f})));
    signInto(a, out);
    EXPECT_TRUE(arrayNear(out, arrayOf(1, 5, {-1.0f, 1.0f, 1.0f, 1.0f, 0.0f}), 0.0));
    normaliseSum(a);
    EXPECT_TRUE(arrayNear(a, arrayOf(1, 5, {-0.4f, 0.1f, 0.2f, 0.3f, 0.0f}), 1e-7));
    fill(a, 0.0f);
    normaliseSum(a);
    EXPECT_EQ(sumAbs(a), 0.0f);
}

TEST(ArrayOps, SpectrumProducts)
{
    const complexArray a = complexArray::allocate(1, 1), b = complexArray::allocate(1, 1), out = a;
    fill(a, {1.0f, 2.0f});
    fill(b, {3.0f, -5.0f});
    multiplySpectra(a, b, out, {0.0f, 2.0f}); // 2i (1 + 2i)(3 - 5i) = 2i (13 + i)
    EXPECT_EQ(out.at(0, 0).re, -2.0f);
    EXPECT_EQ(out.at(0, 0).im, 26.0f);
    fill(a, {1.0f, 2.0f});
    multiplySpectrumByConj(a, b, out); // (1 + 2i)(3 + 5i)
    EXPECT_EQ(out.at(0, 0).re, -7.0f);
    EXPECT_EQ(out.at(0, 0).im, 11.0f);
}

// One of each kind that reads an array and writes an array: views give what compact copies give, and nothing around
// the view is written.
TEST(Primitives, StridedViewsEqualCompactArrays)
{
    struct operation
    {
        const char *name;
        int outRows, outCols;
        std::function<void(const floatArray &in, const floatArray &out)> run;
    };
    const int rows = 19, cols = 23;
    const operation operations[] = {
        {"copyTo", rows, cols, copyTo},
        {"scaleInto", rows, cols, [](auto &in, auto &out) { scaleInto(in, out, 0.3f); }},
        {"combine", rows, cols, [](auto &in, auto &out) { combine(0.3f, in, 0.6f, out, out); }},
        {"combine onto itself", rows, cols, [](auto &in, auto &out) { combine(1.0f, out, 0.6f, in, out); }},
        {"multiplyInto", rows, cols, [](auto &in, auto &out) { multiplyInto(in, out, out, 3.0f); }},
        {"subtractInto", rows, cols, [](auto &in, auto &out) { subtractInto(in, out, out); }},
        {"addInto", rows, cols, [](auto &in, auto &out) { addInto(in, out, out); }},
        {"signInto", rows, cols, signInto},
        {"thresholdInto", rows, cols, [](auto &in, auto &out) { thresholdInto(in, out, 0.5f); }},
        {"normaliseSum", rows, cols, [](auto &, auto &out) { normaliseSum(out); }},
        {"gaussianFill", rows, cols, [](auto &, auto &out) { gaussianFill(out, 2.0f, 3.0f); }},
        {"forwardDiffX", rows, cols, forwardDiffX},
        {"forwardDiffY", rows, cols, forwardDiffY},
        {"circularDiffX", rows, cols, circularDiffX},
        {"circularDiffY", rows, cols, circularDiffY},
        {"laplacian", rows, cols, [](auto &in, auto &out) { laplacian(in, out, laplacianEdge::centre); }},
        {"boxSum", rows, cols, [](auto &in, auto &out) { boxSum(in, out, 2, 3); }},
        {"shrink both", 7, 9, resize},
        {"grow both", 40, 51, resize},
        {"shrink rows, grow columns", 7, 51, resize},
        {"shrink columns, grow rows", 40, 9, resize},
        {"same size", rows, cols, resize},
        {"subPixelCrop", 11, 13, [](auto &in, auto &out) { subPixelCrop(in, out, 3.2f, 17.9f); }},
        {"taperedExtension", 30, 36, [](auto &in, auto &out) { taperedExtension(in, out, 7, 5); }},
    };
    for (const operation &op : operations)
    {
        SCOPED_TRACE(op.name);
        const floatArray in = noiseImage(rows, cols, 3, -1.0f, 1.0f);
        const floatArray compact = noiseImage(op.outRows, op.outCols, 4);
        const floatArray strided = stridedCopy(compact);
        op.run(in, compact);
        op.run(stridedCopy(in), strided);
        EXPECT_TRUE(arrayNear(strided, compact, 1e-7));
        EXPECT_TRUE(marginUntouched(strided));
    }
}

class Resize : public testing::TestWithParam<const char *>
{
};

TEST_P(Resize, MatchesReferenceValues)
{
    const floatArray expected = readFloats(GetParam(), "out");
    const floatArray out = floatArray::allocate(expected.rows, expected.cols);
    resize(readFloats(GetParam(), "in"), out);
    EXPECT_TRUE(arrayNear(out, expected, 2e-6));
}

INSTANTIATE_TEST_SUITE_P(Cases, Resize,
                         testing::Values("resize_19x26", "resize_37x31", "resize_20x80", "resize_50x20", "resize_60x90",
                                         "resize_37x53", "resize_1x1"),
                         [](const auto &instance) { return std::string(instance.param); });

TEST(ResizeLaws, FlatStaysFlatAndEqualShapesCopy)
{
    const floatArray flat = floatArray::allocate(13, 29);
    fill(flat, 0.7f);
    for (const int rows : {1, 5, 13, 40})
        for (const int cols : {1, 11, 29, 64})
        {
            const floatArray out = floatArray::allocate(rows, cols);
            const floatArray expected = floatArray::allocate(rows, cols);
            fill(expected, 0.7f);
            resize(flat, out);
            EXPECT_TRUE(arrayNear(out, expected, 5e-6)) << rows << " x " << cols;
        }
    const floatArray image = noiseImage(9, 9, 5), same = floatArray::allocate(9, 9);
    resize(image, same);
    EXPECT_TRUE(arrayIdentical(same, image));

    // From the smallest source: every sample is its only one.
    const floatArray one = arrayOf(1, 1, {0.25f}), grown = floatArray::allocate(3, 4);
    resize(one, grown);
    EXPECT_EQ(peak(grown), 0.25f);
    EXPECT_FLOAT_EQ(sumAbs(grown), 3.0f);
}

TEST(SubPixelCrop, MatchesReferenceValues)
{
    const floatArray in = readFloats("sub_pixel_crop", "in"), expected = readFloats("sub_pixel_crop", "out");
    const floatArray out = floatArray::allocate(expected.rows, expected.cols);
    subPixelCrop(in, out, 30.25f, 3.6f);
    EXPECT_TRUE(arrayNear(out, expected, 2e-6));
}

TEST(SubPixelCrop, WholeShiftIsExactAndOutsideTakesTheNearestEdge)
{
    const floatArray in = noiseImage(7, 9, 6);
    const floatArray out = floatArray::allocate(7, 9);
    subPixelCrop(in, out, 4.0f + 2.0f, 3.0f - 1.0f); // the centre two to the right, one up
    for (int y = 0; y < 7; ++y)
        for (int x = 0; x < 9; ++x)
            EXPECT_EQ(out.at(y, x), in.at(std::max(y - 1, 0), std::min(x + 2, 8)));
    subPixelCrop(in, out, -1e6f, 1e6f);
    EXPECT_EQ(out.at(3, 3), in.at(6, 0));
}

TEST(TaperedExtension, MatchesReferenceValues)
{
    const floatArray in = readFloats("tapered_extension", "in");
    const floatArray square = readFloats("tapered_extension", "square");
    const floatArray out = floatArray::allocate(square.rows, square.cols);
    taperedExtension(in, out, 15, 15);
    EXPECT_TRUE(arrayNear(out, square, 5e-5));

    const floatArray tall = readFloats("tapered_extension", "tall");
    const floatArray tallOut = floatArray::allocate(tall.rows, tall.cols);
    taperedExtension(in, tallOut, 9, 21);
    EXPECT_TRUE(arrayNear(tallOut, tall, 5e-5));
}

TEST(Gaussian, MatchesReferenceValues)
{
    const floatArray square = floatArray::allocate(5, 5), wide = floatArray::allocate(7, 9);
    gaussianFill(square, 2.0f);
    EXPECT_TRUE(arrayNear(square, readFloats("gaussians", "g_5_5_2_0"), 1e-7));
    gaussianFill(wide, 1.2f, 3.0f);
    EXPECT_TRUE(arrayNear(wide, readFloats("gaussians", "g_7_9_1.2_3"), 1e-7));

    const floatArray centred = floatArray::allocate(7, 9);
    gaussianFill(centred, 1.2f, 3.0f, 4.0f, 3.0f);
    EXPECT_TRUE(arrayIdentical(centred, wide));
    gaussianFill(centred, 1.2f, 0.0f, 1.0f, 5.0f);
    EXPECT_EQ(peak(centred), centred.at(5, 1));
}

TEST(BoxSum, MatchesReferenceValuesAndDirectSums)
{
    const floatArray in = readFloats("box_sum", "in");
    const floatArray out = floatArray::allocate(in.rows, in.cols);
    boxSum(in, out, 4, 2);
    EXPECT_TRUE(arrayNear(out, readFloats("box_sum", "out"), 1e-4));

    // Also with windows wider than the array, and in place.
    for (const auto &[rows, cols] : {std::pair(1, 1), std::pair(3, 8), std::pair(33, 20)})
        for (const auto &[radiusRows, radiusCols] :
             {std::pair(0, 0), std::pair(0, 3), std::pair(5, 1), std::pair(40, 9)})
        {
            const floatArray image = noiseImage(rows, cols, 7), inPlace = stridedCopy(image);
            boxSum(inPlace, inPlace, radiusRows, radiusCols);
            EXPECT_TRUE(arrayNear(inPlace, Reference::directBoxSum(image, radiusRows, radiusCols), 1e-4));
        }
    const floatArray image = noiseImage(12, 12, 8), square = floatArray::allocate(12, 12);
    boxSum(image, square, 3);
    EXPECT_TRUE(arrayNear(square, Reference::directBoxSum(image, 3, 3), 1e-5));
}

TEST(Laplacian, EqualsDirectSumsForBothEdges)
{
    const floatArray stencil = arrayOf(3, 3, {0.0f, -1.0f, 0.0f, -1.0f, 4.0f, -1.0f, 0.0f, -1.0f, 0.0f});
    for (const auto &[rows, cols] :
         {std::pair(1, 1), std::pair(1, 6), std::pair(2, 2), std::pair(3, 8), std::pair(17, 9)})
    {
        const floatArray image = noiseImage(rows, cols, 9), out = floatArray::allocate(rows, cols);
        const auto expected = [&](borderMode border) {
            return Reference::directFilter(image, stencil, border, Reference::filterKind::correlation);
        };
        laplacian(image, out, laplacianEdge::zero);
        EXPECT_TRUE(arrayNear(out, expected(borderMode::constant), 1e-6));
        laplacian(image, out, laplacianEdge::centre);
        EXPECT_TRUE(arrayNear(out, expected(borderMode::replicate), 1e-6));
        fill(image, 0.3f);
        laplacian(image, out, laplacianEdge::centre);
        EXPECT_EQ(peakAbs(out), 0.0f) << "a flat image has exactly none";
    }
}

TEST(Differences, CircularOnesWrapAndForwardOnesEndInZero)
{
    const floatArray a = arrayOf(2, 3, {1.0f, 4.0f, 9.0f, 2.0f, 8.0f, 3.0f}), out = floatArray::allocate(2, 3);
    forwardDiffX(a, out);
    EXPECT_TRUE(arrayNear(out, arrayOf(2, 3, {3.0f, 5.0f, 0.0f, 6.0f, -5.0f, 0.0f}), 0.0));
    circularDiffX(a, out);
    EXPECT_TRUE(arrayNear(out, arrayOf(2, 3, {3.0f, 5.0f, -8.0f, 6.0f, -5.0f, -1.0f}), 0.0));
    forwardDiffY(a, out);
    EXPECT_TRUE(arrayNear(out, arrayOf(2, 3, {1.0f, 4.0f, -6.0f, 0.0f, 0.0f, 0.0f}), 0.0));
    circularDiffY(a, out);
    EXPECT_TRUE(arrayNear(out, arrayOf(2, 3, {1.0f, 4.0f, -6.0f, -1.0f, -4.0f, 6.0f}), 0.0));
}

} // namespace
