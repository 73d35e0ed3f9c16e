#include "host/kernelFile.h"

#include "host/greyPng.h"
#include "host/pfm.h"
#include "tests/host/hostFixture.h"

#include <cmath>
#include <gmock/gmock.h>
#include <numeric>

namespace Stillmark
{
namespace
{

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::StartsWith;

class KernelFile : public hostTest
{
protected:
    std::string message(const std::string &path) const
    {
        try
        {
            readKernel(path);
            return "taken";
        }
        catch (const Platform::fileError &error)
        {
            return error.what();
        }
    }
};

/// A short curve of unequal strength, sum 1.
kernelSamples curve()
{
    kernelSamples kernel{5, 7, std::vector<float>(35)};
    const float weights[] = {0.05f, 0.1f, 0.4f, 0.25f, 0.2f};
    for (int i = 0; i < 5; ++i)
        kernel.samples[i * 7 + (i * i) % 7] = weights[i];
    return kernel;
}

TEST_F(KernelFile, WhatIsWrittenIsReadBack)
{
    const kernelSamples kernel = curve();
    for (const auto &[name, tolerance] : {std::pair{"k.pfm", 1e-8}, std::pair{"k.png", 1.0 / 65535}})
    {
        writeKernel(file(name), kernel);
        const kernelSamples back = readKernel(file(name));
        ASSERT_EQ(back.rows, 5);
        ASSERT_EQ(back.cols, 7);
        for (int i = 0; i < 35; ++i)
            EXPECT_NEAR(back.samples[i], kernel.samples[i], tolerance) << name << " " << i;
    }
    expectOnly({"k.pfm", "k.png"});
}

TEST_F(KernelFile, PicturesAreReadByTheirLumaAndScaledToASumOfOne)
{
    // One red, one green and one blue sample, transparency that says something else, and the float map of the same.
    std::uint8_t rgba[3 * 3 * 4] = {};
    float rgb[27] = {};
    for (int p = 0; p < 3; ++p)
    {
        rgba[p * 12 + p] = 200;
        rgba[p * 12 + 3] = static_cast<std::uint8_t>(99 * p);
        rgb[p * 9 + p] = 12.5f;
    }
    const vipsImage image(vips_image_new_from_memory_copy(rgba, sizeof rgba, 3, 3, 4, VIPS_FORMAT_UCHAR));
    image->Type = VIPS_INTERPRETATION_sRGB;
    writePfm(file("k.pfm"), {3, 3, 3, {rgb, rgb + 27}});
    for (const std::string &path : {save(image.get(), "k.png"), file("k.pfm")})
    {
        const kernelSamples kernel = readKernel(path);
        EXPECT_NEAR(kernel.samples[0], 0.299, 1e-6);
        EXPECT_NEAR(kernel.samples[3], 0.587, 1e-6);
        EXPECT_NEAR(kernel.samples[6], 0.114, 1e-6);
        EXPECT_NEAR(std::accumulate(kernel.samples.begin(), kernel.samples.end(), 0.0), 1, 1e-6);
    }
}

TEST_F(KernelFile, RefusesWhatIsNoKernel)
{
    const auto map = [&](const char *name, int width, int height, float value) {
        writePfm(file(name), {width, height, 1, std::vector<float>(static_cast<std::size_t>(width) * height, value)});
        return file(name);
    };
    const std::pair<std::string, std::string> cases[] = {
        {map("even.pfm", 4, 5, 1), "both sides odd"},
        {map("wide.pfm", 8001, 1, 1), "at most 8000"},
        {map("zero.pfm", 5, 5, 0), "zero"},
        {map("negative.pfm", 5, 5, -1), "negative"},
        {map("nan.pfm", 5, 5, std::nanf("")), "no number"},
        {make({"cmyk", ".tif", 4, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_CMYK}, 5, 5), "neither grey nor RGB"},
        {file("none.pfm"), "No such file"},
    };
    for (const auto &[path, cause] : cases)
        EXPECT_THAT(message(path), AllOf(StartsWith(path + ": "), HasSubstr(cause)));
    EXPECT_THROW(checkKernelPath(file("k.jpg")), Platform::fileError);
    EXPECT_THROW(writeKernel(file("none/k.png"), curve()), Platform::fileError);
    EXPECT_THROW(writeKernel(file("none/k.pfm"), curve()), Platform::fileError);
}

TEST_F(KernelFile, ThePictureShowsEveryKernelEnlargedWithItsPeakWhite)
{
    kernelSamples second{1, 3, {0, 0.01f, 0.99f}};
    writeKernelPicture(file("k.png"), {curve(), second});
    const photo picture = photo::open(file("k.png"));
    ASSERT_EQ(picture.mode(), colourMode::grey);
    ASSERT_EQ(picture.depth(), 8);
    EXPECT_EQ(picture.width(), 8 + 7 * 36 + 8 + 3 * 85 + 8);
    EXPECT_EQ(picture.height(), 8 + 5 * 36 + 8);
    const auto at = [&](int x, int y) { return planesOf(picture, {x, y, 1, 1})[0]; };
    EXPECT_EQ(at(8 + 4 * 36, 8 + 2 * 36), 255); // the curve's strongest sample, at row 2, column 4
    EXPECT_EQ(at(8 + 4 * 36 + 35, 8 + 2 * 36 + 35), 255);
    EXPECT_EQ(at(8 + 5 * 36, 8 + 2 * 36), 0);
    EXPECT_GT(at(8 + 7 * 36 + 8 + 85, 10), 12); // a hundredth of the peak can be seen
    EXPECT_EQ(at(8 + 7 * 36 + 8 + 2 * 85, 10), 255);
}

} // namespace
} // namespace Stillmark
