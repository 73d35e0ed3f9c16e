#pragma once

#include "platform/math/sampleMemory.h"

#include <cstddef>
#include <utility>

namespace CorvaneDeblur
{

/// Owned, uninitialised memory for `count` plain samples, aligned to a cache line: what transforms and vector loops
/// like best. Throws std::bad_alloc.
template <typename Sample> class alignedBuffer
{
public:
    alignedBuffer() = default;
    explicit alignedBuffer(std::size_t sampleCount)
        : memory(static_cast<Sample *>(takeSampleMemory(sampleCount * sizeof(Sample)))), samples(sampleCount)
    {
    }
    alignedBuffer(alignedBuffer &&other) noexcept
        : memory(std::exchange(other.memory, nullptr)), samples(std::exchange(other.samples, 0))
    {
    }
    alignedBuffer &operator=(alignedBuffer &&other) noexcept
    {
        std::swap(memory, other.memory);
        std::swap(samples, other.samples);
        return *this;
    }
    ~alignedBuffer() { returnSampleMemory(memory, samples * sizeof(Sample)); }

    Sample *data() const { return memory; }
    std::size_t count() const { return samples; }
    Sample &operator[](std::size_t i) const { return memory[i]; }

private:
    Sample *memory = nullptr;
    std::size_t samples = 0;
};

} // namespace CorvaneDeblur
