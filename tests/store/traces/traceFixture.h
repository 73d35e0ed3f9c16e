#pragma once

#include "deblur/estimate/arrayOps.h"
#include "store/traces/kernelCollection.h"
#include "store/traces/manualKernel.h"
#include "store/traces/readOnlyKernel.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>
#include <string>

namespace Project
{

/// A grey picture in memory whose bounds begin anywhere.
class testPicture final : public PTracePicture
{
public:
    testPicture(CorvaneDeblur::floatArray samples, int left, int top)
        : grey(std::move(samples)), bounds{left, top, left + grey.cols, top + grey.rows}
    {
    }

    Sarnik::CRect Bounds() const override { return bounds; }
    int Planes() const override { return 1; }
    int Depth() const override { return 32; }
    void ReadGrey(const Sarnik::CRect &rect, std::uint8_t threshold, const CorvaneDeblur::floatArray &out,
                  const CorvaneDeblur::byteArray &mask) override
    {
        ASSERT_TRUE(bounds.Contains(rect) && !rect.Empty());
        ASSERT_EQ(threshold == 255, mask.empty());
        const auto part = grey.subRect(rect.top - bounds.top, rect.left - bounds.left, static_cast<int>(rect.Height()),
                                       static_cast<int>(rect.Width()));
        copyTo(part, out);
        for (int y = 0; y < mask.rows; ++y)
            for (int x = 0; x < mask.cols; ++x)
                mask.at(y, x) = part.at(y, x) > static_cast<float>(threshold) / 255.0f;
    }

    const CorvaneDeblur::floatArray grey;

private:
    const Sarnik::CRect bounds;
};

/// Counts what it is told.
struct testEvents : PTraceEvents
{
    void MarkDirty(const PDirtyStages &stages) override { rough += stages.rough; }
    void TracesChanged() override { ++changes; }
    void EstimationFinished(PKernel &) override { ++finished; }
    int changes = 0, rough = 0, finished = 0;
};

/// A blurred scene with its collection.
class traceTest : public ::testing::Test
{
protected:
    static CorvaneDeblur::floatArray Blurred(int rows, int cols, int kernel, unsigned seed)
    {
        return TestSupport::blurred(TestSupport::edgeScene(rows, cols, seed),
                                    TestSupport::shakeKernel(kernel, kernel, seed), 0.002f, seed);
    }

    KernelSettings Settings(int size) const
    {
        KernelSettings settings;
        settings.size = size;
        settings.noiseLevel = 1;
        return settings;
    }
    PEstimatedKernel &Add(const Sarnik::CRect &region, int size)
    {
        return static_cast<PEstimatedKernel &>(
            traces.Insert(std::make_unique<PEstimatedKernel>(traces, region, Settings(size)), traces.Count()));
    }

    testPicture picture{Blurred(150, 200, 9, 5), 30, -20};
    PParams params;
    testEvents events;
    PKernelCollection traces{picture, params, events, ""};
};

} // namespace Project
