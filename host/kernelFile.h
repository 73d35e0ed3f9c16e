#pragma once

#include <string>
#include <vector>

namespace Stillmark
{

/// A blur kernel as files hold it: rows x cols samples from the top left.
struct kernelSamples
{
    int rows = 0, cols = 0;
    std::vector<float> samples;
};

constexpr int largestKernelSide = 8000;

/// Reads a kernel from a portable float map or from any picture photo::open takes (grey, or the luma of RGB;
/// transparency is ignored) and scales it to a sum of 1. Throws Platform::fileError, with a sentence that names the
/// file, if it cannot be read or is no kernel: a side that is even or above largestKernelSide, a sample that is
/// negative or no number, all samples zero.
kernelSamples readKernel(const std::string &path);

/// Throws Platform::fileError unless path ends in .pfm or .png and can be written.
void checkKernelPath(const std::string &path);

/// Writes .pfm (exact) or .png (16-bit grey, scaled so that the largest sample is white; negative samples become 0).
void writeKernel(const std::string &path, const kernelSamples &kernel);

/// A PNG to look at: the kernels side by side, enlarged to about 256 pixels each with square pixels left visible, and
/// faint parts raised. captions: what is written below each (as many as kernels); none: no text.
void writeKernelPicture(const std::string &path, const std::vector<kernelSamples> &kernels,
                        const std::vector<std::string> &captions = {});

} // namespace Stillmark
