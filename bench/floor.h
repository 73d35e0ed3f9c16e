#pragma once

#include <vector>

/// The floor of a job: the time of the bare transforms that it cannot do without, on one thread, with warm buffers and
/// nothing in between. Wall time over floor is the job's floor ratio.
namespace Bench
{

/// How often a job transforms a real grid of rows x cols.
struct transformCount
{
    int rows, cols;
    long forward, inverse;
};

struct floorSeconds
{
    double fftw = 0.0; ///< FFTW's own two-dimensional real transforms, plans estimated
    double own = 0.0;  ///< the engine's, which are built from complex lines and faster at odd sizes
};

/// Measures now. Makes FFTW plans, so nothing else may make any meanwhile: call it outside of parallel work.
floorSeconds measureFloor(const std::vector<transformCount> &job);

/// Name and version of the transforms that floorSeconds::fftw times.
const char *floorLibrary();

} // namespace Bench
