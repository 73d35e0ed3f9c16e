#pragma once

#include <tbb/blocked_range.h>
#include <tbb/parallel_for.h>

#include <cstddef>

namespace CorvaneDeblur
{

/// Who runs a loop. Values never depend on it.
enum class workers
{
    one, ///< the calling thread, as inside a loop over planes or cells that is parallel itself
    all  ///< all threads of the current tbb arena
};

/// Calls body(first, last) over pieces of [0, count) of at most `grain`, in order on the calling thread or in any order
/// on all of them. The pieces are the same either way, so sums per piece do not depend on the threads.
template <typename Body> void inPieces(workers who, int count, int grain, const Body &body)
{
    const int pieces = (count + grain - 1) / grain;
    const auto piece = [&](int i) {
        const int first = i * grain;
        body(first, first + grain < count ? first + grain : count);
    };
    if (who == workers::one || pieces < 2)
        for (int i = 0; i < pieces; ++i)
            piece(i);
    else
        tbb::parallel_for(0, pieces, piece);
}

} // namespace CorvaneDeblur
