#pragma once

#include "cli/runContext.h"
#include "deblur/estimate/kernelEstimator.h"
#include "host/photo.h"

#include <vector>

namespace Stillmark
{

/// Settings that all estimations of a run share; as kernelEstimator has them.
struct estimationSettings
{
    CorvaneDeblur::noiseMode noise = CorvaneDeblur::noiseMode::automatic;
    float noiseLevel = 0; ///< measured; for noiseMode::automatic
    int maskThreshold = 255;
    int seedLevels = 0;
    int skipLevels = 0;
    bool secondOrder = false;
};

/// One estimation's outcome.
struct foundTrace
{
    rectangle region;
    int size = 0;
    CorvaneDeblur::estimateStatus status = CorvaneDeblur::estimateStatus::finished;
    CorvaneDeblur::floatArray kernel; ///< empty unless status is finished
    double sparsity = 0;
    bool good = false;  ///< finished and not judged poor
    bool point = false; ///< finished, and says that nothing moved
    bool cut = false;   ///< finished, and runs into the border of its square: the blur is longer than `size`
    int levels = 0;
    bool active = true;  ///< wanted in the result
    bool forced = false; ///< wanted whatever it is judged
};

/// Estimates a kernel of size x size in each region, several at a time; the results are in the regions' order and do
/// not depend on the threads. Every region has room for the size (regionFor). A region in which nothing is to be seen
/// gets noStructure without further work. Throws Platform::cancelled after Ctrl-C.
std::vector<foundTrace> estimateTraces(const photo &picture, const std::vector<rectangle> &regions, int size,
                                       const estimationSettings &settings, runContext &context);

/// A kernel that was estimated elsewhere. One that is empty or all zero was not: its region has no room for the size,
/// or no structure.
foundTrace judgeTrace(const rectangle &region, int size, const CorvaneDeblur::floatArray &kernel);

/// Whether a trace is worth removing without being asked to.
inline bool isUsable(const foundTrace &trace)
{
    return trace.good && !trace.point;
}

/// Why a trace is of no use, in plain words; empty for a usable one.
std::string complaintAbout(const foundTrace &trace);

} // namespace Stillmark
