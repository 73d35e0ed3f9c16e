#include "tests/reference/literalSplitting.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "tests/reference/spectra.h"

using namespace CorvaneDeblur;

namespace Reference
{

floatArray laplacianSpectrum(int gridRows, int gridCols)
{
    const floatArray kernel = floatArray::allocate(3, 3);
    fill(kernel, 0.0f);
    kernel.at(1, 1) = 4.0f;
    kernel.at(0, 1) = kernel.at(2, 1) = kernel.at(1, 0) = kernel.at(1, 2) = -1.0f;
    return realSpectrum(kernel, gridRows, gridCols);
}

floatArray powerOf(const complexArray &k)
{
    const floatArray power = floatArray::allocate(k.rows, k.cols);
    for (int v = 0; v < k.rows; ++v)
        for (int u = 0; u < k.cols; ++u)
            power.at(v, u) = norm(k.at(v, u));
    return power;
}

complexArray shrunkGradientSpectrum(const floatArray &x, const shrinkageTable &table)
{
    const floatArray gradient = floatArray::allocate(x.rows, x.cols);
    const floatArray sum = floatArray::allocate(x.rows, x.cols);
    const floatArray vertical = floatArray::allocate(x.rows, x.cols);

    circularDiffX(x, gradient);
    applyShrinkage(gradient, table, -10.0f, 0.0001f, gradient);
    for (int r = 0; r < x.rows; ++r)
        for (int j = 0; j < x.cols; ++j)
            sum.at(r, j) = gradient.at(r, j) - gradient.at(r, j > 0 ? j - 1 : x.cols - 1);

    circularDiffY(x, gradient);
    applyShrinkage(gradient, table, -10.0f, 0.0001f, gradient);
    for (int r = 0; r < x.rows; ++r)
        for (int j = 0; j < x.cols; ++j)
            vertical.at(r, j) = gradient.at(r, j) - gradient.at(r > 0 ? r - 1 : x.rows - 1, j);

    addInto(sum, vertical, sum);
    return spectrumOf(sum);
}

} // namespace Reference
