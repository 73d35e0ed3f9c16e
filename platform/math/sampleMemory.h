#pragma once

#include <cstddef>

/// Memory of arrays and spectra. A fresh block of a few megabytes costs a page fault every 4 KiB, which on the grids of
/// a render is as much time as a transform; so blocks that are given back are kept for the next taker of their size.
///
/// Any thread. Under the address sanitizer nothing is kept, so that a use after release shows.
namespace CorvaneDeblur
{

/// Uninitialised memory, aligned to a cache line. Throws std::bad_alloc.
void *takeSampleMemory(std::size_t bytes);
/// Gives back what takeSampleMemory(bytes) returned; null is nothing.
void returnSampleMemory(void *memory, std::size_t bytes) noexcept;

/// Frees the blocks that wait for a taker. Call it where a run ends.
void trimSampleMemory() noexcept;
/// Bytes that wait for a taker now, and the most that ever wait: 32 MiB per processor.
std::size_t idleSampleMemory() noexcept;
std::size_t idleSampleMemoryLimit() noexcept;

} // namespace CorvaneDeblur
