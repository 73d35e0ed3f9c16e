#include "host/kernelFile.h"

#include "host/greyPng.h"
#include "host/pfm.h"
#include "host/photo.h"
#include "host/textRaster.h"
#include "platform/files.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace Stillmark
{

namespace
{

Platform::fileError noKernel(const std::string &path, const std::string &why)
{
    return Platform::fileError(path + ": cannot be used as a kernel: " + why);
}

/// The samples of one plane as floats, codes divided by the greatest.
std::vector<float> planeSamples(const photo &picture, int plane)
{
    const rectangle all{0, 0, picture.width(), picture.height()};
    const std::size_t count = static_cast<std::size_t>(all.width) * static_cast<std::size_t>(all.height);
    const std::size_t rowBytes = static_cast<std::size_t>(all.width) * static_cast<std::size_t>(picture.sampleBytes());
    std::vector<float> samples(count);
    if (picture.depth() == 32)
    {
        picture.readPlanes(all, plane, 1, samples.data(), rowBytes);
        return samples;
    }
    std::vector<std::uint16_t> codes(count); // holds 8-bit codes just as well
    picture.readPlanes(all, plane, 1, codes.data(), rowBytes);
    if (picture.depth() == 16)
        std::transform(codes.begin(), codes.end(), samples.begin(), [](std::uint16_t c) { return c / 65535.0f; });
    else
    {
        const auto *bytes = reinterpret_cast<const std::uint8_t *>(codes.data());
        std::transform(bytes, bytes + count, samples.begin(), [](std::uint8_t c) { return c / 255.0f; });
    }
    return samples;
}

std::vector<float> greySamples(const std::string &path, const photo &picture)
{
    if (picture.mode() == colourMode::grey)
        return planeSamples(picture, 0);
    if (picture.mode() != colourMode::rgb)
        throw noKernel(path, "it is neither grey nor RGB");
    const float luma[] = {0.299f, 0.587f, 0.114f}; // ITU-R BT.601
    std::vector<float> grey(static_cast<std::size_t>(picture.width()) * static_cast<std::size_t>(picture.height()));
    for (int p = 0; p < 3; ++p)
    {
        const std::vector<float> plane = planeSamples(picture, p);
        for (std::size_t i = 0; i < grey.size(); ++i)
            grey[i] += luma[p] * plane[i];
    }
    return grey;
}

bool endsIn(const std::string &path, const char *extension)
{
    std::string end = path.substr(path.size() - std::min<std::size_t>(path.size(), 4));
    std::transform(end.begin(), end.end(), end.begin(), [](unsigned char c) { return std::tolower(c); });
    return end == extension;
}

struct greyCanvas
{
    int width, height;
    std::vector<std::uint8_t> samples;

    std::uint8_t &at(int x, int y)
    {
        return samples[static_cast<std::size_t>(y) * static_cast<std::size_t>(width) + static_cast<std::size_t>(x)];
    }
};

void draw(const kernelSamples &kernel, int scale, int left, int top, greyCanvas &canvas)
{
    constexpr float gamma = 0.6f; // raises the faint ends of a path without burning out its middle
    const float peak = kernel.samples.empty() ? 0 : *std::max_element(kernel.samples.begin(), kernel.samples.end());
    for (int y = 0; y < kernel.rows * scale; ++y)
        for (int x = 0; x < kernel.cols * scale; ++x)
        {
            const std::size_t at = static_cast<std::size_t>(y / scale) * static_cast<std::size_t>(kernel.cols) +
                                   static_cast<std::size_t>(x / scale);
            const float v = kernel.samples[at] > 0 ? kernel.samples[at] / peak : 0;
            canvas.at(left + x, top + y) =
                static_cast<std::uint8_t>(std::lround(255 * std::pow(std::min(v, 1.0f), gamma)));
        }
}

/// White on the canvas.
void draw(const textRaster &text, int left, int top, greyCanvas &canvas)
{
    for (int y = 0; y < text.height; ++y)
        for (int x = 0; x < text.width; ++x)
        {
            const int cover = text.coverage[static_cast<std::size_t>(y) * static_cast<std::size_t>(text.width) +
                                            static_cast<std::size_t>(x)];
            std::uint8_t &sample = canvas.at(left + x, top + y);
            sample = static_cast<std::uint8_t>(sample + (255 - sample) * cover / 255);
        }
}

} // namespace

kernelSamples readKernel(const std::string &path)
{
    const photo picture = photo::open(path);
    const int rows = picture.height(), cols = picture.width();
    const std::string size = std::to_string(cols) + " x " + std::to_string(rows);
    if (rows > largestKernelSide || cols > largestKernelSide)
        throw noKernel(path, "it has " + size + " samples, at most " + std::to_string(largestKernelSide) +
                                 " a side are taken");
    if (rows % 2 == 0 || cols % 2 == 0)
        throw noKernel(path, "it has " + size + " samples, but a kernel has a sample in its middle: both sides odd");

    kernelSamples kernel{rows, cols, greySamples(path, picture)};
    double sum = 0;
    for (const float v : kernel.samples)
    {
        if (!std::isfinite(v) || v < 0)
            throw noKernel(path, "it has a sample that is negative or no number");
        sum += v;
    }
    if (sum <= 0)
        throw noKernel(path, "all of it is zero");
    for (float &v : kernel.samples)
        v = static_cast<float>(v / sum);
    return kernel;
}

void checkKernelPath(const std::string &path)
{
    if (!endsIn(path, ".pfm") && !endsIn(path, ".png"))
        throw Platform::fileError(path + ": cannot be written: a kernel's file name ends in .pfm or .png");
    Platform::checkWritable(path);
}

void writeKernel(const std::string &path, const kernelSamples &kernel)
{
    if (endsIn(path, ".pfm"))
        return writePfm(path, {kernel.cols, kernel.rows, 1, kernel.samples});
    checkKernelPath(path);
    const float peak = *std::max_element(kernel.samples.begin(), kernel.samples.end());
    std::vector<std::uint16_t> codes(kernel.samples.size());
    for (std::size_t i = 0; i < codes.size(); ++i)
    {
        const float v = peak > 0 ? kernel.samples[i] / peak : 0; // NaN ends as 0
        codes[i] = v > 0 ? static_cast<std::uint16_t>(std::lround(std::min(v, 1.0f) * 65535.0f)) : 0;
    }
    writeGreyPng(path, kernel.cols, kernel.rows, codes);
}

void writeKernelPicture(const std::string &path, const std::vector<kernelSamples> &kernels,
                        const std::vector<std::string> &captions)
{
    constexpr int side = 256, gap = 8;
    constexpr std::uint8_t background = 64;
    const auto enlargement = [](const kernelSamples &k) { return std::max(1, side / std::max({k.rows, k.cols, 1})); };

    std::vector<textRaster> texts;
    for (const std::string &caption : captions)
        texts.push_back(renderText(caption));
    int width = gap, kernelHeight = 0, textHeight = 0;
    for (std::size_t i = 0; i < kernels.size(); ++i)
    {
        const kernelSamples &k = kernels[i];
        const int textWidth = texts.empty() ? 0 : texts[i].width;
        width += std::max(k.cols * enlargement(k), textWidth) + gap;
        kernelHeight = std::max(kernelHeight, k.rows * enlargement(k));
        textHeight = std::max(textHeight, texts.empty() ? 0 : texts[i].height + gap);
    }
    const int height = kernelHeight + textHeight + 2 * gap;
    greyCanvas canvas{width, height, {}};
    canvas.samples.assign(static_cast<std::size_t>(width) * static_cast<std::size_t>(height), background);
    int left = gap;
    for (std::size_t i = 0; i < kernels.size(); ++i)
    {
        draw(kernels[i], enlargement(kernels[i]), left, gap, canvas);
        int used = kernels[i].cols * enlargement(kernels[i]);
        if (!texts.empty())
        {
            draw(texts[i], left, 2 * gap + kernelHeight, canvas);
            used = std::max(used, texts[i].width);
        }
        left += used + gap;
    }
    writeGreyPng(path, width, height, canvas.samples);
}

} // namespace Stillmark
