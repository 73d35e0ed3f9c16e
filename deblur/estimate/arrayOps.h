#pragma once

#include "deblur/estimate/floatArray.h"

/// Element-wise operations and sums on arrays.
///
/// Common to all: arrays of one call have equal shapes unless told otherwise; strides are honoured; `out` is allocated
/// by the caller and may be one of the inputs; single precision throughout; nothing is allocated.
namespace CorvaneDeblur
{

void fill(const floatArray &a, float value);
/// Copies the samples row by row; dst keeps its shape and is at least as large as src.
void copyTo(const floatArray &src, const floatArray &dst);
/// A fresh compact array with the samples of src.
floatArray cloned(const floatArray &src);
/// dst = factor * a
void scaleInto(const floatArray &a, const floatArray &dst, float factor);
/// out = alpha * a + beta * b
void combine(float alpha, const floatArray &a, float beta, const floatArray &b, const floatArray &out);
/// out = a * b * factor
void multiplyInto(const floatArray &a, const floatArray &b, const floatArray &out, float factor = 1.0f);
void subtractInto(const floatArray &a, const floatArray &b, const floatArray &out);
void addInto(const floatArray &a, const floatArray &b, const floatArray &out);

/// Sum of the products, single precision, accumulated per row.
float dot(const floatArray &a, const floatArray &b);
/// Sum of absolute values, single precision, accumulated per row.
float sumAbs(const floatArray &a);
/// Largest sample, but never less than the smallest positive normal float: an all-negative array answers that.
float peak(const floatArray &a);
/// The sample of largest magnitude, with its sign; the first one in row order on ties.
float peakAbs(const floatArray &a);

/// -1, 0 or +1 per sample.
void signInto(const floatArray &a, const floatArray &out);
/// Scales a to a sum of absolute values of 1; an all-zero array stays as it is.
void normaliseSum(const floatArray &a);
/// Samples not greater than t become 0, others are copied.
void thresholdInto(const floatArray &a, const floatArray &out, float t);

void fill(const complexArray &a, complexSample value);
/// out = c * r per sample
void multiplySpectrumByReal(const complexArray &c, const floatArray &r, const complexArray &out);
/// out = a * b * scale
void multiplySpectra(const complexArray &a, const complexArray &b, const complexArray &out, complexSample scale);
/// out = a * conj(b)
void multiplySpectrumByConj(const complexArray &a, const complexArray &b, const complexArray &out);
enum class complexPart
{
    real,
    imaginary
};
/// The real or imaginary parts of c.
void realPartInto(const complexArray &c, const floatArray &out, complexPart part);

} // namespace CorvaneDeblur
