#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/resample.h"
#include "tests/reference/direct.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <functional>
#include <string>
#include <tuple>
#include <utility>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

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
        {"combine", rows, cols, [](auto &in, auto &out) { combine(0.3f, in, 0.6f, out, out); }},
        {"multiplyInto", rows, cols, [](auto &in, auto &out) { multiplyInto(in, out, out, 3.0f); }},
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
    const floatArray flat = noiseImage(13, 29, 5, 0.7f, 0.7f);
    for (const int rows : {1, 5, 13, 40})
        for (const int cols : {1, 11, 29, 64})
        {
            const floatArray out = floatArray::allocate(rows, cols);
            resize(flat, out);
            EXPECT_TRUE(arrayNear(out, noiseImage(rows, cols, 5, 0.7f, 0.7f), 5e-6)) << rows << " x " << cols;
        }
    const floatArray image = noiseImage(9, 9, 5), same = floatArray::allocate(9, 9);
    resize(image, same);
    EXPECT_TRUE(arrayIdentical(same, image));
}

TEST(SubPixelCrop, MatchesReferenceValues)
{
    const floatArray in = readFloats("sub_pixel_crop", "in"), expected = readFloats("sub_pixel_crop", "out");
    const floatArray out = floatArray::allocate(expected.rows, expected.cols);
    subPixelCrop(in, out, 30.25f, 3.6f);
    EXPECT_TRUE(arrayNear(out, expected, 2e-6));
    subPixelCrop(in, out, -1e6f, 1e6f);
    EXPECT_EQ(out.at(3, 3), in.at(in.rows - 1, 0)) << "outside the nearest edge counts";
}

TEST(TaperedExtension, MatchesReferenceValues)
{
    for (const auto &[name, kernelCols, kernelRows] : {std::tuple("square", 15, 15), std::tuple("tall", 9, 21)})
    {
        const floatArray expected = readFloats("tapered_extension", name);
        const floatArray out = floatArray::allocate(expected.rows, expected.cols);
        taperedExtension(readFloats("tapered_extension", "in"), out, kernelCols, kernelRows);
        EXPECT_TRUE(arrayNear(out, expected, 5e-5)) << name;
    }
}

TEST(Gaussian, MatchesReferenceValues)
{
    const floatArray square = floatArray::allocate(5, 5), wide = floatArray::allocate(7, 9);
    gaussianFill(square, 2.0f);
    EXPECT_TRUE(arrayNear(square, readFloats("gaussians", "g_5_5_2_0"), 1e-7));
    gaussianFill(wide, 1.2f, 3.0f);
    EXPECT_TRUE(arrayNear(wide, readFloats("gaussians", "g_7_9_1.2_3"), 1e-7));
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
}

} // namespace
