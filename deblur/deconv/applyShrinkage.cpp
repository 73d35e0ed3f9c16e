#include "deblur/deconv/blockShrinkage.h"
#include "deblur/deconv/shrinkageTable.h"
#include "deblur/estimate/arrayOps.h"
#include "platform/math/multiversion.h"

namespace CorvaneDeblur
{
namespace
{

STILLMARK_MULTIVERSION
void shrinkRow(const float *in, const float *table, float start, float reciprocal, int lastInterval, float *out,
               std::ptrdiff_t count)
{
    const auto value = [in](std::ptrdiff_t i) { return in[i]; };
    blockShrinkage(table, start, reciprocal, lastInterval, value, out, count);
}

} // namespace

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
        shrinkRow(in.row(y), table.data(), start, reciprocal, lastInterval, out.row(y), in.cols);
}

} // namespace CorvaneDeblur
