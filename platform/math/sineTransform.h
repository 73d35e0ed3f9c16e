#pragma once

#include "platform/math/alignedBuffer.h"

#include <cstddef>

namespace CorvaneDeblur
{

/// Type I discrete sine transform along the first axis of a length x count array:
///     S[k] = sum over j of x[j] * sin(pi * (j + 1) * (k + 1) / (length + 1)).
/// It is its own inverse up to the factor 2 / (length + 1).
///
/// Computed as a product with the sine matrix, halved by its symmetry: the lengths here are those of strips about as
/// wide as a blur, mostly below 100, and the length + 1 that a fast transform would have to take apart is often prime.
/// For such lengths the product is the faster of the two. Immutable; use it from any thread.
class sineTransform
{
public:
    explicit sineTransform(int length);

    /// In place: sample j of column c at data[j * stride + c]. Every result is multiplied by `scale`.
    void run(float *data, std::ptrdiff_t stride, int count, float scale) const;

private:
    int length;
    int half;                    ///< rows of the folded input: (length + 1) / 2
    alignedBuffer<float> matrix; ///< row k: the sines of result k at the first `half` samples
};

} // namespace CorvaneDeblur
