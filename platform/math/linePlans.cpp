#include "platform/math/linePlans.h"

#include "platform/math/alignedBuffer.h"

#include <fftw3.h>

#include <map>
#include <memory>
#include <mutex>
#include <new>
#include <tuple>

namespace CorvaneDeblur
{
namespace
{

fftwf_complex *asFftw(const complexSample *p)
{
    // FFTW takes no const input, but leaves it alone in an out-of-place complex transform.
    return reinterpret_cast<fftwf_complex *>(const_cast<complexSample *>(p));
}

} // namespace

linePlan::linePlan(int n, int lanes, direction d)
{
    // Only the alignment of these matters: an estimated plan is made without running it.
    const std::size_t count = static_cast<std::size_t>(n) * static_cast<std::size_t>(lanes);
    const alignedBuffer<complexSample> in(count), out(count);
    plan = fftwf_plan_many_dft(1, &n, lanes, asFftw(in.data()), nullptr, lanes, 1, asFftw(out.data()), nullptr, lanes,
                               1, d == direction::forward ? FFTW_FORWARD : FFTW_BACKWARD, FFTW_ESTIMATE);
    if (!plan)
        throw std::bad_alloc();
}

linePlan::~linePlan()
{
    fftwf_destroy_plan(static_cast<fftwf_plan>(plan));
}

const linePlan &linePlan::cached(int n, int lanes, direction d)
{
    static std::mutex plannerLock;
    static std::map<std::tuple<int, int, direction>, std::unique_ptr<linePlan>> plans;
    const std::lock_guard guard(plannerLock);
    auto &entry = plans[{n, lanes, d}];
    if (!entry)
        entry.reset(new linePlan(n, lanes, d));
    return *entry;
}

const linePlan &linePlan::row(int n, direction d)
{
    return cached(n, 1, d);
}

const linePlan &linePlan::columns(int n, direction d)
{
    return cached(n, columnLanes, d);
}

void linePlan::run(const complexSample *in, complexSample *out) const
{
    fftwf_execute_dft(static_cast<fftwf_plan>(plan), asFftw(in), asFftw(out));
}

} // namespace CorvaneDeblur
