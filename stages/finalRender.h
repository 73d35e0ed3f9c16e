#pragma once

#include <cstdint>
#include <functional>

namespace Project
{

class PImageHub;

/// What a final render tells of itself and asks, on the main thread.
struct PFinalWatcher
{
    std::function<bool()> cancelled;                        ///< between cells
    std::function<void(std::uint64_t, std::uint64_t)> show; ///< cells done and in all; every 0.2 s, and at the end
};

/// Renders the selection's bounds at full resolution and writes them to the host. Cells are computed on all threads of
/// the current tbb arena, each from its own copy of what it reads; the main thread alone reads the host, moves pixels
/// in and out of the stages' pixmaps, and writes, row of cells by row, left to right. What is under way at a time is
/// bounded by the number of threads, and the bytes do not depend on it. Cells that the result stage has finished
/// before are written as they are; the others go past it, straight to the host.
///
/// False where it was cancelled: what was written stays written. Exceptions of the host come out of it.
bool renderFinal(PImageHub &hub, const PFinalWatcher &watcher);

} // namespace Project
