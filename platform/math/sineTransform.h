#pragma once

#include <cstddef>

namespace CorvaneDeblur
{

class linePlan;

/// Type I discrete sine transform along the first axis of a length x count array:
///     S[k] = sum over j of x[j] * sin(pi * (j + 1) * (k + 1) / (length + 1)).
/// It is its own inverse up to the factor 2 / (length + 1).
///
/// Computed from a complex transform of the odd continuation, of length 2 * (length + 1); sixteen real columns travel
/// as eight complex ones. Immutable; use it from any thread.
class sineTransform
{
public:
    explicit sineTransform(int length);

    /// In place: sample j of column c at data[j * stride + c]. Every result is multiplied by `scale`.
    void run(float *data, std::ptrdiff_t stride, int count, float scale) const;

private:
    int length;
    const linePlan *plan;
};

} // namespace CorvaneDeblur
