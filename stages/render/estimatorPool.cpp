#include "stages/render/estimatorPool.h"

namespace Project
{

using CorvaneDeblur::latentEstimator;

PEstimatorPool::PEstimatorPool(const renderSettings &what, CorvaneDeblur::shrinkageTableStore &store)
    : settings(what), tables(store)
{
}

std::unique_ptr<latentEstimator> PEstimatorPool::Take()
{
    {
        const std::lock_guard guard(lock);
        if (!idle.empty())
        {
            std::unique_ptr<latentEstimator> estimator = std::move(idle.back());
            idle.pop_back();
            return estimator;
        }
    }
    std::unique_ptr<latentEstimator> estimator = createLatentEstimator(settings.method, tables);
    estimator->setKernels(settings.kernels, settings.scale);
    estimator->setStopFlag(&stop);
    return estimator;
}

void PEstimatorPool::GiveBack(std::unique_ptr<latentEstimator> estimator) noexcept
{
    try
    {
        const std::lock_guard guard(lock);
        idle.push_back(std::move(estimator));
    }
    catch (const std::bad_alloc &)
    {
        // The next taker makes one of its own.
    }
}

} // namespace Project
