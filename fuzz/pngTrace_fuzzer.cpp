#include "deblur/estimate/arrayOps.h"
#include "framework/base/exceptions.h"
#include "fuzz/fuzzing.h"
#include "store/files/kernelPng.h"

#include <cmath>

using namespace Fuzzing;

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
