#include "deblur/estimate/kernelEstimatorThread.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{

void kernelEstimatorThread::cancel()
{
    const std::lock_guard guard(lock);
    cancelled = true;
}

double kernelEstimatorThread::progress() const
{
    int total, done, iteration, iterations;
    {
        const std::lock_guard guard(lock);
        total = levelCount;
        done = currentLevel;
        if (seedLevels >= 1)
        {
            total += 4 * seedLevels;
            done = currentLevel < seedLevels ? 5 * currentLevel + static_cast<int>(5.0f * seedFraction)
                                             : currentLevel + 4 * seedLevels;
        }
        iteration = currentIteration;
        iterations = iterationsPerLevel;
    }
    if (total == 0)
        return 0.0;
    if (done == total)
        return 1.0;
    const auto share = [&](int levels) { return std::pow(static_cast<double>(levels) / total, 1.9); };
    double p = share(done);
    if (iteration > 0)
        p += (share(done + 1) - p) * iteration / iterations;
    return p;
}

} // namespace CorvaneDeblur
