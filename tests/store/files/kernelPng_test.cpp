#include "store/files/kernelPng.h"

#include "framework/base/exceptions.h"
#include "tests/store/files/traceFileFixture.h"

#include <cmath>
#include <limits>

namespace Project
{

namespace
{

using CorvaneDeblur::floatArray;
using Sarnik::CMemoryContainer;

CMemoryContainer Container(const std::string &bytes)
{
    return CMemoryContainer(std::as_bytes(std::span(bytes)));
}

TEST_F(traceFileTest, KernelsSurviveAsPictures)
{
    std::mt19937 random(3);
    for (int size = 11; size < 60; size += 6)
    {
        const floatArray kernel = TestSupport::shakeKernel(size, size, random());
        CorvaneDeblur::scaleInto(kernel, kernel, 1e-3f * static_cast<float>(size * size * size)); // any sum will do
        CMemoryContainer file;
        std::string message;
        ASSERT_TRUE(WriteKernelPng(kernel, file, message));
        file.Seek(0);
        floatArray back;
        ASSERT_TRUE(ReadKernelPng(back, size, file, message));
        ASSERT_TRUE(back.sameShape(kernel));
        const float sum = sumAbs(kernel), step = peak(kernel) / sum / 65535.0f;
        EXPECT_NEAR(sumAbs(back), 1.0f, 1e-6f);
        for (int y = 0; y < size; ++y)
            for (int x = 0; x < size; ++x)
            {
                // Each sample loses up to a step, and what all of them lose is spread over them in proportion.
                const float expected = kernel.at(y, x) / sum;
                ASSERT_NEAR(back.at(y, x), expected, step * (1.0f + expected * static_cast<float>(size * size)));
            }
    }
}

TEST_F(traceFileTest, SenselessKernelsGiveSoundPictures)
{
    constexpr float none = std::numeric_limits<float>::quiet_NaN();
    const floatArray kernel = floatArray::allocate(11, 11);
    for (const float value : {0.0f, -1.0f, none, 1e-40f, 3e38f, std::numeric_limits<float>::infinity()})
    {
        fill(kernel, 0.0f);
        kernel.at(3, 4) = value;
        CMemoryContainer file;
        std::string message;
        ASSERT_TRUE(WriteKernelPng(kernel, file, message));
        file.Seek(0);
        floatArray back;
        ASSERT_TRUE(ReadKernelPng(back, 11, file, message));
        for (int i = 0; i < 121; ++i)
            ASSERT_TRUE(i == 3 * 11 + 4 ? std::isfinite(back.data[i]) && back.data[i] >= 0.0f : back.data[i] == 0.0f);
    }
}

/// A container on a full disk.
struct fullContainer final : Sarnik::CContainer
{
    std::size_t Size() const override { return 0; }
    std::size_t Position() const override { return 0; }
    void Seek(std::size_t) override {}
    void ReadBytes(std::span<std::byte>) override { throw Sarnik::CError("no data"); }
    void WriteBytes(std::span<const std::byte>) override { throw Sarnik::CError("no room"); }
};

TEST_F(traceFileTest, AStreamThatFailsEndsTheWriting)
{
    fullContainer full;
    std::string message;
    EXPECT_FALSE(WriteKernelPng(TestSupport::shakeKernel(11, 11, 1), full, message));
    EXPECT_FALSE(WriteKernelPng(floatArray(), full, message));
}

TEST_F(traceFileTest, DamagedPicturesAreRefusedOrSound)
{
    for (const char *name : {"grey16.png", "grey16_interlaced.png", "rgb8.png", "palette.png", "grey8_trns.png"})
    {
        const std::string whole = Sample(name);
        const auto check = [&](const std::string &bytes) {
            CMemoryContainer file = Container(bytes);
            std::string message;
            floatArray kernel;
            const bool read = ReadKernelPng(kernel, 99, file, message);
            ASSERT_EQ(read, !kernel.empty());
            if (!read)
                return;
            ASSERT_EQ(message, "");
            ASSERT_TRUE(kernel.rows == kernel.cols && kernel.rows % 2 == 1 && kernel.rows <= 99);
            const float sum = sumAbs(kernel);
            ASSERT_TRUE(sum == 0.0f || std::fabs(sum - 1.0f) < 1e-5f);
        };
        for (std::size_t length = 8; length < whole.size(); ++length)
            check(whole.substr(0, length));
        for (std::size_t bit = 0; bit < whole.size() * 8; ++bit)
        {
            std::string file = whole;
            file[bit / 8] = static_cast<char>(file[bit / 8] ^ 1 << bit % 8);
            check(file);
        }
        EXPECT_FALSE(Loading(whole.substr(0, 7), ".png"));
        EXPECT_EQ(Error(), kUnrecognized);
    }
}

} // namespace

} // namespace Project
