#pragma once

#include <cstddef>
#include <memory>
#include <new>

namespace CorvaneDeblur
{

/// Owned, uninitialised memory for `count` plain samples, aligned to a cache line: what transforms and vector loops
/// like best. Throws std::bad_alloc.
template <typename Sample> class alignedBuffer
{
public:
    static constexpr std::align_val_t alignment{64};

    alignedBuffer() = default;
    explicit alignedBuffer(std::size_t sampleCount)
        : memory(static_cast<Sample *>(::operator new(sampleCount * sizeof(Sample), alignment))), samples(sampleCount)
    {
    }

    Sample *data() const { return memory.get(); }
    std::size_t count() const { return samples; }
    Sample &operator[](std::size_t i) const { return memory[i]; }

private:
    struct release
    {
        void operator()(Sample *p) const { ::operator delete(p, alignment); }
    };
    std::unique_ptr<Sample[], release> memory;
    std::size_t samples = 0;
};

} // namespace CorvaneDeblur
