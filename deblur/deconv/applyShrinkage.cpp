#include "deblur/deconv/shrinkageLookup.h"
#include "deblur/deconv/shrinkageTable.h"
#include "deblur/estimate/arrayOps.h"

namespace CorvaneDeblur
{

void applyShrinkage(const floatArray &in, const shrinkageTable &table, float start, float step, const floatArray &out)
{
    assert(in.sameShape(out) && table.size() >= 2);
    if (!(step > 0.0f))
    {
        fill(out, table[0]);
        return;
    }
    const float reciprocal = 1.0f / step;
    const int lastInterval = static_cast<int>(table.size()) - 2;
    for (int y = 0; y < in.rows; ++y)
        for (int x = 0; x < in.cols; ++x)
            out.row(y)[x] = shrinkageLookup(table.data(), in.row(y)[x], start, reciprocal, lastInterval);
}

} // namespace CorvaneDeblur
