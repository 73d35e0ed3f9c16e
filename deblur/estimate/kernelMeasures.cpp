#include "deblur/estimate/kernelMeasures.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/resample.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{

double kernelSparsity(const floatArray &kernel)
{
    if (kernel.empty())
        return 0.0;
    double sum = 0.0;
    for (int y = 0; y < kernel.rows; ++y)
    {
        const float *k = kernel.row(y);
        for (int x = 0; x < kernel.cols; ++x)
            sum += std::sqrt(std::fabs(static_cast<double>(k[x])));
    }
    return sum / std::pow(static_cast<double>(kernel.rows) * kernel.cols, 0.25);
}

double kernelDistance(const floatArray &kernel, const floatArray &reference)
{
    const floatArray resized = floatArray::allocate(reference.rows, reference.cols);
    resize(kernel, resized);
    normaliseSum(resized);

    double sum = 0.0;
    for (int y = 0; y < reference.rows; ++y)
    {
        const float *a = resized.row(y);
        const float *b = reference.row(y);
        for (int x = 0; x < reference.cols; ++x)
        {
            const double difference = static_cast<double>(a[x]) - b[x];
            sum += difference * difference;
        }
    }
    return sum / (static_cast<double>(reference.rows) * reference.cols);
}

double gradientSparsity(const floatArray &image)
{
    double sumX = 0.0, squaresX = 0.0, sumY = 0.0, squaresY = 0.0;
    for (int y = 0; y + 1 < image.rows; ++y)
    {
        const float *here = image.row(y);
        const float *below = image.row(y + 1);
        for (int x = 0; x + 1 < image.cols; ++x)
        {
            const double dx = static_cast<double>(here[x + 1]) - here[x];
            const double dy = static_cast<double>(below[x]) - here[x];
            sumX += std::fabs(dx);
            squaresX += dx * dx;
            sumY += std::fabs(dy);
            squaresY += dy * dy;
        }
    }
    return sumY / squaresY + sumX / squaresX;
}

bool isGoodKernel(const floatArray &kernel)
{
    const double sparsity = kernelSparsity(kernel);
    return sparsity > 0.0 && sparsity < 3.5;
}

double pointShare(const floatArray &kernel)
{
    double total = 0.0, most = 0.0;
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
        {
            total += std::fabs(static_cast<double>(kernel.row(y)[x]));
            double around = 0.0;
            for (int v = std::max(0, y - 1); v <= std::min(kernel.rows - 1, y + 1); ++v)
                for (int u = std::max(0, x - 1); u <= std::min(kernel.cols - 1, x + 1); ++u)
                    around += std::fabs(static_cast<double>(kernel.row(v)[u]));
            most = std::max(most, around);
        }
    return total > 0.0 ? most / total : 0.0;
}

bool isPointKernel(const floatArray &kernel)
{
    return pointShare(kernel) >= 0.6;
}

double borderShare(const floatArray &kernel)
{
    double total = 0.0, border = 0.0;
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
        {
            const double weight = std::fabs(static_cast<double>(kernel.row(y)[x]));
            total += weight;
            if (y == 0 || x == 0 || y + 1 == kernel.rows || x + 1 == kernel.cols)
                border += weight;
        }
    return total > 0.0 ? border / total : 0.0;
}

} // namespace CorvaneDeblur
