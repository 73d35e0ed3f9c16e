#include "store/traces/squareKernel.h"

#include "deblur/estimate/arrayOps.h"

#include <algorithm>

namespace Project
{

using namespace CorvaneDeblur;

floatArray SquareKernel(const floatArray &kernel, int side)
{
    if (kernel.rows == side && kernel.cols == side)
        return kernel;
    const int rows = std::min(side, kernel.rows), cols = std::min(side, kernel.cols);
    const floatArray square = floatArray::allocate(side, side);
    fill(square, 0.0f);
    copyTo(kernel.subRect((kernel.rows - rows) / 2, (kernel.cols - cols) / 2, rows, cols),
           square.subRect((side - rows) / 2, (side - cols) / 2, rows, cols));
    return square;
}

} // namespace Project
