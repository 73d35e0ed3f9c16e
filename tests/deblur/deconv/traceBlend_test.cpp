#include "deblur/deconv/traceBlend.h"

#include "tests/support/matchers.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

latentKernel traceAt(int left, int top, int right, int bottom)
{
    latentKernel trace;
    trace.regionLeft = left;
    trace.regionTop = top;
    trace.regionRight = right;
    trace.regionBottom = bottom;
    return trace;
}

latentKernel traceCentredAt(int x, int y)
{
    return traceAt(x - 15, y - 15, x + 15, y + 15);
}

/// The product of the trace's weights against all others; against an earlier one it is the rest to 1.
double weightOf(std::size_t i, int x, int y, const std::vector<latentKernel> &traces)
{
    double weight = 1.0;
    for (std::size_t j = 0; j < traces.size(); ++j)
        if (i != j)
            weight *= i < j ? pairWeight(x, y, traces[i], traces[j]) : 1.0 - pairWeight(x, y, traces[j], traces[i]);
    return weight;
}

std::vector<latentKernel> randomTraces(std::mt19937 &random, int count)
{
    const auto below = [&](unsigned n) { return static_cast<int>(random() % n); };
    std::vector<latentKernel> traces;
    for (int i = 0; i < count; ++i)
    {
        const int left = below(300) - 40, top = below(300) - 40;
        traces.push_back(traceAt(left, top, left + below(80), top + below(80)));
    }
    return traces;
}

TEST(TraceBlend, PairWeightFallsAcrossTheBandAndStepsOutsideIt)
{
    // Centres 200 pixels apart on a line: the difference of distances grows by 2 a pixel.
    const latentKernel a = traceCentredAt(0, 0), b = traceCentredAt(200, 0);
    EXPECT_EQ(pairWeight(100, 0, a, b), 0.5);
    EXPECT_EQ(pairWeight(89, 0, a, b), 1.0);
    EXPECT_EQ(pairWeight(111, 0, a, b), 0.0);
    EXPECT_NEAR(pairWeight(90, 0, a, b), 0.99966, 1e-5);
    EXPECT_NEAR(pairWeight(110, 0, a, b), 0.00034, 1e-5);
    // A large picture: squares of these distances overflow 32 bits.
    EXPECT_EQ(pairWeight(99990, 99990, traceCentredAt(99980, 99990), traceCentredAt(0, 0)), 1.0);
    // Sums of a region's edges are halved towards zero.
    EXPECT_EQ(pairWeight(0, 7, traceAt(-1, 0, 0, 0), traceAt(0, 0, 1, 0)), 0.5);
    // Corners from a spoilt file.
    EXPECT_EQ(pairWeight(0, 0, traceAt(2147483647, 0, 2147483647, 0), traceCentredAt(0, 0)), 0.0);
}

TEST(TraceBlend, ActiveTracesAreThoseWithAWeightAtOneOfNinePoints)
{
    EXPECT_EQ(selectActiveKernels({traceCentredAt(5000, 5000)}, 0, 0, 9, 9), std::vector<int>{0});
    EXPECT_EQ(selectActiveKernels({}, 0, 0, 9, 9), std::vector<int>{0});

    std::mt19937 random(7);
    std::size_t least = 99, most = 0;
    for (int round = 0; round < 300; ++round)
    {
        const std::vector<latentKernel> traces = randomTraces(random, 2 + round % 4);
        const int left = static_cast<int>(random() % 200) - 20, top = static_cast<int>(random() % 200);
        const int right = left + static_cast<int>(random() % 90), bottom = top + static_cast<int>(random() % 90);
        const int cx = (left + right) / 2, cy = (top + bottom) / 2;
        const std::pair<int, int> points[] = {{left, top},
                                              {right, top},
                                              {right, bottom},
                                              {left, bottom},
                                              {cx, cy},
                                              {cx, (cy + top) / 2},
                                              {cx, (cy + bottom) / 2},
                                              {(cx + left) / 2, cy},
                                              {(cx + right) / 2, cy}};
        std::vector<int> expected;
        for (std::size_t i = 0; i < traces.size(); ++i)
            if (std::any_of(std::begin(points), std::end(points),
                            [&](const auto &at) { return weightOf(i, at.first, at.second, traces) > 0.0; }))
                expected.push_back(static_cast<int>(i));
        EXPECT_EQ(selectActiveKernels(traces, left, top, right, bottom), expected);
        least = std::min(least, expected.size());
        most = std::max(most, expected.size());
    }
    EXPECT_EQ(least, 1u);
    EXPECT_GT(most, 2u);
}

TEST(TraceBlend, OneTraceAloneIsTakenBitByBit)
{
    const std::vector<latentKernel> traces = {traceCentredAt(20, 20), traceCentredAt(400, 20)};
    const std::vector<floatArray> results = {noiseImage(40, 40, 1), noiseImage(40, 40, 2)};
    const floatArray tile = floatArray::allocate(40, 40);
    blendResults(tile, traces, {0, 1}, results, 0, 0);
    EXPECT_TRUE(arrayIdentical(tile, results[0]));
    blendResults(tile, traces, {0, 1}, results, 380, 0);
    EXPECT_TRUE(arrayIdentical(tile, results[1]));
}

} // namespace
