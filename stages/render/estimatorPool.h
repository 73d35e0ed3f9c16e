#pragma once

#include "stages/render/renderSettings.h"

#include <atomic>
#include <memory>
#include <mutex>
#include <vector>

namespace Project
{

/// Estimators of one render, all with the same kernels, for as many threads as ask at a time: setting one up costs a
/// resampling of every kernel. Any thread.
class PEstimatorPool
{
public:
    /// The settings and the tables outlive the pool.
    PEstimatorPool(const renderSettings &what, CorvaneDeblur::shrinkageTableStore &store);

    /// Takes one for as long as it lives.
    class Loan
    {
    public:
        explicit Loan(PEstimatorPool &from) : pool(from), estimator(from.Take()) {}
        Loan(const Loan &) = delete;
        Loan &operator=(const Loan &) = delete;
        ~Loan() { pool.GiveBack(std::move(estimator)); }
        CorvaneDeblur::latentEstimator &Estimator() { return *estimator; }

    private:
        PEstimatorPool &pool;
        std::unique_ptr<CorvaneDeblur::latentEstimator> estimator;
    };

    /// Deconvolutions under way end at their next plane, with undefined results.
    void Stop() { stop = true; }

private:
    std::unique_ptr<CorvaneDeblur::latentEstimator> Take();
    void GiveBack(std::unique_ptr<CorvaneDeblur::latentEstimator> estimator) noexcept;

    const renderSettings &settings;
    CorvaneDeblur::shrinkageTableStore &tables;
    std::atomic<bool> stop{false};
    std::mutex lock; ///< guards idle
    std::vector<std::unique_ptr<CorvaneDeblur::latentEstimator>> idle;
};

} // namespace Project
