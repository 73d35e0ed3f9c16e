#pragma once

#include "platform/math/complexSample.h"

#include <cstddef>

/// Element-wise and level-1 operations on n contiguous samples, single precision. Outputs may be one of the inputs, but
/// no arrays may overlap otherwise. Sums run in eight interleaved partial sums that are added at the end, so that they
/// vectorise and still give the same value on every processor.
namespace CorvaneDeblur
{

void vsAdd(std::size_t n, const float *a, const float *b, float *out);
void vsSub(std::size_t n, const float *a, const float *b, float *out);
void vsMul(std::size_t n, const float *a, const float *b, float *out);
/// out = sqrt(a^2 + b^2); no care is taken of overflow, intensities are around 1.
void vsHypot(std::size_t n, const float *a, const float *b, float *out);
/// out = exp(a), to 2 units in the last place for a in -87..88; a is clamped to that range.
void vsExp(std::size_t n, const float *a, float *out);

/// out = factor * a
void sscal(std::size_t n, float factor, const float *a, float *out);
/// y += factor * x
void saxpy(std::size_t n, float factor, const float *x, float *y);
/// out = alpha * a + beta * b
void saxpby(std::size_t n, float alpha, const float *a, float beta, const float *b, float *out);
float sdot(std::size_t n, const float *a, const float *b);
float sasum(std::size_t n, const float *a);
/// Index of the first element of largest magnitude; 0 when n is 0.
std::size_t isamax(std::size_t n, const float *a);
/// Largest element, or `least` when none is larger.
float smax(std::size_t n, const float *a, float least);

/// out = a * conj(b)
void vcMulByConj(std::size_t n, const complexSample *a, const complexSample *b, complexSample *out);
/// out = a * b * scale
void vcMul(std::size_t n, const complexSample *a, const complexSample *b, complexSample scale, complexSample *out);
/// out = c * r
void vcMulByReal(std::size_t n, const complexSample *c, const float *r, complexSample *out);

} // namespace CorvaneDeblur
