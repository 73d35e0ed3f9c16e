#pragma once

#include <mutex>

namespace CorvaneDeblur
{

/// What an estimating thread shares with the thread that watches it. cancel and progress may come from any thread at
/// any moment; the lock is never held across a computation.
class kernelEstimatorThread
{
public:
    virtual ~kernelEstimatorThread() = default;

    /// Asks the run to stop: it does so within one alternation of the level it is in, with status `cancelled`.
    /// Never cleared: an object serves one run.
    void cancel();

    /// Share of the run that is done, 0..1. The exponent 1.9 over the levels follows their cost, the fine ones being
    /// the slow ones; a level of the seed search counts five times.
    double progress() const;

protected:
    mutable std::mutex lock; ///< guards all that follows
    bool cancelled = false;
    int levelCount = 0;
    int currentLevel = 0; ///< level in work; levelCount when done
    int iterationsPerLevel = 0;
    int currentIteration = 0; ///< 1-based while a level runs, 0 between levels
    int seedLevels = 0;
    float seedFraction = 0.0f; ///< share of the seeds done on the current seed level
};

} // namespace CorvaneDeblur
