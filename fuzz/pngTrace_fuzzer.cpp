#include "deblur/estimate/arrayOps.h"
#include "framework/base/exceptions.h"
#include "fuzz/fuzzing.h"
#include "store/files/kernelPng.h"

#include <cmath>
#include <zlib.h>

using namespace Fuzzing;

#ifdef STILLMARK_FUZZ
extern "C" std::size_t LLVMFuzzerMutate(std::uint8_t *data, std::size_t size, std::size_t largest);

namespace
{

/// Makes every chunk's check sum right, as far as the chunks can be followed; without that hardly any change of a
/// header or of pixels would get past it.
void repairCheckSums(std::uint8_t *data, std::size_t size)
{
    constexpr std::size_t signature = 8, frame = 12; // a chunk's length, type and check sum
    for (std::size_t at = signature; at + frame <= size;)
    {
        std::size_t length = 0;
        for (int i = 0; i < 4; ++i)
            length = length << 8 | data[at + static_cast<std::size_t>(i)];
        if (length > size - at - frame)
            return;
        const auto sum = crc32(0, data + at + 4, static_cast<uInt>(length + 4));
        at += frame + length;
        for (std::size_t i = 0; i < 4; ++i)
            data[at - 4 + i] = static_cast<std::uint8_t>(sum >> (24 - 8 * i));
    }
}

} // namespace

extern "C" std::size_t LLVMFuzzerCustomMutator(std::uint8_t *data, std::size_t size, std::size_t largest, unsigned seed)
{
    size = LLVMFuzzerMutate(data, size, largest);
    if (seed % 8 != 0) // wrong sums are inputs, too
        repairCheckSums(data, size);
    return size;
}
#endif

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    constexpr int largest = 99;
    CorvaneDeblur::floatArray kernel;
    std::string message;
    Sarnik::CMemoryContainer in = containerOf(data, size);
    try
    {
        if (!Project::ReadKernelPng(kernel, largest, in, message))
        {
            require(kernel.empty());
            return 0;
        }
    }
    catch (const Sarnik::CException &)
    {
        require(size < 8);
        return 0;
    }
    require(message.empty() && kernel.rows == kernel.cols && kernel.rows % 2 == 1 && kernel.rows <= largest);
    const float sum = sumAbs(kernel);
    require(sum == 0.0f || std::fabs(sum - 1.0f) < 1e-4f);

    Sarnik::CMemoryContainer out;
    require(Project::WriteKernelPng(kernel, out, message));
    out.Seek(0);
    CorvaneDeblur::floatArray back;
    require(Project::ReadKernelPng(back, largest, out, message) && back.sameShape(kernel));
    return 0;
}
