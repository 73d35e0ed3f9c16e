#include "tests/store/traces/traceFixture.h"

#include <cmath>

namespace Project
{
namespace
{

using CorvaneDeblur::floatArray;
using Sarnik::CRect;

/// The picture is 200 x 150 pixels at (30, -20): x from 30 to 230, y from -20 to 130; traces have at most 49 pixels.
class Geometry : public traceTest
{
protected:
    static std::string Edges(const CRect &r)
    {
        return std::to_string(r.left) + " " + std::to_string(r.top) + " " + std::to_string(r.right) + " " +
               std::to_string(r.bottom);
    }
};

TEST_F(Geometry, GrowRegion)
{
    struct
    {
        CRect drawn;
        int size;
        CRect grown;
    } const table[] = {
        {{100, 20, 140, 60}, 13, {100, 20, 140, 60}},    // large enough
        {{100, 20, 140, 60}, 14, {97, 17, 143, 63}},     // 45 wanted, 5 missing
        {{40, 20, 60, 60}, 15, {30, 7, 76, 73}},         // stopped at the left edge
        {{210, 110, 230, 130}, 11, {196, 96, 230, 130}}, // moved back from the lower right corner
        {{30, -20, 40, -10}, 199, {30, -20, 230, 130}},  // more than the picture has
        {{}, 5, {30, -8, 46, 8}},                        // nothing drawn
        {{100, 20, 140, 60}, INT32_MAX, {30, -20, 230, 130}},
    };
    for (const auto &row : table)
    {
        PEstimatedKernel trace(traces, row.drawn, Settings(5));
        trace.GrowRegion(row.size);
        EXPECT_EQ(trace.Region(), row.grown) << Edges(trace.Region());
        EXPECT_TRUE(picture.Bounds().Contains(trace.Region()));
        EXPECT_EQ(trace.DrawnRegion(), row.drawn);
    }
}

TEST_F(Geometry, SetKernelSize)
{
    PEstimatedKernel trace(traces, {100, 20, 140, 50}, Settings(5));
    trace.GrowRegion(13);
    EXPECT_FALSE(trace.SetKernelSize(41, 0));
    EXPECT_EQ(trace.Settings(), Settings(5));
    EXPECT_TRUE(trace.SetKernelSize(40, 0));
    EXPECT_EQ(trace.Settings().size, 40);
    EXPECT_EQ(trace.Settings().mode, 3u);
    EXPECT_EQ(trace.DrawnRegion(), trace.Region());
    PEstimatedKernel whole(traces, {}, Settings(5));
    EXPECT_TRUE(whole.SetKernelSize(1000, 0));
}

TEST_F(Geometry, SetLine)
{
    struct
    {
        PLinePoint start, end;
        int side;
        CRect region;
    } const table[] = {
        {{100, 50}, {103, 50}, 11, {96, 45, 107, 56}},
        {{100.5f, 50}, {111.5f, 50}, 23, {95, 39, 118, 62}}, // 11 long: twice 11, made odd
        {{100, 50}, {100, 90}, 49, {76, 46, 125, 95}},       // limited by the picture
        {{32, -18}, {35, -18}, 11, {30, -20, 41, -9}},       // moved in from the upper left corner
        {{300, 200}, {306, 206}, 15, {215, 115, 230, 130}},  // and from outside of the lower right one
        {{-2e9f, 0}, {2e9f, 1}, 49, {30, -20, 79, 29}},      // beyond whole numbers
    };
    for (const auto &row : table)
    {
        PManualKernel trace(traces, {}, Settings(5));
        trace.SetLine(row.start, row.end);
        EXPECT_EQ(trace.KernelImage().rows, row.side);
        EXPECT_EQ(trace.KernelImage().cols, row.side);
        EXPECT_EQ(trace.Settings().size, row.side);
        EXPECT_EQ(trace.PreviousSettings(), trace.Settings());
        EXPECT_EQ(trace.Region(), row.region) << Edges(trace.Region());
        EXPECT_EQ(trace.CommittedRegion(), row.region);
        EXPECT_TRUE(trace.IsApplied());
        EXPECT_TRUE(trace.Changed());
    }

    // Which way it slopes, that it is symmetric, that it sums to 1; either end may come first.
    PManualKernel rising(traces, {}, Settings(5)), back(traces, {}, Settings(5));
    rising.SetLine({100, 60}, {110, 50});
    back.SetLine({110, 50}, {100, 60});
    const floatArray &k = rising.KernelImage();
    const int middle = k.rows / 2;
    EXPECT_GT(k.at(middle - 3, middle + 3), 0.05f);
    EXPECT_EQ(k.at(middle - 3, middle - 3), 0.0f);
    EXPECT_NEAR(sumAbs(k), 1.0f, 1e-4f);
    for (int y = 0; y < k.rows; ++y)
        for (int x = 0; x < k.cols; ++x)
        {
            EXPECT_EQ(k.at(y, x), k.at(k.rows - 1 - y, k.cols - 1 - x));
            EXPECT_NEAR(k.at(y, x), back.KernelImage().at(y, x), 1e-6f);
        }

    // A line without length is stored and makes no kernel; what is no number is not even stored.
    const float *samples = k.data;
    rising.SetLine({5, 5}, {5, 5});
    EXPECT_EQ(rising.LineStart(), (PLinePoint{5, 5}));
    EXPECT_EQ(rising.KernelImage().data, samples);
    rising.SetLine({NAN, 5}, {6, 6});
    EXPECT_EQ(rising.LineEnd(), (PLinePoint{5, 5}));
}

TEST_F(Geometry, CopiesAndMoves)
{
    PManualKernel line(traces, {}, Settings(5));
    line.SetLine({100, 50}, {110, 55});
    line.Settings().smoothing = 0.9f;
    const auto copy = line.Copy();
    copy->Offset(3, -4);
    EXPECT_EQ(copy->Region(), line.Region().Moved(3, -4));
    EXPECT_EQ(static_cast<PManualKernel &>(*copy).LineEnd(), (PLinePoint{113, 51}));
    EXPECT_EQ(copy->PreviousSettings(), line.Settings());
    EXPECT_FALSE(copy->Changed());

    PEstimatedKernel wide(traces, {100, 20, 140, 31}, Settings(10));
    wide.SetKernel(line.KernelImage());
    const auto fixed = PReadOnlyKernel::Of(wide);
    EXPECT_EQ(fixed->Region(), (CRect{115, 20, 125, 30}));
    EXPECT_EQ(fixed->DrawnRegion(), fixed->Region());
    EXPECT_EQ(fixed->KernelImage().data, wide.KernelImage().data);
}

} // namespace
} // namespace Project
