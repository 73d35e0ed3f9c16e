#pragma once

#include "platform/math/complexSample.h"

namespace CorvaneDeblur
{

enum class direction
{
    forward, ///< exponent -2 pi i / n
    inverse  ///< exponent +2 pi i / n, unnormalised
};

/// Number of neighbouring columns that are transformed together: 8 complex samples fill a cache line.
constexpr int columnLanes = 8;

/// A one-dimensional complex transform of length n, single precision, out of place; plans are kept for the life of the
/// process. Getting a plan takes one lock (FFTW's planner is not thread-safe); running it takes none and may happen on
/// any number of threads. Plans are estimated, never measured: the same length gives the same plan, and so the same
/// bytes, on every run.
///
/// `in` and `out` are aligned to 64 bytes and do not overlap; `in` is preserved.
class linePlan
{
public:
    /// One line of n contiguous samples.
    static const linePlan &row(int n, direction d);
    /// columnLanes lines at once: sample j of lane c at index j * columnLanes + c.
    static const linePlan &columns(int n, direction d);

    void run(const complexSample *in, complexSample *out) const;

    linePlan(const linePlan &) = delete;
    linePlan &operator=(const linePlan &) = delete;
    ~linePlan();

private:
    linePlan(int n, int lanes, direction d);
    static const linePlan &cached(int n, int lanes, direction d);
    void *plan;
};

} // namespace CorvaneDeblur
