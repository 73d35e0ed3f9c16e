#pragma once

#include "framework/base/container.h"
#include "store/traces/kernelCollection.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <span>
#include <string>

/// The entry of a fuzzer: any bytes. Returns 0.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size);

namespace Fuzzing
{

/// Ends the process, as a fault, unless the law holds; in every build.
inline void require(bool law)
{
    if (!law)
        std::abort();
}

inline Sarnik::CMemoryContainer containerOf(const std::uint8_t *data, std::size_t size)
{
    return Sarnik::CMemoryContainer(std::as_bytes(std::span(data, size)));
}

inline std::string contentOf(const Sarnik::CMemoryContainer &container)
{
    return {reinterpret_cast<const char *>(container.Content().data()), container.Size()};
}

/// A collection for a picture of the size that the sample files are for. Nothing reads its pixels.
struct collectionForSamples
{
    struct samplePicture final : Project::PTracePicture
    {
        Sarnik::CRect Bounds() const override { return {0, 0, 400, 300}; }
        int Planes() const override { return 1; }
        int Depth() const override { return 8; }
        void ReadGrey(const Sarnik::CRect &, std::uint8_t, const CorvaneDeblur::floatArray &,
                      const CorvaneDeblur::byteArray &) override
        {
            require(false);
        }
    };

    samplePicture picture;
    Project::PParams parameters;
    Project::PTraceEvents events;
    Project::PKernelCollection traces{picture, parameters, events, ""};
};

} // namespace Fuzzing
